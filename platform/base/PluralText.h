#pragma once

#include <optional>
#include <string_view>

#include "platform/base/Api.h"

namespace ktr::platform {

/// A text with a branch for each form that a number takes in its language:
///
///     {0, plural, one{%@ minute ago} other{%@ minutes ago}}
///
/// 0 is the first argument; nothing stands before or after; there is a branch "other"; a branch is a text as any other,
/// without braces, and need not show the number. Values only; any thread.
class KTR_API PluralText {
  public:
    static bool isPlural(std::string_view text) { return text.starts_with(kOpening); }
    /// The branch of a category, else the branch "other"; none for a text that is not built so.
    static std::optional<std::string_view> branch(std::string_view text, std::string_view category);

  private:
    static constexpr std::string_view kOpening = "{0, plural,";
};

}  // namespace ktr::platform
