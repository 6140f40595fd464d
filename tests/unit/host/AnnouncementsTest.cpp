#include "host/heard/Announcements.h"

#include "platform/base/VirtualTime.h"

#include <gtest/gtest.h>

namespace ktr::host {

namespace {

using platform::AccessibilitySubject;
using Whereabouts = AccessibilitySubject::Whereabouts;

class KTRAnnouncementsTest : public ::testing::Test {
  public:
    struct Said {
        double at;
        std::string message;
    };

    KTRAnnouncementsTest() {
        state.listening = true;
        state.cards = {{&card, {person("Ann", "Home"), person("Ben", "Work")}}};
        announcements.changed();
        pass(60.0);
    }

    static AccessibilitySubject person(const std::string& name, const std::string& place) {
        AccessibilitySubject subject;
        subject.person = name;
        subject.whereabouts = Whereabouts::Known;
        subject.place = place;
        return subject;
    }
    void pass(double seconds) { time->advance(seconds); }
    void tell() { announcements.changed(); }
    void place(const std::string& where) {
        people()[0].place = where;
        tell();
    }
    void whereabouts(Whereabouts what) {
        people()[0].whereabouts = what;
        tell();
    }
    std::vector<std::string> messages() const {
        std::vector<std::string> all;
        for (const Said& one : said) {
            all.push_back(one.message);
        }
        return all;
    }
    static std::string text(const std::string& key) {
        if (key == "ANNOUNCE_PEOPLE") {
            return "People: %@.";
        }
        if (key == "ANNOUNCE_PLACE") {
            return "%1$@: %2$@.";
        }
        if (key == "ANNOUNCE_UNSEEN") {
            return "%@ gone.";
        }
        if (key == "ANNOUNCE_SEEN") {
            return "%1$@ back: %2$@.";
        }
        if (key == "ANNOUNCE_SEEN_SOMEWHERE") {
            return "%@ back.";
        }
        return key == "ANNOUNCE_NEXT" ? "%1$@ %2$@" : key;
    }

    std::vector<AccessibilitySubject>& people() { return state.cards[0].people; }

