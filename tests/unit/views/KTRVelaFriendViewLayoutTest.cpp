#include <gtest/gtest.h>

#include "model/KTRVATheme.h"
#include "platform/ui/Window.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "views/KTRVelaFriendView.h"

// Every rectangle of the row with a glyph of one em. At L: subheadline 13 (lines of 18), headline and body 16 (22).

namespace ktr {

using namespace platform;
using test::placedFriend;

namespace {

struct UserPosition : CurrentLocationDelegate {
    std::shared_ptr<PlatformLocation> position;
    std::shared_ptr<PlatformLocation> currentLocation() const override { return position; }
};

}  // namespace

class KTRVelaFriendViewLayoutTest : public test::PlatformTest {
  protected:
    void layOut(const std::string& name, double width = 320.0, std::optional<double> height = std::nullopt,
                const std::string& city = "Springfield") {
        window_ = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, width, 500.0});
        row_ = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{0.0, 0.0, width, 0.0});
        row_->setCurrentLocationDelegate(user_);
        auto object = placedFriend(name, "ann@example.org");
        object->city = city;
        row_->setLocation(KTRVALocation::locationWithVelaLocation(object));
        window_->addSubview(row_);
        row_->setFrame({0.0, 0.0, width, height.value_or(row_->estimagedHeightForView())});
        window_->layoutIfNeeded();
    }
    /// 111 m away: five glyphs, 80 points.
    void userIsNear() { user_->position = position(51.001, -1.0); }

    std::shared_ptr<UserPosition> user_ = std::make_shared<UserPosition>();
    std::shared_ptr<Window> window_;
    std::shared_ptr<KTRVelaFriendView> row_;
};

TEST_F(KTRVelaFriendViewLayoutTest, LeftToRight) {
    userIsNear();
    layOut("Ann");
    EXPECT_EQ(row_->frame(), (Rect{0.0, 0.0, 320.0, 78.5}));
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->avatarViewController()->view()->frame(), (Rect{0.0, 0.0, 54.0, 54.0}));
    EXPECT_EQ(row_->locationLabel()->frame(), (Rect{82.0, 10.0, 223.0, 18.0}));
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 28.0, 130.0, 22.0}));
    EXPECT_EQ(row_->distanceLabel()->frame(), (Rect{225.0, 28.0, 80.0, 22.0}));
    EXPECT_EQ(row_->timeLabel()->frame(), (Rect{82.0, 50.0, 223.0, 18.0}));
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 78.0, 320.0, 0.5}));
}

TEST_F(KTRVelaFriendViewLayoutTest, RightToLeft) {
    assistant->rightToLeft = true;
    userIsNear();
    layOut("Ann");
    EXPECT_EQ(row_->frame(), (Rect{0.0, 0.0, 320.0, 78.5}));
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{251.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->avatarViewController()->view()->frame(), (Rect{0.0, 0.0, 54.0, 54.0}));
    EXPECT_EQ(row_->locationLabel()->frame(), (Rect{15.0, 10.0, 223.0, 18.0}));
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{108.0, 28.0, 130.0, 22.0}));
    EXPECT_EQ(row_->distanceLabel()->frame(), (Rect{15.0, 28.0, 80.0, 22.0}));
    EXPECT_EQ(row_->timeLabel()->frame(), (Rect{15.0, 50.0, 223.0, 18.0}));
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 78.0, 320.0, 0.5}));
}

TEST_F(KTRVelaFriendViewLayoutTest, RightToLeft_TextsStandAtTheRight) {
    assistant->rightToLeft = true;
    userIsNear();
    layOut("Ann");
    EXPECT_EQ(row_->nameLabel()->drawnTextRect(), (Rect{82.0, 0.0, 48.0, 22.0}));
}

TEST_F(KTRVelaFriendViewLayoutTest, NoDistance_NameTakesTheRoom) {
    layOut("Ann");
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 28.0, 210.0, 22.0}));
    EXPECT_EQ(row_->distanceLabel()->frame(), (Rect{305.0, 28.0, 0.0, 22.0}));
}

TEST_F(KTRVelaFriendViewLayoutTest, LongName_GivesWayToTheDistance) {
    userIsNear();
    layOut("Wilhelmina Featherstonehaugh");
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 28.0, 130.0, 22.0}));
    EXPECT_TRUE(row_->nameLabel()->textLayout()->isTruncated());
    EXPECT_EQ(row_->distanceLabel()->frame(), (Rect{225.0, 28.0, 80.0, 22.0}));
    EXPECT_FALSE(row_->distanceLabel()->textLayout()->isTruncated());
    EXPECT_EQ(row_->frame().height, 78.5);
}

TEST_F(KTRVelaFriendViewLayoutTest, LongPlace_IsCutAndTheRowDoesNotGrow) {
    layOut("Ann", 320.0, std::nullopt, "Llanfairpwllgwyngyllgogerychwyrndrobwll");
    EXPECT_EQ(row_->locationLabel()->frame(), (Rect{82.0, 10.0, 223.0, 18.0}));
    EXPECT_TRUE(row_->locationLabel()->textLayout()->isTruncated());
    EXPECT_EQ(row_->estimagedHeightForView(), 78.5);
}

