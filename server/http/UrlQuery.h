#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace ktr::server {

/// The parameters of a query or of a form (application/x-www-form-urlencoded), unescaped, in their order. A value.
class UrlQuery {
  public:
    /// "+" is a blank, "%" and two digits a byte; a "%" without them stands for itself. Parameters without "=" have an
    /// empty value. At most 200 are read.
    static UrlQuery read(std::string_view text);

    /// The first of this name; none when there is none.
    std::optional<std::string> find(std::string_view name) const;
    const std::vector<std::pair<std::string, std::string>>& parameters() const { return parameters_; }

    static std::string unescaped(std::string_view text);

  private:
    std::vector<std::pair<std::string, std::string>> parameters_;
};

}  // namespace ktr::server
