#include "tests/contract/MapPictureSourceContract.h"

#include <limits>

#include "tests/support/FakeMaps.h"

namespace ktr::test {

TEST_P(MapPictureSourceContract, AnswersOnceOnALaterTurn) {
    ask(request());
    EXPECT_TRUE(pictures.empty());
    time->runPosted();
    ASSERT_EQ(pictures.size(), 1U);
    EXPECT_EQ(pictures[0].viewport, request().viewport);
    ASSERT_NE(pictures[0].image, nullptr);
    EXPECT_EQ(pictures[0].image->size(), request().viewport.size);
    EXPECT_FALSE(pictures[0].attribution.empty());
    time->runPosted();
    EXPECT_EQ(pictures.size(), 1U);
}

TEST_P(MapPictureSourceContract, EveryPlaceAndZoomHasAPictureWithItsAttribution) {
    for (const double latitude : {-90.0, -60.0, 0.0, 50.2104, 90.0}) {
        for (const double longitude : {-180.0, -3.12, 0.0, 180.0}) {
            for (const double zoom : {0.0, 7.5, 24.0}) {
                pictures.clear();
                ask(request(latitude, longitude, zoom));
                time->runPosted();
                ASSERT_EQ(pictures.size(), 1U);
                EXPECT_NE(pictures[0].image, nullptr);
                EXPECT_FALSE(pictures[0].attribution.empty()) << latitude << " " << longitude << " " << zoom;
            }
        }
    }
}

TEST_P(MapPictureSourceContract, WhatMakesNoSense_IsAnsweredToo) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    auto none = request();
    none.viewport.size = {0.0, 0.0};
    ask(none);
    ask(request(nan, nan, nan));
    auto scaled = request();
    scaled.scale = -1.0;
    ask(scaled);
    time->runPosted();
    ASSERT_EQ(pictures.size(), 3U);
    for (const auto& picture : pictures) {
        EXPECT_NE(picture.image, nullptr);
        EXPECT_FALSE(picture.attribution.empty());
    }
}

TEST_P(MapPictureSourceContract, Cancelled_IsNotAnswered) {
    const int first = ask(request());
    const int second = ask(request(10.0, 10.0));
    EXPECT_NE(first, second);
    subject.source->cancel(first);
    subject.source->cancel(first);
    subject.source->cancel(4711);
    time->runPosted();
    ASSERT_EQ(pictures.size(), 1U);
    EXPECT_EQ(pictures[0].viewport, request(10.0, 10.0).viewport);
    subject.source->cancel(second);
}

TEST_P(MapPictureSourceContract, EqualRequests_AreEachAnswered) {
    ask(request());
    ask(request());
    time->runPosted();
    EXPECT_EQ(pictures.size(), 2U);
}

TEST_P(MapPictureSourceContract, ObserversHearOfChangesUntilTheirTokenGoes) {
    int first = 0;
    int second = 0;
    auto one = subject.source->observeChanges([&first] { ++first; });
    const auto two = subject.source->observeChanges([&second] { ++second; });
    subject.change();
    time->runPosted();
    EXPECT_EQ(first, 1);
    EXPECT_EQ(second, 1);
    one.reset();
    subject.change();
    time->runPosted();
    EXPECT_EQ(first, 1);
    EXPECT_EQ(second, 2);
}

TEST_P(MapPictureSourceContract, TheSourceMayEndWhileSomebodyWaits) {
    ask(request());
    const auto token = subject.source->observeChanges([] {});
    subject = {};
    time->runPosted();
    EXPECT_TRUE(pictures.empty());
}

INSTANTIATE_TEST_SUITE_P(FakeMaps, MapPictureSourceContract,
                         ::testing::Values(MapSourceCase{"FakeMaps",
                                                         [](const auto& mainLoop) {
                                                             auto maps = std::make_shared<FakeMaps>(mainLoop);
                                                             return MapSourceUnderTest{
                                                                 maps, [weak = std::weak_ptr(maps)] {
                                                                     if (const auto fake = weak.lock()) {
                                                                         fake->change();
                                                                     }
                                                                 }};
                                                         }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
