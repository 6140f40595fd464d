#include "platform/base/Format.h"

#include <array>
#include <charconv>
#include <cmath>

#include "platform/assistant/Localization.h"
#include "platform/base/FilledText.h"
#include "platform/base/Json.h"
#include "platform/base/Platform.h"
#include "platform/base/PluralRules.h"
#include "platform/base/PluralText.h"

namespace ktr::platform {

namespace {

constexpr std::string_view kToken = "authToken";
constexpr std::string_view kHidden = "<hidden>";

Value withoutToken(const Value& value);

Dictionary withoutToken(const Dictionary& dictionary) {
    Dictionary out;
    for (const auto& [key, element] : dictionary) {
        out.set(key, key == kToken ? Value(std::string(kHidden)) : withoutToken(element));
    }
    return out;
}

Value withoutToken(const Value& value) {
    if (const Dictionary* dictionary = value.dictionary()) {
        return withoutToken(*dictionary);
    }
    if (const Value::Array* array = value.array()) {
        Value::Array out;
        out.reserve(array->size());
        for (const Value& element : *array) {
            out.push_back(withoutToken(element));
        }
        return out;
    }
    return value;
}

/// Hides the value of every "authToken=" pair of a URL's text.
std::string withoutToken(const Url& url) {
    std::string text = url.text();
    const std::string pair = std::string(kToken) + "=";
    for (auto at = text.find(pair); at != std::string::npos; at = text.find(pair, at)) {
        const auto begin = at + pair.size();
        const auto end = text.find_first_of("&#", begin);
        text.replace(begin, end == std::string::npos ? std::string::npos : end - begin, kHidden);
        at = begin + kHidden.size();
    }
    return text;
}

std::string wholeText(double number) {
    if (!std::isfinite(number)) {
        return std::isnan(number) ? "nan" : number > 0 ? "inf" : "-inf";
    }
    std::array<char, 400> buffer{};
    const auto result =
        std::to_chars(buffer.data(), buffer.data() + buffer.size(), number, std::chars_format::fixed, 0);
    return std::string(buffer.data(), result.ptr);
}

/// A conversion found at the "%" of a format.
struct Conversion {
    enum class Kind { Unknown, Percent, Text, Whole, Real } kind = Kind::Unknown;
    std::size_t length = 1;
    /// One-based; 0 means the next argument in order.
    std::size_t position = 0;
};

Conversion conversionAt(std::string_view format) {
    std::size_t at = 1;
    std::size_t position = 0;
    std::size_t digits = at;
    while (digits < format.size() && digits < at + 3 && format[digits] >= '0' && format[digits] <= '9') {
        position = position * 10 + static_cast<std::size_t>(format[digits] - '0');
        ++digits;
    }
    if (digits > at && digits < format.size() && format[digits] == '$') {
        at = digits + 1;
    } else {
        position = 0;
    }
    const std::string_view rest = format.substr(at);
    const auto found = [&](Conversion::Kind kind, std::size_t length) {
        return Conversion{kind, at + length, position};
    };
    switch (rest.empty() ? '\0' : rest.front()) {
        case '%':
            return found(Conversion::Kind::Percent, 1);
        case '@':
            return found(Conversion::Kind::Text, 1);
        case 'i':
        case 'd':
            return found(Conversion::Kind::Whole, 1);
        default:
            break;
    }
    if (rest.starts_with("li")) {
        return found(Conversion::Kind::Whole, 2);
    }
    if (rest.starts_with("0.0f")) {
        return found(Conversion::Kind::Real, 4);
    }
    return {};
}

void appendArgument(const Conversion& conversion, const FormatArguments& arguments, std::size_t index, bool redact,
                    std::string& out) {
    if (index >= arguments.size()) {
        out += "(null)";
    } else if (redact && arguments[index].isPrivate()) {
        out += "<private>";
    } else if (conversion.kind == Conversion::Kind::Real) {
        out += wholeText(arguments[index].number());
    } else {
        out += arguments[index].text();
    }
}

/// Copies a format, and has each argument put where it is asked for: `append(conversion, index, out)`.
template <class Append>
std::string fill(std::string_view format, const Append& append) {
    std::string out;
    std::size_t next = 0;
    for (std::size_t at = 0; at < format.size();) {
        if (format[at] != '%') {
            const auto percent = std::min(format.find('%', at), format.size());
            out.append(format.substr(at, percent - at));
            at = percent;
            continue;
        }
        const Conversion conversion = conversionAt(format.substr(at));
        if (conversion.kind == Conversion::Kind::Unknown || conversion.kind == Conversion::Kind::Percent) {
            out.push_back('%');
        } else {
            append(conversion, conversion.position > 0 ? conversion.position - 1 : next++, out);
        }
        at += conversion.length;
    }
    return out;
}

/// The branch of a plural text that goes with the number in the first argument, by the rules of the texts' language.
/// A text that is not built as it should be stands as it is.
std::string_view branchFor(std::string_view text, const FormatArguments& arguments) {
    const auto platform = Platform::installed();
    std::string category = "other";
    if (platform && platform->pluralRules && platform->localization && !arguments.empty()) {
        category = platform->pluralRules->category(arguments.front().text(), platform->localization->languageOfTexts());
    }
    return PluralText::branch(text, category).value_or(text);
}

}  // namespace

FormatArgument::FormatArgument(const char* text)
    : text_(text != nullptr ? text : ""), isNone_(text == nullptr), isPrivate_(true) {}
FormatArgument::FormatArgument(const std::optional<std::string>& text)
    : text_(text.value_or("")), isNone_(!text), isPrivate_(true) {}
FormatArgument::FormatArgument(const Url& url) : text_(withoutToken(url)), isPrivate_(true) {}
FormatArgument::FormatArgument(const std::optional<Url>& url)
    : text_(url ? withoutToken(*url) : ""), isNone_(!url), isPrivate_(true) {}
FormatArgument::FormatArgument(const Value& value) : text_(withoutToken(value).description()), isPrivate_(true) {}
FormatArgument::FormatArgument(const Dictionary& dictionary)
    : text_(writeJson(withoutToken(dictionary))), isPrivate_(true) {}
FormatArgument::FormatArgument(const std::optional<Dictionary>& dictionary)
    : text_(dictionary ? writeJson(withoutToken(*dictionary)) : ""), isNone_(!dictionary), isPrivate_(true) {}
FormatArgument::FormatArgument(double number) : text_(writeJsonNumber(number)), number_(number) {}

std::string formatted(std::string_view format, const FormatArguments& arguments, bool redact) {
    if (PluralText::isPlural(format)) {
        format = branchFor(format, arguments);
    }
    return fill(format, [&](const Conversion& conversion, std::size_t index, std::string& out) {
        appendArgument(conversion, arguments, index, redact, out);
    });
}

std::string filled(std::string_view format, std::initializer_list<std::string_view> texts) {
    if (PluralText::isPlural(format)) {
        return formatted(format, FormatArguments(texts.begin(), texts.end()));
    }
    return fill(format, [&](const Conversion& conversion, std::size_t index, std::string& out) {
        if (index >= texts.size()) {
            out += "(null)";
        } else {
            // A text is no number.
            out += conversion.kind == Conversion::Kind::Real ? "0" : texts.begin()[index];
        }
    });
}

}  // namespace ktr::platform
