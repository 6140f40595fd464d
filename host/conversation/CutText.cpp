#include "host/conversation/CutText.h"

namespace ktr::host {

std::string beginningOf(const std::string& text, std::size_t bytes) {
    if (text.size() <= bytes) {
        return text;
    }
    std::size_t end = bytes;
    while (end > 0 && (static_cast<unsigned char>(text[end]) & 0xC0u) == 0x80u) {
        --end;
    }
    return text.substr(0, end);
}

std::string cutText(const std::string& text, std::size_t bytes) {
    return text.size() <= bytes ? text : beginningOf(text, bytes) + "\u2026";
}

}  // namespace ktr::host
