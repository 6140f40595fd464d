#include "documents/JsonReader.h"

#include <gtest/gtest.h>

#include "platform/base/Json.h"

namespace ktr::documents {

namespace {

using platform::Value;

std::string errorOf(std::string_view text) {
    const auto read = JsonReader::read(text);
    const auto* error = std::get_if<JsonError>(&read);
    if (error == nullptr) {
        return "no error";
    }
    return std::to_string(error->position.line) + ":" + std::to_string(error->position.column) + " " +
           error->path.text() + " " + error->message;
}

TEST(KTRJsonReaderTest, Values_KeepTheirKindsAndOrder) {
    const auto read = JsonReader::read(R"({"b": true, "a": null, "i": -3, "r": 1.5, "whole": 2.0, "s": "é\u00e9\n",
        "list": [1, [2]], "empty": {}})");
    const auto* value = std::get_if<Value>(&read);
    ASSERT_NE(value, nullptr) << std::get<JsonError>(read).message;
    EXPECT_EQ(platform::writeJson(*value),
              R"({"b":true,"a":null,"i":-3,"r":1.5,"whole":2,"s":"éé\n","list":[1,[2]],"empty":{}})");
    EXPECT_EQ(value->dictionary()->find("i")->kind(), Value::Kind::Integer);
    EXPECT_EQ(value->dictionary()->find("whole")->kind(), Value::Kind::Real);
}

TEST(KTRJsonReaderTest, Integers_BeyondSixtyFourBitsBecomeReals) {
    const auto read = JsonReader::read("[9223372036854775807, 9223372036854775808, 123456789012345678901234567890]");
    const auto* value = std::get_if<Value>(&read);
    ASSERT_NE(value, nullptr);
    const auto& list = *value->array();
    EXPECT_EQ(list[0].integer(), INT64_MAX);
    EXPECT_EQ(list[1].kind(), Value::Kind::Real);
    EXPECT_DOUBLE_EQ(*list[2].number(), 123456789012345678901234567890.0);
}

TEST(KTRJsonReaderTest, BrokenText_IsToldWithItsPlace) {
    const std::pair<const char*, const char*> cases[] = {
        {"", "1:1 $ expected a JSON object, found nothing"},
        {" \n ", "2:2 $ expected a JSON object, found nothing"},
        {"3", "1:1 $ expected a JSON object"},
        {"{\"a\": \"b", "1:7 $ a string is not closed"},
        {"{\"a\": \"b\nc\"}", "1:9 $ a control character inside a string"},
        {"{\"a\": \"\\x\"}", "1:7 $.a a string with a broken escape"},
        {"{\"a\": \"\\ud800\"}", "1:7 $.a a string with a broken escape"},
        {"{\"a\": 01}", "1:7 $.a not a number as JSON writes it"},
        {"{\"a\": 1e999}", "1:7 $.a not a number as JSON writes it"},
        {"{\"a\": -}", "1:7 $.a not a number as JSON writes it"},
        {"{\"a\": 1} x", "1:10 $ text after the end of the JSON value"},
        {"{\"a\": 1}}", "1:9 $ text after the end of the JSON value"},
        {"{\n \"a\": 1,\n \"a\": 2}", "3:2 $.a this member is there already"},
        {"{\"é\": \"\xff\"}", "1:8 $ the text is not UTF-8"},
        {"{\"a\": [1, 2", "1:12 $.a[1] the text ends before its arrays and objects are closed"},
    };
    for (const auto& [text, expected] : cases) {
        EXPECT_EQ(errorOf(text), expected) << text;
    }
}

TEST(KTRJsonReaderTest, Malformed_IsRefused) {
    for (const char* text :
         {"{\"a\": 1,}", "[1,]", "[1 2]", "{\"a\" 1}", "{'a': 1}", "{\"a\": 1 /* */}", "{\"a\": tru}", "{\"a\": nulll}",
          "{\"a\": NaN}", "{1: 2}", "[", "]", "{", "}", "[}", "{]", ":", ",", "\"x\""}) {
        EXPECT_NE(errorOf(text), "no error") << text;
    }
}

TEST(KTRJsonReaderTest, Truncated_AtEveryByteIsRefused) {
    const std::string whole = R"({"a": [1, {"b": "é\"\\", "c": -1.5e3}], "d": null})";
    ASSERT_EQ(errorOf(whole), "no error");
    for (std::size_t length = 0; length < whole.size(); ++length) {
        EXPECT_NE(errorOf(std::string_view(whole).substr(0, length)), "no error") << length;
    }
}

TEST(KTRJsonReaderTest, Nesting_EndsAtSixtyFour) {
    const auto nested = [](std::size_t depth) { return std::string(depth, '[') + std::string(depth, ']'); };
    EXPECT_EQ(errorOf(nested(kDeepestJson)), "no error");
    EXPECT_NE(errorOf(nested(kDeepestJson + 1)).find("1:65 "), std::string::npos);
    EXPECT_NE(errorOf(std::string(1'000'000, '[')).find("nested more than 64"), std::string::npos);
}

TEST(KTRJsonReaderTest, Size_EndsAtSixtyFourMebibytes) {
    std::string text = "{}";
    text.resize(kLargestJson + 1, ' ');
    EXPECT_NE(errorOf(text).find("larger than 64 MiB"), std::string::npos);
}

TEST(KTRJsonReaderTest, Locate_FindsValuesByPath) {
    const std::string text = "{\n  \"é\": {\"list\": [1,\n    {\"x\": true}]}\n}";
    const JsonPath x = JsonPath().member("é").member("list").element(1).member("x");
    EXPECT_EQ(JsonReader::locate(text, x), (JsonPosition{3, 11}));
    EXPECT_EQ(JsonReader::locate(text, {}), (JsonPosition{1, 1}));
    EXPECT_EQ(JsonReader::locate(text, JsonPath().member("nothing")), (JsonPosition{1, 1}));
}

TEST(KTRJsonReaderTest, Path_QuotesWhatIsNoIdentifierAndShortensLongNames) {
    EXPECT_EQ(JsonPath().member("a").element(2).member("b c").text(), "$.a[2][\"b c\"]");
    EXPECT_LT(JsonPath().member(std::string(100'000, 'x')).text().size(), 100u);
}

}  // namespace

}  // namespace ktr::documents
