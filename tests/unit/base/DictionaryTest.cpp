#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "platform/base/Value.h"

namespace ktr::test {
namespace {

using platform::Dictionary;

std::vector<std::string> keysOf(const Dictionary& dictionary) {
    std::vector<std::string> keys;
    for (const auto& entry : dictionary) {
        keys.push_back(entry.first);
    }
    return keys;
}

TEST(DictionaryTest, AbsentNullAndPresentAreToldApart) {
    const Dictionary dictionary{{"null", nullptr}, {"text", "x"}};
    EXPECT_EQ(dictionary.find("absent"), nullptr);
    ASSERT_NE(dictionary.find("null"), nullptr);
    EXPECT_TRUE(dictionary.find("null")->isNull());
    EXPECT_TRUE(dictionary.contains("text"));
    EXPECT_FALSE(dictionary.contains("absent"));
}

TEST(DictionaryTest, KeepsTheOrderOfInsertion) {
    Dictionary dictionary{{"z", 1}, {"a", 2}};
    dictionary.set("m", 3);
    EXPECT_EQ(keysOf(dictionary), (std::vector<std::string>{"z", "a", "m"}));
}

TEST(DictionaryTest, OverwritingKeepsThePlace) {
    Dictionary dictionary{{"z", 1}, {"a", 2}};
    dictionary.set("z", 9);
    EXPECT_EQ(keysOf(dictionary), (std::vector<std::string>{"z", "a"}));
    EXPECT_EQ(dictionary.find("z")->integer(), 9);
}

TEST(DictionaryTest, RemovingAnAbsentKeyDoesNothing) {
    Dictionary dictionary{{"a", 1}};
    dictionary.remove("b");
    EXPECT_EQ(dictionary.size(), 1U);
    dictionary.remove("a");
    EXPECT_TRUE(dictionary.empty());
}

TEST(DictionaryTest, FindsEverythingAlsoWhenItIsLarge) {
    Dictionary dictionary;
    constexpr int kCount = 200;
    for (int i = 0; i < kCount; ++i) {
        dictionary.set("key" + std::to_string(i), i);
    }
    dictionary.set("key150", "changed");
    dictionary.remove("key3");
    EXPECT_EQ(dictionary.size(), 199U);
    EXPECT_EQ(dictionary.find("key3"), nullptr);
    EXPECT_EQ(*dictionary.find("key150")->string(), "changed");
    for (int i = 4; i < kCount; ++i) {
        ASSERT_TRUE(dictionary.contains("key" + std::to_string(i))) << i;
    }
    for (int i = 4; i < kCount; ++i) {
        dictionary.remove("key" + std::to_string(i));
    }
    EXPECT_EQ(keysOf(dictionary), (std::vector<std::string>{"key0", "key1", "key2"}));
    EXPECT_EQ(dictionary.find("key2")->integer(), 2);
}

TEST(DictionaryTest, EqualityIgnoresTheOrder) {
    EXPECT_TRUE((Dictionary{{"a", 1}, {"b", 2}}) == (Dictionary{{"b", 2}, {"a", 1}}));
    EXPECT_FALSE((Dictionary{{"a", 1}}) == (Dictionary{{"a", 2}}));
    EXPECT_FALSE((Dictionary{{"a", 1}}) == (Dictionary{{"b", 1}}));
    EXPECT_FALSE((Dictionary{{"a", nullptr}}) == (Dictionary{}));
}

}  // namespace
}  // namespace ktr::test
