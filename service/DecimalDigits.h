#pragma once

namespace ktr {

/// Whether the code point is a decimal digit of any script (Unicode 14, general category Nd). Any thread.
bool isDecimalDigit(char32_t codePoint);

}  // namespace ktr
