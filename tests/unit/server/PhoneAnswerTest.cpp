#include "server/answers/PhoneAnswer.h"

#include <gtest/gtest.h>

#include <limits>

#include "platform/base/Json.h"

namespace ktr::test {

using platform::Dictionary;
using platform::Value;
using server::PhoneAnswer;
using server::PhoneFriend;
using server::Seen;
using server::SentCard;

class PhoneAnswerTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    static PhoneFriend ann() {
        PhoneFriend ann;
        ann.name = "Ann";
        ann.seen = Seen{50.2, -3.1, 12.2, kNow};
        return ann;
    }
    static std::string text(const std::vector<PhoneFriend>& friends) {
        return platform::writeJson(Value(PhoneAnswer::messages(friends)));
    }
};

TEST_F(PhoneAnswerTest, Card_CallsThemByTheirTitle_AndNeedsNoPlace) {
    PhoneFriend own = ann();
    own.seen = std::nullopt;
    EXPECT_EQ(text({own}), "[]");
    own.withCard = true;
    own.title = "Ann, seen by Otto";
    EXPECT_EQ(text({own}), R"([{"_type":"card","tid":"Ann","name":"Ann, seen by Otto"}])");
}

TEST_F(PhoneAnswerTest, Friend_IsAPlaceInWholeSecondsAndMetres) {
    EXPECT_EQ(text({ann()}), R"([{"_type":"location","tid":"Ann","lat":50.2,"lon":-3.1,"tst":1763760000,"acc":13}])");
    PhoneFriend unknown = ann();
    unknown.seen->accuracy = std::nullopt;
    EXPECT_EQ(text({unknown}).find("acc"), std::string::npos);
    EXPECT_EQ(text({}), "[]");
}

TEST_F(PhoneAnswerTest, Card_ComesBeforeThePlace_WithAFaceWhenThereIsOne) {
    PhoneFriend friend_ = ann();
    friend_.withCard = true;
    EXPECT_EQ(text({friend_}).rfind(R"([{"_type":"card","tid":"Ann","name":"Ann"},{"_type":"location")", 0), 0U);
    friend_.face = "ABC";
    EXPECT_EQ(text({friend_}).rfind(R"([{"_type":"card","tid":"Ann","name":"Ann","face":"QUJD"},)", 0), 0U);
    friend_.withCard = false;
    EXPECT_EQ(text({friend_}).find("card"), std::string::npos);
}

TEST_F(PhoneAnswerTest, WhatAPhoneWouldNotTake_IsLeftOut_AndCostsNothingElse) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    std::vector<PhoneFriend> friends(6, ann());
    friends[0].name = "";
    friends[1].seen->time = 0;
    friends[2].seen->latitude = 91.0;
    friends[3].seen->longitude = nan;
    friends[4].seen->latitude = nan;
    EXPECT_EQ(text(friends), text({ann()}));
}

TEST_F(PhoneAnswerTest, OnlyCardsAndLocations_AreSound) {
    for (const char* type : {"transition", "waypoint", "cmd", "", "status"}) {
        EXPECT_FALSE(PhoneAnswer::isSound(
            {{"_type", type}, {"tid", "Ann"}, {"name", "Ann"}, {"lat", 1.0}, {"lon", 2.0}, {"tst", kNow}}))
            << type;
    }
    EXPECT_FALSE(PhoneAnswer::isSound({{"_type", "card"}, {"tid", "Ann"}, {"name", "Ann"}, {"face", Value()}}));
    EXPECT_FALSE(PhoneAnswer::isSound({{"_type", "location"}, {"tid", "A"}, {"lat", 1}, {"lon", 2}, {"tst", 3.5}}));
}

TEST_F(PhoneAnswerTest, Card_IsDueWhenItChanged_OnceAWeek_AndForAPostThatComesAgain) {
    const std::string hash = PhoneAnswer::cardHash("Ann", "face");
    EXPECT_NE(hash, PhoneAnswer::cardHash("Ann", ""));
    EXPECT_NE(hash, PhoneAnswer::cardHash("Ann2", "face"));
    const SentCard sent{hash, kNow, 1763759990};
    EXPECT_TRUE(PhoneAnswer::isCardDue({}, hash, kNow, 0)) << "never told";
    EXPECT_FALSE(PhoneAnswer::isCardDue(sent, hash, kNow + 7 * 86400 - 1, 1763759995));
    EXPECT_TRUE(PhoneAnswer::isCardDue(sent, PhoneAnswer::cardHash("Ann", ""), kNow + 1, 1763759995));
    EXPECT_TRUE(PhoneAnswer::isCardDue(sent, hash, kNow + 7 * 86400, 1763759995));
    EXPECT_TRUE(PhoneAnswer::isCardDue(sent, hash, kNow - 7 * 86400, 1763759995)) << "the clock was ahead";
    EXPECT_TRUE(PhoneAnswer::isCardDue(sent, hash, kNow + 1, 1763759990)) << "the answer did not arrive";
    EXPECT_FALSE(PhoneAnswer::isCardDue({hash, kNow, 0}, hash, kNow + 1, 0)) << "without a fix nobody knows";
}

}  // namespace ktr::test
