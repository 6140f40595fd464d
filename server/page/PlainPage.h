#pragma once

#include <string>

#include "server/page/PageLanguage.h"

namespace ktr::server {

/// Pages without anything of anybody on them: the one that a link opens, and those that say one thing. Any thread.
class PlainPage {
  public:
    /// Asks before the link is spent: a program that looks at links beforehand must not spend it.
    static std::string linkHtml(const PageLanguage& language, const std::string& link);
    static std::string signedOutHtml(const PageLanguage& language);
    /// A title of one sentence, one more below it if not empty, and the way to one's own page if wanted.
    static std::string sayingHtml(const PageLanguage& language, const std::string& title, const std::string& more,
                                  bool leadsBack);
};

}  // namespace ktr::server
