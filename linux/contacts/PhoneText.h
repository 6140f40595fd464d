#pragma once

#include <string>
#include <string_view>

namespace ktr::linux_ {

/// Phone numbers as people write them, before any library has understood them. Stateless; any thread.
struct PhoneText {
    /// The number without the extension that follows it: what begins with ";", and up to seven digits at the end after
    /// a mark ("#", ",", "~") or a word in any language ("ext.", "x", "доб.", "poste", "内線", ...), if seven digits or
    /// more stand before it. Letters that are themselves digits ("1-800-EXAMPLE") stay.
    static std::string_view withoutExtension(std::string_view text);
    /// Decimal digits of every script as ASCII, letters as the keypad's digits (ITU-T E.161), all else dropped.
    static std::string digits(std::string_view text);
    /// Without the "tel:" of RFC 3966.
    static std::string_view withoutScheme(std::string_view text);
};

}  // namespace ktr::linux_
