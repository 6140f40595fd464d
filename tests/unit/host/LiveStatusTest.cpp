#include "host/live/LiveStatus.h"

#include <gtest/gtest.h>

namespace ktr::test {

using host::LiveStatus;
using platform::Date;
using Trouble = host::ServiceWatch::Trouble;

class LiveStatusTest : public ::testing::Test {
  protected:
    LiveStatusTest() {
        facts.ready = true;
        facts.signedIn = true;
        facts.shown = Date{100.0};
        facts.wasAsked = true;
        facts.now = Date{105.0};
    }
    std::string words() const { return status().words; }
    LiveStatus status() const {
        return LiveStatus::of(facts,
                              {[](const std::string& key) { return key; }, [](Date) { return std::string("17:42"); },
                               [](std::int64_t number) { return std::to_string(number); }});
    }
    LiveStatus::Facts facts;
};

TEST_F(LiveStatusTest, AnswerOnScreen_IsLive) {
    EXPECT_EQ(status(), (LiveStatus{LiveStatus::Mark::Live, "STATUS_LIVE_NOW"}));
}

TEST_F(LiveStatusTest, Numbers_StandInTheLanguagesDigits) {
    facts.now = Date{100.0 + 5.0 * 60.0};
    const LiveStatus::Words arabic{[](const std::string&) { return "قبل %@ دقائق"; }, [](Date) { return ""; },
                                   [](std::int64_t number) { return number == 5 ? "٥" : "?"; }};
    EXPECT_EQ(LiveStatus::of(facts, arabic).words, "قبل ٥ دقائق");
}

TEST_F(LiveStatusTest, HiddenUser_IsSaidInsteadOfHowLiveTheAnswerIs) {
    facts.hidden = true;
    EXPECT_EQ(status(), (LiveStatus{LiveStatus::Mark::Hidden, "STATUS_HIDDEN"}));
    facts.now = Date{100000.0};
    EXPECT_EQ(words(), "STATUS_HIDDEN") << "that does not grow old";
}

TEST_F(LiveStatusTest, TroubleGoesBeforeHiding) {
    facts.hidden = true;
    facts.assistant = Trouble::Unreachable;
    EXPECT_EQ(status().mark, LiveStatus::Mark::Warning);
    facts.signedIn = false;
    facts.hasAccount = true;
    EXPECT_EQ(words(), "STATUS_SIGN_IN");
    EXPECT_TRUE(status().wantsSignIn);
}

TEST_F(LiveStatusTest, EachTrouble_HasWhatMendsIt_AndNothingElseHas) {
    using Help = LiveStatus::Help;
    EXPECT_EQ(status().help, Help::None);
    facts.assistant = Trouble::Unreachable;
    EXPECT_EQ(status().help, Help::TryNow);
    facts.assistant = Trouble::Faulty;
    EXPECT_EQ(status().help, Help::CheckUp);
    facts.assistant = Trouble::Untrusted;
    EXPECT_EQ(status().help, Help::CheckUp);
    facts.unusable = true;
    EXPECT_EQ(status().help, Help::CheckUp);
    facts.unusable = false;
    facts.assistant = Trouble::SignedOut;
    EXPECT_EQ(status().help, Help::None) << "the page for signing in is there";
}

TEST_F(LiveStatusTest, WhoWasNeverSignedIn_IsNotToldToDoItAgain) {
    facts.signedIn = false;
    EXPECT_EQ(words(), "STATUS_SIGN_IN_FIRST");
    EXPECT_TRUE(status().wantsSignIn);
    facts.signedIn = true;
    EXPECT_FALSE(status().wantsSignIn);
}

TEST_F(LiveStatusTest, EachTroubleHasItsOwnWords) {
    for (const auto& [trouble, key] :
         {std::pair(Trouble::Unreachable, "STATUS_OFFLINE"), std::pair(Trouble::Untrusted, "STATUS_UNTRUSTED"),
          std::pair(Trouble::Faulty, "STATUS_FAULTY")}) {
        for (const bool isAssistants : {false, true}) {
            facts.service.trouble = isAssistants ? Trouble::None : trouble;
            facts.assistant = isAssistants ? trouble : Trouble::None;
            facts.shown = Date{100.0};
            EXPECT_EQ(words(), std::string(key) + "_SINCE");
            EXPECT_EQ(status().mark, LiveStatus::Mark::Warning);
            facts.shown.reset();
            EXPECT_EQ(words(), key);
            EXPECT_EQ(status().mark, LiveStatus::Mark::Warning);
        }
    }
}

TEST_F(LiveStatusTest, CredentialsThatAreRefused_AreSaid_WhoeverRefusesThem) {
    facts.service.trouble = Trouble::SignedOut;
    EXPECT_EQ(words(), "STATUS_SIGN_IN");
    facts.service.trouble = Trouble::None;
    facts.assistant = Trouble::SignedOut;
    EXPECT_EQ(words(), "STATUS_SIGN_IN");
}

TEST_F(LiveStatusTest, QuestionWithoutAnswer_IsForgottenOnceTheServiceAnswers) {
    facts.assistant = Trouble::Faulty;
    facts.assistantEnded = Date{102.0};
    facts.service.interval = 30.0;
    facts.service.answered = Date{101.0};
    EXPECT_EQ(words(), "STATUS_FAULTY_SINCE");
    facts.service.answered = Date{103.0};
    EXPECT_EQ(words(), "STATUS_LIVE_NOW");
}

TEST_F(LiveStatusTest, ScenarioOnScreen_IsNotLiveBeforeTheServiceHasAnswered) {
    facts.wasAsked = false;
    EXPECT_EQ(status(), LiveStatus());
    facts.service.underWay = 1;
    EXPECT_EQ(status(), LiveStatus()) << "asked, and not answered";
    facts.now = Date{100000.0};
    EXPECT_EQ(status(), LiveStatus()) << "nor was it ever updated";
    facts.service.interval = 30.0;
    facts.service.answered = Date{100001.0};
    facts.now = Date{100002.0};
    EXPECT_EQ(words(), "STATUS_LIVE_NOW");
}

TEST_F(LiveStatusTest, BrokenConfiguration_IsNotTakenForSigningOut) {
    facts.signedIn = false;
    facts.unusable = true;
    EXPECT_EQ(status(), (LiveStatus{LiveStatus::Mark::Warning, "STATUS_UNREADABLE", false, LiveStatus::Help::CheckUp}));
}

TEST_F(LiveStatusTest, QuestionUnderWayGoesBeforeHiding) {
    facts.hidden = true;
    facts.asking = Date{104.0};
    EXPECT_EQ(words(), "STATUS_ASKING");
}

// Whoever shows the line waits for no less: at each moment before, it says what it said.
TEST_F(LiveStatusTest, ChangesIn_IsNeverTooLateAndSeldomEarly) {
    facts.service.answered = Date{101.0};
    facts.service.interval = 40.0;
    facts.asking = Date{104.8};
    int looked = 0;
    constexpr double kDay = 86400.0;
    constexpr double kAlmost = 1e-3;
    std::vector<std::string> said = {words()};
    while (facts.now.secondsSinceReferenceDate < kDay) {
        const auto wait = LiveStatus::changesIn(facts);
        ASSERT_TRUE(wait);
        ASSERT_GT(*wait, 0.0);
        ++looked;
        const double next = facts.now.secondsSinceReferenceDate + *wait;
        facts.now = Date{next - std::min(kAlmost, *wait / 2.0)};
        EXPECT_EQ(words(), said.back()) << facts.now.secondsSinceReferenceDate;
        facts.now = Date{next + kAlmost};
        said.push_back(words());
        if (facts.asking) {
            facts.asking.reset();
            said.push_back(words());
        }
    }
    EXPECT_LT(looked, 110) << "every ten seconds, then every minute, then every hour";
}

TEST_F(LiveStatusTest, ChangesIn_NothingOnScreenNeverChanges) {
    facts.shown.reset();
    EXPECT_FALSE(LiveStatus::changesIn(facts));
}

}  // namespace ktr::test
