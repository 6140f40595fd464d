#include "platform/base/Value.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::Value;

TEST(ValueTest, KindsAreToldApart) {
    EXPECT_EQ(Value().kind(), Value::Kind::Null);
    EXPECT_EQ(Value(nullptr).kind(), Value::Kind::Null);
    EXPECT_EQ(Value(true).kind(), Value::Kind::Bool);
    EXPECT_EQ(Value(1).kind(), Value::Kind::Integer);
    EXPECT_EQ(Value(1.0).kind(), Value::Kind::Real);
    EXPECT_EQ(Value("1").kind(), Value::Kind::String);
    EXPECT_EQ(Value(Value::Array{1, 2}).kind(), Value::Kind::Array);
    EXPECT_EQ(Value(Dictionary{{"a", 1}}).kind(), Value::Kind::Dictionary);
}

TEST(ValueTest, BooleanIsNoNumber) {
    EXPECT_FALSE(Value(true).isNumber());
    EXPECT_EQ(Value(true).number(), std::nullopt);
    EXPECT_EQ(Value(true).boolean(), true);
    EXPECT_EQ(Value(1).boolean(), std::nullopt);
}

TEST(ValueTest, NumberReadsIntegersAndReals) {
    EXPECT_EQ(Value(3).number(), 3.0);
    EXPECT_EQ(Value(3.5).number(), 3.5);
    EXPECT_EQ(Value(3).integer(), 3);
    EXPECT_EQ(Value(3.0).integer(), std::nullopt);
}

TEST(ValueTest, OtherKindsGiveNone) {
    const Value text("abc");
    ASSERT_NE(text.string(), nullptr);
    EXPECT_EQ(*text.string(), "abc");
    EXPECT_EQ(text.array(), nullptr);
    EXPECT_EQ(text.dictionary(), nullptr);
    EXPECT_EQ(text.number(), std::nullopt);
    EXPECT_EQ(Value(1).string(), nullptr);
}

TEST(ValueTest, DescriptionOfScalars) {
    EXPECT_EQ(Value(true).description(), "1");
    EXPECT_EQ(Value(false).description(), "0");
    EXPECT_EQ(Value(60000).description(), "60000");
    EXPECT_EQ(Value(std::int64_t{-9223372036854775807}).description(), "-9223372036854775807");
    EXPECT_EQ(Value(2500.0).description(), "2500");
    EXPECT_EQ(Value(0.1).description(), "0.1");
    EXPECT_EQ(Value(nullptr).description(), "<null>");
    EXPECT_EQ(Value("a \"b\"").description(), "a \"b\"");
}

TEST(ValueTest, DescriptionOfContainersIsCompactJson) {
    EXPECT_EQ(Value(Value::Array{1, true, "x", nullptr}).description(), R"([1,true,"x",null])");
    EXPECT_EQ(Value(Dictionary{{"b", 1}, {"a", 2.5}}).description(), R"({"b":1,"a":2.5})");
}

TEST(ValueTest, EqualityComparesKindAndContent) {
    EXPECT_EQ(Value(1), Value(1));
    EXPECT_FALSE(Value(1) == Value(1.0));
    EXPECT_FALSE(Value(1) == Value(true));
    EXPECT_FALSE(Value(std::nan("")) == Value(std::nan("")));
    EXPECT_EQ(Value(Value::Array{1, "a"}), Value(Value::Array{1, "a"}));
    EXPECT_FALSE(Value(Value::Array{1}) == Value(Value::Array{1, 2}));
    EXPECT_EQ(Value(Dictionary{{"a", 1}, {"b", 2}}), Value(Dictionary{{"b", 2}, {"a", 1}}));
}

TEST(ValueTest, CopiesShareTheirContainers) {
    const Value list(Value::Array{1, 2, 3});
    const Value copy = list;
    EXPECT_EQ(copy.array(), list.array());
}

}  // namespace
}  // namespace ktr::test
