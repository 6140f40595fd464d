#include "platform/base/Json.h"

#include <array>
#include <charconv>
#include <cmath>

#include "platform/base/Utf8.h"

namespace ktr::platform {

namespace {

void append(std::string& out, const Value& value);

void appendString(std::string& out, std::string_view text) {
    static constexpr std::string_view kHex = "0123456789abcdef";
    out.push_back('"');
    for (std::size_t at = 0; at < text.size();) {
        const Utf8Step step = decodeUtf8(text, at);
        const char32_t c = step.codePoint;
        if (c == '"' || c == '\\') {
            out.push_back('\\');
            out.push_back(static_cast<char>(c));
        } else if (c == '\n') {
            out += "\\n";
        } else if (c == '\t') {
            out += "\\t";
        } else if (c == '\r') {
            out += "\\r";
        } else if (c < 0x20) {
            out += "\\u00";
            out.push_back(kHex[c >> 4]);
            out.push_back(kHex[c & 0xF]);
        } else {
            appendUtf8(out, c);
        }
        at += step.length;
    }
    out.push_back('"');
}

void appendArray(std::string& out, const Value::Array& array) {
    out.push_back('[');
    bool first = true;
    for (const Value& element : array) {
        if (!first) {
            out.push_back(',');
        }
        first = false;
        append(out, element);
    }
    out.push_back(']');
}

void appendDictionary(std::string& out, const Dictionary& dictionary) {
    out.push_back('{');
    bool first = true;
    for (const auto& [key, element] : dictionary) {
        if (!first) {
            out.push_back(',');
        }
        first = false;
        appendString(out, key);
        out.push_back(':');
        append(out, element);
    }
    out.push_back('}');
}

void append(std::string& out, const Value& value) {
    switch (value.kind()) {
        case Value::Kind::Null:
            out += "null";
            break;
        case Value::Kind::Bool:
            out += *value.boolean() ? "true" : "false";
            break;
        case Value::Kind::Integer:
            out += std::to_string(*value.integer());
            break;
        case Value::Kind::Real:
            out += writeJsonNumber(*value.number());
            break;
        case Value::Kind::String:
            appendString(out, *value.string());
            break;
        case Value::Kind::Array:
            appendArray(out, *value.array());
            break;
        case Value::Kind::Dictionary:
            appendDictionary(out, *value.dictionary());
            break;
    }
}

}  // namespace

std::string writeJson(const Value& value) {
    std::string out;
    append(out, value);
    return out;
}

std::string writeJsonString(std::string_view text) {
    std::string out;
    appendString(out, text);
    return out;
}

std::string writeJsonNumber(double number) {
    if (!std::isfinite(number)) {
        return "null";
    }
    std::array<char, 64> buffer{};
    const bool whole = std::trunc(number) == number && std::fabs(number) < 1e17;
    const auto result =
        whole ? std::to_chars(buffer.data(), buffer.data() + buffer.size(), number, std::chars_format::fixed)
              : std::to_chars(buffer.data(), buffer.data() + buffer.size(), number);
    return std::string(buffer.data(), result.ptr);
}

}  // namespace ktr::platform
