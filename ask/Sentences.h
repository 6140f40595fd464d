#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "ask/Language.h"
#include "platform/base/Date.h"

namespace ktr::ask {

/// Words answers in one language: its patterns (ICU MessageFormat with named arguments), lists and times of day. Any
/// thread; keeps the language alive no longer than whoever made it.
class Sentences {
  public:
    using Arguments = std::map<std::string, std::string>;

    /// `language` outlives this. `secondsFromUtc`: of the asker's clock.
    Sentences(const Language& language, double secondsFromUtc) : language_(language), secondsFromUtc_(secondsFromUtc) {}

    /// The pattern of this key, filled. An argument that is not given reads as nothing.
    std::string text(const std::string& key, const Arguments& arguments = {}) const;
    /// "Ann, Otto and Zofia", or with "or".
    std::string list(const std::vector<std::string>& names, bool any = false) const;
    /// "17:42"; with the day where it is not that of `now`.
    std::string time(platform::Date moment, platform::Date now) const;
    const Language& language() const { return language_; }

  private:
    const Language& language_;
    const double secondsFromUtc_;
};

}  // namespace ktr::ask