    int card = 0;
    int otherCard = 0;
    std::shared_ptr<platform::VirtualTime> time = std::make_shared<platform::VirtualTime>(platform::Date{0.0});
    Announcements::State state;
    std::vector<Said> said;
    Announcements announcements{time,
                                {text, [](std::size_t number) { return std::to_string(number); }},
                                [this] { return state; },
                                [this](const std::string& message) {
                                    said.push_back({time->now().secondsSinceReferenceDate, message});
                                }};
};

TEST_F(KTRAnnouncementsTest, PeopleWhoAreThereAtFirst_AreNotSaid) {
    EXPECT_TRUE(said.empty());
}

TEST_F(KTRAnnouncementsTest, Answer_IsSaidOnceWithItsSentenceAndCount) {
    announcements.answerCame("Here are the nearest.", 5);
    pass(1.9);
    EXPECT_TRUE(said.empty());
    pass(60.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Here are the nearest. People: 5."});
}

TEST_F(KTRAnnouncementsTest, AnswerWithoutPeople_IsItsSentence) {
    announcements.answerCame("I do not know.", 0);
    pass(60.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"I do not know."});
}

TEST_F(KTRAnnouncementsTest, AnotherPlace_IsSaidOnce) {
    place("Harbour");
    pass(60.0);
    tell();
    pass(60.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Ann: Harbour."});
}

TEST_F(KTRAnnouncementsTest, MetresAndAge_AreNeverSaid) {
    for (int poll = 0; poll < 20; ++poll) {
        people()[0].metres = 100.0 * poll;
        people()[0].distance = std::to_string(100 * poll);
        people()[0].ageBand = poll % 5;
        tell();
        pass(3.0);
    }
    EXPECT_TRUE(said.empty());
}

TEST_F(KTRAnnouncementsTest, GoneAndBack_AreSaidOnceEach) {
    whereabouts(Whereabouts::Unknown);
    pass(30.0);
    whereabouts(Whereabouts::Known);
    pass(30.0);
    EXPECT_EQ(messages(), (std::vector<std::string>{"Ann gone.", "Ann back: Home."}));
}

TEST_F(KTRAnnouncementsTest, BackAtAPlaceWithoutAName_IsSaidWithoutOne) {
    whereabouts(Whereabouts::Unknown);
    pass(30.0);
    people()[0].place.clear();
    whereabouts(Whereabouts::Known);
    pass(30.0);
    EXPECT_EQ(messages().back(), "Ann back.");
}

TEST_F(KTRAnnouncementsTest, PlaceThatIsFoundAfterASearch_IsSaidAsAPlace) {
    people().push_back(person("Cy", ""));
    people().back().whereabouts = Whereabouts::Sought;
    tell();
    pass(30.0);
    EXPECT_TRUE(said.empty());
    people().back() = person("Cy", "Gym");
    tell();
    pass(30.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Cy: Gym."});
}

TEST_F(KTRAnnouncementsTest, ServiceOutOfReachAndBack_AreSaidOnceEach) {
    state.reachable = false;
    for (int poll = 0; poll < 5; ++poll) {
        tell();
        pass(10.0);
    }
    state.reachable = true;
    tell();
    pass(30.0);
    EXPECT_EQ(messages(), (std::vector<std::string>{"ANNOUNCE_UNREACHABLE", "ANNOUNCE_REACHABLE"}));
}

TEST_F(KTRAnnouncementsTest, WithinTwoSeconds_IsSaidTogether) {
    place("Harbour");
    pass(1.0);
    people()[1].place = "Gym";
    tell();
    announcements.answerCame("Here they are.", 2);
    pass(1.5);
    EXPECT_EQ(messages(), std::vector<std::string>{"Here they are. People: 2. Ann: Harbour. Ben: Gym."});
}

TEST_F(KTRAnnouncementsTest, AtMostOneInTenSeconds_AndTheLastStateCounts) {
    const std::vector<std::string> places = {"A", "B", "C", "D", "E", "F", "G", "H", "I", "J"};
    for (const std::string& next : places) {
        place(next);
        pass(3.0);
    }
    pass(30.0);
    ASSERT_GE(said.size(), 3U);
    for (std::size_t i = 1; i < said.size(); ++i) {
        EXPECT_GE(said[i].at - said[i - 1].at, 10.0);
    }
    EXPECT_EQ(said.back().message, "Ann: J.");
}

TEST_F(KTRAnnouncementsTest, WhatBecameUndone_IsNotSaid) {
    place("Harbour");
    state.reachable = false;
    pass(1.0);
    place("Home");
    state.reachable = true;
    pass(30.0);
    EXPECT_TRUE(said.empty());
}

TEST_F(KTRAnnouncementsTest, WindowThatIsNotUsed_SaysNothingThenOrLater) {
    state.listening = false;
    announcements.answerCame("Here they are.", 2);
    place("Harbour");
    pass(30.0);
    state.listening = true;
    tell();
    pass(30.0);
    EXPECT_TRUE(said.empty()) << "whoever comes back reads what is there";
    place("Gym");
    pass(30.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Ann: Gym."});
}

TEST_F(KTRAnnouncementsTest, FriendInTwoAnswers_IsSaidOnce) {
    state.cards.push_back({&otherCard, {person("Ann", "Home")}});
    tell();
    pass(30.0);
    people()[0].place = state.cards[1].people[0].place = "Harbour";
    tell();
    pass(30.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Ann: Harbour."});
}

TEST_F(KTRAnnouncementsTest, FriendWhoLeavesTheListAndComesBack_IsSaidOnceEach) {
    const auto ann = people()[0];
    people().erase(people().begin());
    tell();
    pass(30.0);
    tell();
    pass(30.0);
    people().push_back(ann);
    tell();
    pass(30.0);
    EXPECT_EQ(messages(), (std::vector<std::string>{"Ann gone.", "Ann back: Home."}));
}

TEST_F(KTRAnnouncementsTest, ThoseWhoAreFoundLater_AreNamedOrCounted) {
    people().push_back(person("Cy", "Gym"));
    tell();
    pass(30.0);
    EXPECT_EQ(messages(), std::vector<std::string>{"Cy: Gym."});
    for (const char* name : {"Di", "Ed", "Flo", "Gus"}) {
        people().push_back(person(name, "School"));
    }
    tell();
    pass(30.0);
    EXPECT_EQ(messages().back(), "People: 7.");
}

TEST_F(KTRAnnouncementsTest, CardThatGoes_IsNoNewsOfItsPeople) {
    state.cards.clear();
    tell();
    pass(30.0);
    EXPECT_TRUE(said.empty());
}

TEST_F(KTRAnnouncementsTest, TwoOfOneName_AreKeptApart) {
    people().push_back(person("Ann", "Gym"));
    people().back().handle = "other@example.org";
    tell();
    pass(30.0);
    said.clear();
    std::swap(people()[0], people()[2]);
    tell();
    pass(30.0);
    EXPECT_TRUE(said.empty());
}

TEST_F(KTRAnnouncementsTest, Gone_LeavesNothingBehind) {
    auto other = std::make_unique<Announcements>(
        time, Announcements::Words{text, [](std::size_t) { return ""; }}, [this] { return state; },
        [](const std::string&) { FAIL() << "said by one that is gone"; });
    other->answerCame("Hello.", 0);
    other.reset();
    pass(30.0);
}

}  // namespace

}  // namespace ktr::host
