#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "platform/base/Api.h"

namespace ktr::platform {

/// One decoded code point: how many bytes it took (at least 1 unless the text is at its end) and whether they were well
/// formed UTF-8 (RFC 3629: no overlong forms, no surrogates, at most U+10FFFF). Malformed bytes decode to U+FFFD.
struct Utf8Step {
    char32_t codePoint = 0;
    std::size_t length = 0;
    bool valid = false;
};

/// Decodes the code point that starts at `offset`.
KTR_API Utf8Step decodeUtf8(std::string_view text, std::size_t offset);
KTR_API bool isValidUtf8(std::string_view text);
/// The text with malformed bytes replaced by U+FFFD.
KTR_API std::string sanitizedUtf8(std::string_view text);
KTR_API void appendUtf8(std::string& out, char32_t codePoint);
/// ASCII letters in lower case, all other bytes as they stand.
KTR_API std::string asciiLowercased(std::string_view text);
/// The number of code points.
KTR_API std::size_t utf8Length(std::string_view text);

}  // namespace ktr::platform
