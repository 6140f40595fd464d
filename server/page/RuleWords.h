#pragma once

#include <string>

#include "server/page/PageData.h"

namespace ktr::server {

/// A rule in one line, as its owner reads it. Any thread.
class RuleWords {
  public:
    static std::string of(const PageRule& rule, const PageLanguage& language, std::int64_t now);
    static std::string of(Precision precision, const PageLanguage& language);
    static bool isOver(const PageRule& rule, std::int64_t now) { return rule.grant.end() <= now; }
    /// A rule that is over stays to be seen for a day.
    static bool isShown(const PageRule& rule, std::int64_t now) { return rule.grant.end() > now - 86400; }
    /// Whether it ends as the reader's day ends.
    static bool endsAtMidnight(const Grant& grant, const PageLanguage& language, std::int64_t now);
};

}  // namespace ktr::server
