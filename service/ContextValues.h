#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/base/Value.h"

namespace ktr {

/// Reads members of a context dictionary, whose values are integers or strings. Stateless; any thread.
class ContextValues {
  public:
    /// A number as it is, or the decimal number that a string begins with (blanks before it are skipped; beyond the
    /// range of a double: the nearest finite one); else 0.
    static double number(const platform::Dictionary& dictionary, std::string_view key);
    /// The same in single precision: rounded once, not from a double.
    static float singleNumber(const platform::Dictionary& dictionary, std::string_view key);
    /// Whether a number is not 0, or a string's first character after blanks, a sign and zeros is one of YyTt1-9; else
    /// false.
    static bool boolean(const platform::Dictionary& dictionary, std::string_view key);
    /// A string as it stands; a number in decimal, so that a text of digits alone reads as what it decoded to,
    /// saturated to 32 bits; else none.
    static std::optional<std::string> text(const platform::Dictionary& dictionary, std::string_view key);
};

}  // namespace ktr
