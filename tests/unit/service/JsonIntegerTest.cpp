#include "service/JsonInteger.h"

#include <gtest/gtest.h>

#include <limits>

namespace ktr {
namespace {

using platform::Value;

TEST(JsonIntegerTest, EveryKind) {
    constexpr auto kLeast = std::numeric_limits<std::int64_t>::min();
    constexpr auto kGreatest = std::numeric_limits<std::int64_t>::max();
    const std::pair<Value, std::int64_t> cases[] = {
        {Value(true), 1},
        {Value(false), 0},
        {Value(416), 416},
        {Value(std::int64_t{-5}), -5},
        {Value(411.9), 411},
        {Value(-411.9), -411},
        {Value(0.5), 0},
        {Value(1e300), kGreatest},
        {Value(-1e300), kLeast},
        {Value(std::numeric_limits<double>::quiet_NaN()), 0},
        {Value("411"), 411},
        {Value("-7"), -7},
        {Value("+7"), 7},
        {Value("0411"), 411},
        {Value("99999999999999999999"), kGreatest},
        {Value("-99999999999999999999"), kLeast},
        {Value("+-7"), 0},
        {Value("411 "), 0},
        {Value("4.11"), 0},
        {Value("-"), 0},
        {Value(""), 0},
        {Value("true"), 0},
        {Value(nullptr), 0},
        {Value(Value::Array{Value(411)}), 0},
        {Value(platform::Dictionary{{"status", 411}}), 0},
    };
    for (const auto& [value, number] : cases) {
        EXPECT_EQ(jsonInteger(&value), number) << value.description();
    }
    EXPECT_EQ(jsonInteger(nullptr), 0);
}

}  // namespace
}  // namespace ktr
