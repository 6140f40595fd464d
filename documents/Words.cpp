#include "documents/Words.h"

#include "platform/base/Utf8.h"

namespace ktr::documents {

namespace {

constexpr char32_t kFirstStrongIsolate = 0x2068;
constexpr char32_t kPopIsolate = 0x2069;

bool isControl(char32_t c) {
    return c < 0x20 || (c >= 0x7F && c < 0xA0) || c == 0x2028 || c == 0x2029;
}

/// Embeddings and overrides: what follows them to the line's end may be turned around.
bool isOverride(char32_t c) {
    return c >= 0x202A && c <= 0x202E;
}

bool isIsolate(char32_t c) {
    return c >= 0x2066 && c <= 0x2069;
}

bool isMark(char32_t c) {
    return c == 0x061C || c == 0x200E || c == 0x200F;
}

/// Letters of scripts that are written from right to left, by their blocks.
bool isRightToLeft(char32_t c) {
    return (c >= 0x0590 && c <= 0x08FF) || (c >= 0xFB1D && c <= 0xFDFF) || (c >= 0xFE70 && c <= 0xFEFF) ||
           (c >= 0x10800 && c <= 0x10FFF) || (c >= 0x1E800 && c <= 0x1EFFF);
}

void appendEscape(std::string& out, char32_t c) {
    constexpr std::string_view kDigits = "0123456789abcdef";
    if (c == '\n' || c == '\r' || c == '\t') {
        out += c == '\n' ? "\\n" : c == '\r' ? "\\r" : "\\t";
        return;
    }
    out += c < 0x80 ? "\\x" : "\\u";
    for (int shift = c < 0x80 ? 4 : 12; shift >= 0; shift -= 4) {
        out += kDigits[(c >> static_cast<unsigned>(shift)) & 0xFU];
    }
}

/// Appends the escaped text; `quoted` escapes what would end the quotes or an isolate, too.
void appendEscaped(std::string& out, std::string_view text, std::size_t longest, bool quoted) {
    for (std::size_t at = 0; at < text.size();) {
        if (at >= longest) {
            out += "…";
            return;
        }
        const platform::Utf8Step step = platform::decodeUtf8(text, at);
        const char32_t c = step.codePoint;
        const bool isOwnIsolate = !quoted && (c == kFirstStrongIsolate || c == kPopIsolate);
        if (isControl(c) || isOverride(c) || isMark(c) || (isIsolate(c) && !isOwnIsolate)) {
            appendEscape(out, c);
        } else {
            if (quoted && (c == '"' || c == '\\')) {
                out += '\\';
            }
            platform::appendUtf8(out, c);
        }
        at += step.length;
    }
}

bool runsRightToLeft(std::string_view text, std::size_t longest) {
    for (std::size_t at = 0; at < text.size() && at < longest;) {
        const platform::Utf8Step step = platform::decodeUtf8(text, at);
        if (isRightToLeft(step.codePoint)) {
            return true;
        }
        at += step.length;
    }
    return false;
}

}  // namespace

std::string forLine(std::string_view text, std::size_t longest) {
    std::string out;
    appendEscaped(out, text, longest, false);
    return out;
}

std::string inQuotes(std::string_view text, std::size_t longest) {
    const bool isolated = runsRightToLeft(text, longest);
    std::string out;
    if (isolated) {
        platform::appendUtf8(out, kFirstStrongIsolate);
    }
    out += '"';
    appendEscaped(out, text, longest, true);
    out += '"';
    if (isolated) {
        platform::appendUtf8(out, kPopIsolate);
    }
    return out;
}

std::string withoutControls(std::string_view text) {
    std::string out;
    for (std::size_t at = 0; at < text.size();) {
        const platform::Utf8Step step = platform::decodeUtf8(text, at);
        if (isControl(step.codePoint) || isOverride(step.codePoint)) {
            out += ' ';
        } else {
            platform::appendUtf8(out, step.codePoint);
        }
        at += step.length;
    }
    return out;
}

std::string asShellWord(std::string_view text) {
    std::string word = "'";
    for (const char c : withoutControls(text)) {
        word += c == '\'' ? std::string("'\\''") : std::string(1, c);
    }
    return word + "'";
}

std::string jsonForTerminal(std::string_view json) {
    std::string out;
    for (std::size_t at = 0; at < json.size();) {
        const platform::Utf8Step step = platform::decodeUtf8(json, at);
        const char32_t c = step.codePoint;
        if (c == 0x7F) {
            out += "\\u007f";
        } else if (c > 0x7F && (isControl(c) || isOverride(c) || isMark(c) || isIsolate(c))) {
            appendEscape(out, c);
        } else {
            platform::appendUtf8(out, c);
        }
        at += step.length;
    }
    return out;
}

}  // namespace ktr::documents
