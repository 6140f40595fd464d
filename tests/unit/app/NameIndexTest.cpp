#include "app/search/NameIndex.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ktr::test {

using app::NameIndex;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class NameIndexTest : public ::testing::Test {
  protected:
    static ask::Person person(const std::string& first, const std::string& last, const std::string& email,
                              const std::string& nickname = "") {
        ask::Person person;
        person.firstName = first;
        person.lastName = last;
        person.fullName = last.empty() ? first : first + " " + last;
        person.nickname = nickname;
        if (!email.empty()) {
            person.emails = {email};
        }
        return person;
    }
    /// Names of who is found; in brackets who is only begun.
    std::vector<std::string> found(const std::string& text, std::size_t most = 10) const {
        std::vector<std::string> names;
        for (const auto& match : index.find(text, most)) {
            names.push_back(match.isWhole ? match.person->shownName() : "(" + match.person->shownName() + ")");
        }
        return names;
    }

    const NameIndex index{std::make_shared<const ask::People>(std::vector<ask::Person>{
        person("Ann", "Marsh", "ann@x.example", "Spark"), person("Anna", "Lee", "anna@x.example"),
        person("Zoë Maria", "Nowak", "zoe@x.example"), person("健", "佐藤", "ken@x.example"),
        person("Ann", "Hidden", ""), person("Max", "Weber", "max1@x.example"), person("Max", "Weber", "max2@x.example"),
        person("Otto", "", "otto@x.example")})};
};

TEST_F(NameIndexTest, AnyWordOfAName_IsFoundByItsBeginning) {
    EXPECT_THAT(found("an"), ElementsAre("(Ann Marsh)", "(Anna Lee)"));
    EXPECT_THAT(found("mars"), ElementsAre("(Ann Marsh)"));
    EXPECT_THAT(found("MARIA"), ElementsAre("(Zoë Maria Nowak)"));
    EXPECT_THAT(found("zoe m"), ElementsAre("(Zoë Maria Nowak)"));
    EXPECT_THAT(found("佐"), ElementsAre("(健 佐藤)"));
    EXPECT_THAT(found("xyz"), IsEmpty());
    EXPECT_THAT(found(""), IsEmpty());
    EXPECT_THAT(found("?!"), IsEmpty());
}

TEST_F(NameIndexTest, WholeName_IsAllOfIt) {
    EXPECT_THAT(found("Ann Marsh"), ElementsAre("Ann Marsh"));
    EXPECT_THAT(found("marsh, ann"), ElementsAre("Ann Marsh"));
    EXPECT_THAT(found("spark"), ElementsAre("Ann Marsh"));
    EXPECT_THAT(found("ann@x.example"), ElementsAre("Ann Marsh"));
    EXPECT_THAT(found("otto"), ElementsAre("Otto"));
    EXPECT_THAT(found("ann"), ElementsAre("(Ann Marsh)", "(Anna Lee)")) << "a first name begins the whole one";
    EXPECT_THAT(found("nowak"), ElementsAre("(Zoë Maria Nowak)"));
    EXPECT_THAT(found("max weber"), ElementsAre("Max Weber", "Max Weber"));
}

TEST_F(NameIndexTest, WhoHasNoHandle_IsNotFound) {
    EXPECT_THAT(found("ann hidden"), IsEmpty());
    EXPECT_EQ(index.withHandle(""), nullptr);
    EXPECT_EQ(index.withHandle("nobody@x.example"), nullptr);
    ASSERT_NE(index.withHandle("anna@x.example"), nullptr);
    EXPECT_EQ(index.withHandle("anna@x.example")->shownName(), "Anna Lee");
}

TEST_F(NameIndexTest, MoreThanAsked_AreLeftOut) {
    EXPECT_THAT(found("max", 1), ElementsAre("(Max Weber)"));
    EXPECT_THAT(found("max weber", 1), ElementsAre("Max Weber"));
}

}  // namespace ktr::test
