#include "platform/base/Utf8.h"

namespace ktr::platform {

namespace {

constexpr char32_t kReplacement = 0xFFFD;

struct Lead {
    std::size_t length;
    char32_t bits;
    char32_t smallest;
};

Lead leadOf(unsigned char byte) {
    if (byte < 0x80) {
        return {1, byte, 0};
    }
    if (byte >= 0xC2 && byte <= 0xDF) {
        return {2, static_cast<char32_t>(byte & 0x1F), 0x80};
    }
    if (byte >= 0xE0 && byte <= 0xEF) {
        return {3, static_cast<char32_t>(byte & 0x0F), 0x800};
    }
    if (byte >= 0xF0 && byte <= 0xF4) {
        return {4, static_cast<char32_t>(byte & 0x07), 0x10000};
    }
    return {0, 0, 0};
}

}  // namespace

Utf8Step decodeUtf8(std::string_view text, std::size_t offset) {
    if (offset >= text.size()) {
        return {};
    }
    const Lead lead = leadOf(static_cast<unsigned char>(text[offset]));
    if (lead.length == 0 || offset + lead.length > text.size()) {
        return {kReplacement, 1, false};
    }
    char32_t point = lead.bits;
    for (std::size_t i = 1; i < lead.length; ++i) {
        const auto byte = static_cast<unsigned char>(text[offset + i]);
        if ((byte & 0xC0) != 0x80) {
            return {kReplacement, 1, false};
        }
        point = (point << 6) | (byte & 0x3F);
    }
    if (point < lead.smallest || point > 0x10FFFF || (point >= 0xD800 && point <= 0xDFFF)) {
        return {kReplacement, 1, false};
    }
    return {point, lead.length, true};
}

bool isValidUtf8(std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const Utf8Step step = decodeUtf8(text, at);
        if (!step.valid) {
            return false;
        }
        at += step.length;
    }
    return true;
}

std::string sanitizedUtf8(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const Utf8Step step = decodeUtf8(text, at);
        appendUtf8(out, step.codePoint);
        at += step.length;
    }
    return out;
}

void appendUtf8(std::string& out, char32_t point) {
    const auto put = [&out](char32_t byte) { out.push_back(static_cast<char>(static_cast<unsigned char>(byte))); };
    if (point < 0x80) {
        put(point);
    } else if (point < 0x800) {
        put(0xC0 | (point >> 6));
        put(0x80 | (point & 0x3F));
    } else if (point < 0x10000) {
        put(0xE0 | (point >> 12));
        put(0x80 | ((point >> 6) & 0x3F));
        put(0x80 | (point & 0x3F));
    } else {
        put(0xF0 | (point >> 18));
        put(0x80 | ((point >> 12) & 0x3F));
        put(0x80 | ((point >> 6) & 0x3F));
        put(0x80 | (point & 0x3F));
    }
}

std::string asciiLowercased(std::string_view text) {
    std::string out(text);
    for (char& c : out) {
        if (c >= 'A' && c <= 'Z') {
            c = static_cast<char>(c - 'A' + 'a');
        }
    }
    return out;
}

std::size_t utf8Length(std::string_view text) {
    std::size_t count = 0;
    for (std::size_t at = 0; at < text.size(); ++count) {
        at += decodeUtf8(text, at).length;
    }
    return count;
}

}  // namespace ktr::platform
