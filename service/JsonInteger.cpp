#include "service/JsonInteger.h"

#include <charconv>
#include <cmath>
#include <limits>
#include <string_view>

namespace ktr {

namespace {

constexpr auto kLeast = std::numeric_limits<std::int64_t>::min();
constexpr auto kGreatest = std::numeric_limits<std::int64_t>::max();

std::int64_t truncated(double number) {
    constexpr double kLimit = 9223372036854775808.0;  // 2^63
    if (std::isnan(number)) {
        return 0;
    }
    if (number >= kLimit) {
        return kGreatest;
    }
    return number < -kLimit ? kLeast : static_cast<std::int64_t>(number);
}

std::int64_t parsed(std::string_view text) {
    const bool negative = text.starts_with('-');
    const std::string_view digits = negative || text.starts_with('+') ? text.substr(1) : text;
    if (digits.empty() || digits.find_first_not_of("0123456789") != std::string_view::npos) {
        return 0;
    }
    const std::string_view number = negative ? text : digits;
    std::int64_t result = 0;
    if (std::from_chars(number.data(), number.data() + number.size(), result).ec == std::errc::result_out_of_range) {
        return negative ? kLeast : kGreatest;
    }
    return result;
}

}  // namespace

std::int64_t jsonInteger(const platform::Value* value) {
    if (value == nullptr) {
        return 0;
    }
    if (const auto flag = value->boolean()) {
        return *flag ? 1 : 0;
    }
    if (const auto whole = value->integer()) {
        return *whole;
    }
    if (const auto real = value->number()) {
        return truncated(*real);
    }
    return value->string() != nullptr ? parsed(*value->string()) : 0;
}

}  // namespace ktr