TEST_F(KTRVelaFriendViewLayoutTest, MoreHeightThanWanted_GoesAboveTheSeparator) {
    layOut("Ann", 320.0, 120.0);
    EXPECT_EQ(row_->locationLabel()->frame(), (Rect{82.0, 10.0, 223.0, 18.0}));
    EXPECT_EQ(row_->timeLabel()->frame(), (Rect{82.0, 50.0, 223.0, 18.0}));
    EXPECT_EQ(row_->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 119.5, 320.0, 0.5}));
}

TEST_F(KTRVelaFriendViewLayoutTest, HiddenSeparator_KeepsItsRoom) {
    layOut("Ann");
    row_->setSeparatorEnabled(false);
    EXPECT_EQ(row_->estimagedHeightForView(), 78.5);
}

TEST_F(KTRVelaFriendViewLayoutTest, Separator_IsOnePixelHigh) {
    device->scale = 1.0;
    layOut("Ann");
    EXPECT_EQ(row_->estimagedHeightForView(), 79.0);
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 78.0, 320.0, 1.0}));
    device->scale = 4.0;
    layOut("Ann");
    EXPECT_EQ(row_->estimagedHeightForView(), 78.25);
}

TEST_F(KTRVelaFriendViewLayoutTest, SmallestText_AvatarDecidesTheHeight) {
    // Lines of 15, 18 and 15 end at 58; the avatar at 64, and 10 points below it the row ends.
    device->category = ContentSizeCategory::XS;
    layOut("Ann");
    EXPECT_EQ(row_->estimagedHeightForView(), 74.0);
    EXPECT_EQ(row_->timeLabel()->frame(), (Rect{82.0, 43.0, 223.0, 15.0}));
    EXPECT_EQ(row_->separatorView()->frame(), (Rect{0.0, 73.5, 320.0, 0.5}));
}

TEST_F(KTRVelaFriendViewLayoutTest, LargestOrdinaryText) {
    // Lines of 25, 30 and 25.
    device->category = ContentSizeCategory::XXXL;
    layOut("Ann");
    EXPECT_EQ(row_->estimagedHeightForView(), 100.5);
    EXPECT_EQ(row_->nameLabel()->frame(), (Rect{82.0, 35.0, 210.0, 30.0}));
    EXPECT_EQ(row_->timeLabel()->frame(), (Rect{82.0, 65.0, 223.0, 25.0}));
}

TEST_F(KTRVelaFriendViewLayoutTest, NoWidth_KeepsItsHeight) {
    layOut("Ann", 0.0);
    EXPECT_EQ(row_->estimagedHeightForView(), 78.5);
}

TEST_F(KTRVelaFriendViewLayoutTest, EmptyRow_IsAsHighAsAFilledOne) {
    row_ = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{0.0, 0.0, 320.0, 0.0});
    EXPECT_EQ(row_->estimagedHeightForView(), 78.5);
}

TEST_F(KTRVelaFriendViewLayoutTest, Labels_HaveTheirFontsColoursAndPriorities) {
    layOut("Ann");
    struct Expected {
        std::shared_ptr<Label> label;
        TextStyle style;
        Color color;
        double horizontalResistance;
        double horizontalHugging;
    };
    const std::vector<Expected> labels = {
        {row_->nameLabel(), TextStyle::Headline, KTRVATheme::friendNameTextColor(), 250.0, 250.0},
        {row_->timeLabel(), TextStyle::Subheadline, KTRVATheme::friendLocationTextColor(), 1000.0, 250.0},
        {row_->locationLabel(), TextStyle::Subheadline, KTRVATheme::friendLocationTextColor(), 1000.0, 250.0},
        {row_->distanceLabel(), TextStyle::Body, KTRVATheme::distanceTextColor(), 1000.0, 1000.0},
    };
    for (const auto& expected : labels) {
        const Label& label = *expected.label;
        EXPECT_EQ(label.font(), preferredFont(expected.style));
        EXPECT_EQ(label.textColor(), expected.color);
        EXPECT_EQ(label.backgroundColor(), Color::clear());
        EXPECT_EQ(label.numberOfLines(), 1);
        EXPECT_EQ(label.lineBreakMode(), LineBreakMode::TruncatingTail);
        EXPECT_EQ(label.contentCompressionResistancePriority(LayoutAxis::Horizontal), expected.horizontalResistance);
        EXPECT_EQ(label.contentCompressionResistancePriority(LayoutAxis::Vertical), 1000.0);
        EXPECT_EQ(label.contentHuggingPriority(LayoutAxis::Horizontal), expected.horizontalHugging);
        EXPECT_EQ(label.contentHuggingPriority(LayoutAxis::Vertical), 1000.0);
    }
    EXPECT_EQ(row_->separatorView()->layerBackgroundColor(), Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
    EXPECT_EQ(row_->separatorView()->backgroundColor(), Color::clear());
}

TEST_F(KTRVelaFriendViewLayoutTest, Subviews_StandInTheOrderOfPainting) {
    layOut("Ann");
    EXPECT_EQ(row_->subviews(), (std::vector<std::shared_ptr<View>>{row_->nameLabel(), row_->friendIconView(),
                                                                    row_->timeLabel(), row_->separatorView(),
                                                                    row_->locationLabel(), row_->distanceLabel()}));
}

}  // namespace ktr
