#pragma once

#include <optional>
#include <utility>
#include <vector>

#include "server/http/UrlQuery.h"
#include "server/page/PageData.h"

namespace ktr::server {

/// What somebody chose on the page about a rule. Any thread.
class RuleForm {
  public:
    /// The grant, from now on; else none, and the key of the text that says what is missing. `before`: the rule as it
    /// was. An end that is shown by its time of day and was not changed stays what it was, days ahead, too.
    static std::pair<std::optional<Grant>, const char*> read(const UrlQuery& form, const PageContext& context,
                                                             const std::vector<NamedPlace>& places,
                                                             const std::optional<Grant>& before);
};

}  // namespace ktr::server
