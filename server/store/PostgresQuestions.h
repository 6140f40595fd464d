#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "server/store/DatabaseValue.h"

namespace ktr::server {

/// One statement that is run with many values, as one question to the server: a hundred cost little more than one. Each
/// of its values travels as an array; the first column of the answer is the number of the run, from 1, that the row
/// belongs to, in which the rows come as the statement orders them. A value.
class PostgresQuestions {
  public:
    /// Of a statement that only reads; `runs` has the values of each, at least one, alike in number and types.
    PostgresQuestions(std::string_view sql, const std::vector<const std::vector<DatabaseValue>*>& runs);

    const std::string& sql() const { return sql_; }
    const std::vector<DatabaseValue>& values() const { return values_; }

  private:
    std::string sql_;
    std::vector<DatabaseValue> values_;
};

}  // namespace ktr::server
