#include "host/heard/NameChanges.h"

#include <gtest/gtest.h>

namespace ktr::host {

namespace {

using platform::AccessibilitySubject;

class KTRNameChangesTest : public ::testing::Test {
  public:
    static AccessibilitySubject ann(double metres = 310.0, int ageBand = 0, const std::string& place = "Fish Market") {
        AccessibilitySubject subject;
        subject.person = "Ann";
        subject.whereabouts = AccessibilitySubject::Whereabouts::Known;
        subject.place = place;
        subject.ageBand = ageBand;
        subject.metres = metres;
        subject.distance = std::to_string(metres);
        return subject;
    }
    bool isNews(const std::optional<AccessibilitySubject>& subject, double now, const std::string& name = "Ann") {
        return changes.isNews(&row, name, subject, now);
    }

    int row = 0;
    NameChanges changes;
};

TEST_F(KTRNameChangesTest, FirstSight_IsNoNews) {
    EXPECT_FALSE(isNews(ann(), 0.0));
    EXPECT_FALSE(isNews(ann(), 100.0));
}

TEST_F(KTRNameChangesTest, PlaceWhereaboutsAndAge_AreNewsAtOnce) {
    isNews(ann(), 0.0);
    EXPECT_TRUE(isNews(ann(310.0, 0, "Work"), 1.0));
    EXPECT_TRUE(isNews(ann(310.0, 1, "Work"), 2.0));
    auto unseen = ann(310.0, 1, "Work");
    unseen.whereabouts = AccessibilitySubject::Whereabouts::Unknown;
    EXPECT_TRUE(isNews(unseen, 3.0));
    EXPECT_FALSE(isNews(unseen, 4.0));
}

TEST_F(KTRNameChangesTest, DistanceAlone_IsNewsOnceAMinute) {
    isNews(ann(300.0), 0.0);
    int news = 0;
    for (int second = 1; second <= 180; ++second) {
        news += isNews(ann(300.0 + second), second) ? 1 : 0;
    }
    EXPECT_EQ(news, 3);
}

TEST_F(KTRNameChangesTest, AgeThatGrowsWithinItsKind_IsNoNews) {
    isNews(ann(310.0, 2), 0.0, "Ann, 4 minutes ago");
    EXPECT_FALSE(isNews(ann(310.0, 2), 60.0, "Ann, 5 minutes ago"));
    EXPECT_FALSE(isNews(ann(310.0, 2), 600.0, "Ann, 14 minutes ago"));
}

TEST_F(KTRNameChangesTest, AnotherCloseness_IsNewsAtOnceAndNotWhileItWavers) {
    isNews(ann(950.0), 0.0);
    EXPECT_FALSE(isNews(ann(1190.0), 1.0)) << "not yet far enough beyond a kilometre";
    EXPECT_TRUE(isNews(ann(1200.0), 2.0));
    EXPECT_FALSE(isNews(ann(801.0), 3.0));
    EXPECT_FALSE(isNews(ann(1201.0), 4.0));
    EXPECT_TRUE(isNews(ann(799.0), 5.0));
}

TEST_F(KTRNameChangesTest, Closeness_HasFiveKinds) {
    const auto fresh = [](double metres) { return NameChanges::closeness(metres, std::nullopt); };
    EXPECT_EQ(fresh(0.0), 0);
    EXPECT_EQ(fresh(99.9), 0);
    EXPECT_EQ(fresh(100.0), 1);
    EXPECT_EQ(fresh(999.0), 1);
    EXPECT_EQ(fresh(1000.0), 2);
    EXPECT_EQ(fresh(10000.0), 3);
    EXPECT_EQ(fresh(100000.0), 4);
    EXPECT_EQ(NameChanges::closeness(5.0e6, 0), 4) << "a leap takes it through all of them";
    EXPECT_EQ(NameChanges::closeness(5.0, 4), 0);
    EXPECT_EQ(NameChanges::closeness(81.0, 1), 1);
    EXPECT_EQ(NameChanges::closeness(79.0, 1), 0);
}

TEST_F(KTRNameChangesTest, DistanceThatComesOrGoes_IsNews) {
    auto none = ann();
    none.metres.reset();
    none.distance.clear();
    isNews(none, 0.0);
    EXPECT_TRUE(isNews(ann(), 1.0));
    EXPECT_TRUE(isNews(none, 2.0));
}

TEST_F(KTRNameChangesTest, ElementAboutNobody_IsNewsOnceAMinute) {
    isNews(std::nullopt, 0.0, "Map: 310 m north");
    EXPECT_TRUE(isNews(std::nullopt, 1.0, "Map: 320 m north"));
    EXPECT_FALSE(isNews(std::nullopt, 60.0, "Map: 330 m north"));
    EXPECT_TRUE(isNews(std::nullopt, 61.0, "Map: 330 m north")) << "late, and not lost";
    EXPECT_FALSE(isNews(std::nullopt, 200.0, "Map: 330 m north"));
}

TEST_F(KTRNameChangesTest, Forgotten_ComesForTheFirstTime) {
    isNews(ann(), 0.0);
    changes.forget(&row);
    EXPECT_FALSE(isNews(ann(310.0, 0, "Work"), 1.0));
}

}  // namespace

}  // namespace ktr::host
