#include "linux/contacts/PhoneText.h"

#include <algorithm>
#include <cstddef>
#include <vector>

#include <unicode/uchar.h>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

/// No number is shorter than what an extension may follow.
constexpr int kLeastBefore = 7;
constexpr int kMostDigits = 7;
/// Far longer than any number is written; what is longer has no extension to look for.
constexpr std::size_t kLongest = 250;

struct Letter {
    UChar32 point = 0;
    std::size_t at = 0;
};

std::vector<Letter> lettersOf(std::string_view text) {
    std::vector<Letter> letters;
    for (std::size_t at = 0; at < text.size();) {
        const auto step = platform::decodeUtf8(text, at);
        letters.push_back({static_cast<UChar32>(step.codePoint), at});
        at += step.length;
    }
    return letters;
}

bool isDigit(const Letter& letter) {
    return u_charDigitValue(letter.point) >= 0;
}

/// What stands between a number, a word for its extension and the extension.
bool isBetween(const Letter& letter) {
    constexpr std::string_view kMarks = ".:()";
    return u_isUWhiteSpace(letter.point) ||
           (letter.point < 0x80 && kMarks.find(static_cast<char>(letter.point)) != std::string_view::npos);
}

bool isMark(const Letter& letter) {
    constexpr std::string_view kMarks = "#,~";
    return letter.point < 0x80 && kMarks.find(static_cast<char>(letter.point)) != std::string_view::npos;
}

}  // namespace

std::string_view PhoneText::withoutExtension(std::string_view text) {
    text = text.substr(0, text.find(';'));
    if (text.size() > kLongest) {
        return text;
    }
    const std::vector<Letter> letters = lettersOf(text);
    std::size_t end = letters.size();
    const auto skip = [&](auto is) {
        const std::size_t from = end;
        while (end > 0 && is(letters[end - 1])) {
            --end;
        }
        return static_cast<int>(from - end);
    };
    skip(isBetween);
    const int extension = skip(isDigit);
    if (extension == 0 || extension > kMostDigits) {
        return text;
    }
    skip(isBetween);
    int words = skip(isMark);
    std::size_t number = end;
    while (skip([](const Letter& letter) { return u_isalpha(letter.point) != 0; }) > 0) {
        ++words;
        number = end;
        skip(isBetween);
    }
    const auto digits = std::count_if(letters.begin(), letters.begin() + static_cast<std::ptrdiff_t>(number), isDigit);
    return words > 0 && digits >= kLeastBefore && number < letters.size() ? text.substr(0, letters[number].at) : text;
}

std::string PhoneText::digits(std::string_view text) {
    constexpr std::string_view keypad = "22233344455566677778889999";
    std::string out;
    for (const Letter& letter : lettersOf(text)) {
        const UChar32 c = letter.point;
        if (const int digit = u_charDigitValue(c); digit >= 0) {
            out += static_cast<char>('0' + digit);
        } else if (c >= 'a' && c <= 'z') {
            out += keypad[static_cast<std::size_t>(c - 'a')];
        } else if (c >= 'A' && c <= 'Z') {
            out += keypad[static_cast<std::size_t>(c - 'A')];
        }
    }
    return out;
}

std::string_view PhoneText::withoutScheme(std::string_view text) {
    constexpr std::string_view kScheme = "tel:";
    const bool has = platform::asciiLowercased(text.substr(0, kScheme.size())) == kScheme;
    return has ? text.substr(kScheme.size()) : text;
}

}  // namespace ktr::linux_
