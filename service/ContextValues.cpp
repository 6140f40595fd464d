#include "service/ContextValues.h"

#include <algorithm>
#include <charconv>
#include <limits>

namespace ktr {

namespace {

constexpr std::string_view kBlanks = " \t\n\v\f\r";

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

std::string_view withoutLeadingBlanks(std::string_view text) {
    const auto begin = text.find_first_not_of(kBlanks);
    return begin == std::string_view::npos ? std::string_view() : text.substr(begin);
}

/// Takes a sign off the front; -1 for a minus, else 1.
double takeSign(std::string_view& text) {
    if (text.empty() || (text.front() != '+' && text.front() != '-')) {
        return 1.0;
    }
    const double sign = text.front() == '-' ? -1.0 : 1.0;
    text.remove_prefix(1);
    return sign;
}

/// What stands for a number that no double or float can hold, which is either too great or too near to 0: its order of
/// magnitude tells.
template <typename Number>
Number nearestToOutOfRange(std::string_view number) {
    const auto end = std::min(number.find_first_of("eE"), number.size());
    const std::string_view mantissa = number.substr(0, end);
    std::string_view exponentText = number.substr(std::min(end + 1, number.size()));
    const double sign = takeSign(exponentText);
    long exponent = 0;
    const auto read = std::from_chars(exponentText.data(), exponentText.data() + exponentText.size(), exponent);
    if (read.ec == std::errc::result_out_of_range) {
        exponent = std::numeric_limits<long>::max();
    }
    const auto point = std::min(mantissa.find('.'), mantissa.size());
    const auto first = std::min(mantissa.find_first_not_of("0."), mantissa.size());
    const double order = static_cast<double>(point) - static_cast<double>(first);
    return order + sign * static_cast<double>(exponent) > 0.0 ? std::numeric_limits<Number>::max() : Number{0};
}

template <typename Number>
Number leadingNumber(std::string_view text) {
    text = withoutLeadingBlanks(text);
    const auto sign = static_cast<Number>(takeSign(text));
    // "inf" and "nan" are no decimal numbers.
    const bool begins = !text.empty() && (isDigit(text[0]) || (text[0] == '.' && text.size() > 1 && isDigit(text[1])));
    if (!begins) {
        return Number{0};
    }
    Number number{0};
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number, std::chars_format::general);
    if (result.ec == std::errc::result_out_of_range) {
        number = nearestToOutOfRange<Number>(text.substr(0, static_cast<std::size_t>(result.ptr - text.data())));
    }
    return sign * number;
}

bool leadingTruth(std::string_view text) {
    text = withoutLeadingBlanks(text);
    takeSign(text);
    const auto first = text.find_first_not_of('0');
    return first != std::string_view::npos &&
           std::string_view("YyTt123456789").find(text[first]) != std::string_view::npos;
}

}  // namespace

double ContextValues::number(const platform::Dictionary& dictionary, std::string_view key) {
    const platform::Value* value = dictionary.find(key);
    if (value == nullptr) {
        return 0.0;
    }
    if (const std::string* text = value->string()) {
        return leadingNumber<double>(*text);
    }
    return value->number().value_or(value->boolean().value_or(false) ? 1.0 : 0.0);
}

float ContextValues::singleNumber(const platform::Dictionary& dictionary, std::string_view key) {
    const platform::Value* value = dictionary.find(key);
    if (const std::string* text = value != nullptr ? value->string() : nullptr) {
        return leadingNumber<float>(*text);
    }
    constexpr double kMost = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(number(dictionary, key), -kMost, kMost));
}

bool ContextValues::boolean(const platform::Dictionary& dictionary, std::string_view key) {
    const platform::Value* value = dictionary.find(key);
    const std::string* text = value != nullptr ? value->string() : nullptr;
    return text != nullptr ? leadingTruth(*text) : number(dictionary, key) != 0.0;
}

std::optional<std::string> ContextValues::text(const platform::Dictionary& dictionary, std::string_view key) {
    const platform::Value* value = dictionary.find(key);
    if (value == nullptr || (value->string() == nullptr && !value->isNumber())) {
        return std::nullopt;
    }
    return value->description();
}

}  // namespace ktr
