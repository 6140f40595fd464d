#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/base/Api.h"

namespace ktr::platform {

/// Header fields by name, in order of insertion. Names are compared without the case of ASCII letters (RFC 9110).
class KTR_API HttpHeaders {
  public:
    using Field = std::pair<std::string, std::string>;

    HttpHeaders() = default;
    HttpHeaders(std::initializer_list<Field> fields);

    /// Overwrites a field of the same name, name included, in its place; or appends.
    void set(std::string name, std::string value);
    std::optional<std::string> value(std::string_view name) const;

    std::size_t size() const { return fields_.size(); }
    std::vector<Field>::const_iterator begin() const { return fields_.begin(); }
    std::vector<Field>::const_iterator end() const { return fields_.end(); }

  private:
    std::vector<Field> fields_;
};

}  // namespace ktr::platform
