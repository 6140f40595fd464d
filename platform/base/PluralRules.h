#pragma once

#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// How languages tell numbers apart: "1 minute" and "2 minutes", and up to six forms elsewhere. Any thread; answers
/// from memory once a language has been asked about.
class KTR_API PluralRules {
  public:
    virtual ~PluralRules();
    /// Which form goes with a number: "zero", "one", "two", "few", "many" or "other". The number is a text in the
    /// language's own style and digits, as it will be shown; "other" for a text that is no number and for a language
    /// without rules. `language` is BCP 47.
    virtual std::string category(const std::string& number, const std::string& language) const = 0;
};

}  // namespace ktr::platform
