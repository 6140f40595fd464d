#include <gtest/gtest.h>

#include "platform/ui/Window.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "views/KTRVelaFenceView.h"

// Every rectangle of the row with a glyph of one em. At L: body 16 (lines of 22), footnote 12 (17).

namespace ktr {

using namespace platform;
using test::fenceOf;
using test::friendByEmail;

class KTRVelaFenceViewLayoutTest : public test::PlatformTest {
  protected:
    KTRVelaFenceViewLayoutTest() {
        localization->set("org.ktr.snippets", "LEAVING_LABEL", "Leaves %@");
        const auto icon = std::make_shared<test::FakeImage>();
        icon->points = {16.0, 16.0};
        images->named["org.ktr.snippets/location"] = icon;
    }
    void layOut(const std::string& name, double width = 320.0, std::optional<double> height = std::nullopt) {
        window_ = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, width, 500.0});
        row_ = create<KTRVelaFenceView>(&KTRVelaFenceView::initWithFrame, Rect{0.0, 0.0, width, 100.0});
        row_->setGeoFence(
            fenceOf(friendByEmail(name, "ann@example.org")->friend_, VAKtrGeoFenceTriggerOnDepartureValue, "Work"));
        window_->addSubview(row_);
        row_->setFrame({0.0, 0.0, width, height.value_or(row_->estimagedHeightForView())});
        window_->layoutIfNeeded();
    }

    std::shared_ptr<Window> window_;
    std::shared_ptr<KTRVelaFenceView> row_;
};

TEST_F(KTRVelaFenceViewLayoutTest, LeftToRight) {
    layOut("Ann");
    EXPECT_EQ(row_->frame(), (Rect{0.0, 0.0, 320.0, 74.0}));
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->avatarViewController()->view()->frame(), (Rect{0.0, 0.0, 54.0, 54.0}));
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 10.0, 194.0, 22.0}));
    EXPECT_EQ(row_->geoFenceIconImageView()->frame(), (Rect{289.0, 16.0, 16.0, 16.0}));
    EXPECT_EQ(row_->fenceLabel()->frame(), (Rect{82.0, 32.0, 223.0, 17.0}));
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 73.5, 320.0, 0.5}));
}

TEST_F(KTRVelaFenceViewLayoutTest, RightToLeft) {
    assistant->rightToLeft = true;
    layOut("Ann");
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{251.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{44.0, 10.0, 194.0, 22.0}));
    EXPECT_EQ(row_->geoFenceIconImageView()->frame(), (Rect{15.0, 16.0, 16.0, 16.0}));
    EXPECT_EQ(row_->fenceLabel()->frame(), (Rect{15.0, 32.0, 223.0, 17.0}));
}

TEST_F(KTRVelaFenceViewLayoutTest, LongName_GivesWayToTheIcon) {
    layOut("Wilhelmina Featherstonehaugh");
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 10.0, 194.0, 22.0}));
    EXPECT_EQ(row_->geoFenceIconImageView()->frame(), (Rect{289.0, 16.0, 16.0, 16.0}));
    EXPECT_EQ(row_->frame().height, 74.0);
}

TEST_F(KTRVelaFenceViewLayoutTest, HigherThanMeasured_SeparatorStandsAtTheBottom) {
    layOut("Ann", 320.0, 100.0);
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 10.0, 194.0, 22.0}));
    EXPECT_EQ(row_->fenceLabel()->frame().y, 32.0);
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 99.5, 320.0, 0.5}));
}

TEST_F(KTRVelaFenceViewLayoutTest, LargestOrdinaryText_StaysWithinTheAvatarsHeight) {
    device->category = ContentSizeCategory::XXXL;
    layOut("Ann");
    // Body 22 (30), footnote 16 (22): 10 + 30 + 22 + 10 and the hairline, still less than the avatar's 74.
    EXPECT_EQ(row_->frame().height, 74.0);
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 10.0, 194.0, 30.0}));
    EXPECT_EQ(row_->fenceLabel()->frame(), (Rect{82.0, 40.0, 223.0, 22.0}));
}

TEST_F(KTRVelaFenceViewLayoutTest, NarrowWindow_SentenceIsCutNotTheRow) {
    layOut("Ann", 180.0);
    EXPECT_EQ(row_->fenceLabel()->frame(), (Rect{82.0, 32.0, 83.0, 17.0}));
    EXPECT_EQ(row_->frame().height, 74.0);
}

}  // namespace ktr
