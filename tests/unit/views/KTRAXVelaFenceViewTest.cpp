#include "views/accessibility/KTRAXVelaFenceView.h"

#include "model/KTRVATheme.h"
#include "tests/support/BackgroundLoop.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;
using test::fenceOf;
using test::friendByEmail;

namespace {

struct ResizeCounter : FriendViewDelegate {
    int count = 0;
    void viewNeedsResize() override { ++count; }
};

struct PlainImage : Image {
    Size size() const override { return {16.0, 16.0}; }
};

constexpr const char* kBundle = "org.ktr.snippets";
constexpr const char* kLeaving = VAKtrGeoFenceTriggerOnDepartureValue;

}  // namespace

class KTRAXVelaFenceViewTest : public test::PlatformTest {
  protected:
    KTRAXVelaFenceViewTest() {
        localization->set(kBundle, "IMMEDIATE_LABEL", "At once");
        localization->set(kBundle, "LEAVING_LABEL", "When leaving %@");
        localization->set(kBundle, "ARRIVING_LABEL", "When arriving at %@");
        localization->set(kBundle, "LEAVING_LABEL_ABSOLUTE", "When leaving");
        localization->set(kBundle, "ARRIVING_LABEL_ABSOLUTE", "When arriving (100 %@)");
        localization->set(kBundle, "_$!<work>!$_", "Work");
        images->named["org.ktr.snippets/location"] = icon_;
        device->category = ContentSizeCategory::AX3;
    }

    std::shared_ptr<KTRAXVelaFenceView> makeRow(double width = 640.0) {
        auto row = create<KTRAXVelaFenceView>(&KTRAXVelaFenceView::initWithFrame, Rect{0.0, 0.0, width, 0.0});
        row->setViewDelegate(host_);
        return row;
    }
    static std::shared_ptr<VAKtrGeoFence> annsFence(const std::optional<std::string>& trigger,
                                                    const std::optional<std::string>& label = std::nullopt,
                                                    const std::optional<std::string>& street = std::nullopt) {
        return fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, trigger, label, street);
    }
    std::shared_ptr<KTRAXVelaFenceView> rowFor(const std::shared_ptr<VAKtrGeoFence>& fence, double width = 640.0) {
        auto row = makeRow(width);
        row->setGeoFence(fence);
        return row;
    }
    std::string text(const std::shared_ptr<VAKtrGeoFence>& fence) {
        return rowFor(fence)->attributedStringForView().text();
    }
    static void layOut(const std::shared_ptr<View>& row, double width) {
        const double height = row->systemLayoutSizeFitting({width, 0.0}, 1000.0, 1.0).height;
        row->setFrame({0.0, 0.0, width, height});
        row->layoutIfNeeded();
    }

    std::shared_ptr<PlainImage> icon_ = std::make_shared<PlainImage>();
    std::shared_ptr<ResizeCounter> host_ = std::make_shared<ResizeCounter>();
};

// The text

TEST_F(KTRAXVelaFenceViewTest, Text_IsTheNameAndTheSentence) {
    const auto composed = rowFor(annsFence(kLeaving, std::nullopt, "1 Harbour St"))->attributedStringForView();
    const Font headline = preferredFont(TextStyle::Headline, ContentSizeCategory::AX3);
    const Font subheadline = preferredFont(TextStyle::Subheadline, ContentSizeCategory::AX3);
    const ParagraphStyle style = {TextAlignment::Left, LineBreakMode::WordWrapping, WritingDirection::LeftToRight};
    const std::vector<AttributedString::Run> expected = {
        {"Ann", headline, std::nullopt, style},
        {"\n", headline, std::nullopt, style},
        {"When leaving 1 Harbour St", subheadline, std::nullopt, style}};
    EXPECT_EQ(composed.runs(), expected);
}

TEST_F(KTRAXVelaFenceViewTest, Text_OfEachKindOfFence) {
    EXPECT_EQ(text(annsFence(VAKtrGeoFenceTriggerImmediateValue, "Pier")), "Ann\nAt once");
    EXPECT_EQ(text(annsFence(std::nullopt)), "Ann\nWhen arriving (100 %@)") << "as it stands";
    EXPECT_EQ(text(annsFence("a later day's")), "Ann\nWhen arriving (100 %@)");
    EXPECT_EQ(text(annsFence(kLeaving)), "Ann\nWhen leaving");
    EXPECT_EQ(text(annsFence(kLeaving, "_$!<Work>!$_")), "Ann\nWhen leaving Work") << "looked up in small letters";
    EXPECT_EQ(text(annsFence(std::nullopt, "Pier", "1 Harbour St")), "Ann\nWhen arriving at Pier");
}

TEST_F(KTRAXVelaFenceViewTest, RightToLeft_AlignsRightAndMirrorsTheExclusion) {
    assistant->rightToLeft = true;
    const auto row = rowFor(annsFence(kLeaving), 400.0);
    EXPECT_EQ(row->attributedStringForView().runs().back().paragraph.alignment, TextAlignment::Right);
    EXPECT_EQ(row->exclusionPaths(), (std::vector<Rect>{{303.0, 0.0, 67.0, 54.0}}));
    EXPECT_EQ(row->imageView()->contentMode(), ContentMode::TopRight);
}

// The views

TEST_F(KTRAXVelaFenceViewTest, Views_TheIconAndTheAvatarArePaintedOverTheImage_IsKept) {
    const auto row = makeRow();
    EXPECT_EQ(row->subviews(), (std::vector<std::shared_ptr<View>>{row->imageView(), row->geoFenceIconImageView(),
                                                                   row->separatorView(), row->friendIconView()}));
    EXPECT_EQ(row->geoFenceIconImageView()->image(), icon_);
    EXPECT_EQ(row->nameLabel(), nullptr);
    EXPECT_EQ(row->fenceLabel(), nullptr);
}

TEST_F(KTRAXVelaFenceViewTest, OrdinaryTextSize_SetsUpOnce) {
    device->category = ContentSizeCategory::L;
    EXPECT_EQ(makeRow()->subviews().size(), 4u);
}

TEST_F(KTRAXVelaFenceViewTest, Layout_TheSeparatorHasNoWidth_IsKept) {
    const auto row = rowFor(annsFence(kLeaving, "Pier"));
    time->runPosted();
    layOut(row, 640.0);
    const Size size = row->imageView()->image()->size();
    EXPECT_EQ(row->imageView()->frame(), (Rect{15.0, 10.0, 610.0, size.height}));
    EXPECT_EQ(row->separatorView()->frame().width, 0.0);
    EXPECT_EQ(row->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    // A fifth of the headline's size and 10 from the top.
    EXPECT_EQ(row->geoFenceIconImageView()->frame(), (Rect{609.0, 18.0, 16.0, 16.0}));
}

TEST_F(KTRAXVelaFenceViewTest, IconsPlace_IsReadAtSetUp) {
    const auto row = rowFor(annsFence(kLeaving));
    device->category = ContentSizeCategory::AX5;
    row->updateFenceView();
    layOut(row, 640.0);
    EXPECT_EQ(row->geoFenceIconImageView()->frame().y, 18.0);
    const auto larger = rowFor(annsFence(kLeaving));
    layOut(larger, 640.0);
    EXPECT_DOUBLE_EQ(larger->geoFenceIconImageView()->frame().y, 20.4);
}

TEST_F(KTRAXVelaFenceViewTest, Layout_BeforeTheImage_HoldsTheAvatar) {
    const auto row = rowFor(annsFence(kLeaving));
    layOut(row, 640.0);
    EXPECT_EQ(row->imageView()->frame().height, 0.0);
    EXPECT_EQ(row->frame().height, 74.0);
}

TEST_F(KTRAXVelaFenceViewTest, Height_BeforeTheImage_IsMeasured) {
    const auto row = rowFor(annsFence(kLeaving));
    EXPECT_EQ(row->estimagedHeightForView(),
              row->sizeForText(row->attributedStringForView(), 620.0, row->exclusionPaths()).height + 30.5);
    EXPECT_EQ(log->texts(LogLevel::Debug).back(), "Calculating estimated height");
}

TEST_F(KTRAXVelaFenceViewTest, Height_WithTheImage_IsItsHeightWhateverTheWidth_IsKept) {
    const auto row = rowFor(annsFence(kLeaving, "Pier"));
    time->runPosted();
    const double height = row->imageView()->image()->size().height;
    EXPECT_EQ(row->estimagedHeightForView(), height + 20.0);
    row->setFrame({0.0, 0.0, 100.0, 0.0});
    EXPECT_EQ(row->estimagedHeightForView(), height + 20.0);
}

// The image

TEST_F(KTRAXVelaFenceViewTest, Filling_ShowsTheImageAndTellsTheResize) {
    const auto row = rowFor(annsFence(kLeaving));
    time->runPosted();
    EXPECT_NE(row->imageView()->image(), nullptr);
    EXPECT_EQ(row->imageView()->image()->size().width, 610.0);
    EXPECT_EQ(host_->count, 1);
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts().size(), 1u);
}

TEST_F(KTRAXVelaFenceViewTest, ChangedWidth_RendersAgain) {
    const auto row = rowFor(annsFence(kLeaving, "Pier"));
    time->runPosted();
    layOut(row, 400.0);
    time->runPosted();
    EXPECT_EQ(row->imageView()->image()->size().width, 370.0);
    EXPECT_EQ(host_->count, 2);
}

TEST_F(KTRAXVelaFenceViewTest, OlderRendering_NeverReplacesANewerOne) {
    const auto loop = std::make_shared<test::BackgroundLoop>(Date{kNoon});
    platform->mainLoop = loop;
    const auto row = rowFor(annsFence(kLeaving, "Pier"));
    row->setGeoFence(annsFence(kLeaving, "Quay"));
    loop->run(1);
    loop->runPosted();
    const auto newer = row->imageView()->image();
    loop->run(0);
    loop->runPosted();
    EXPECT_EQ(row->imageView()->image(), newer);
    EXPECT_EQ(host_->count, 1);
}

TEST_F(KTRAXVelaFenceViewTest, NoFence_IsNobodysArrival) {
    const auto row = makeRow();
    row->setGeoFence(nullptr);
    EXPECT_EQ(row->attributedStringForView().text(), "\nWhen arriving (100 %@)");
    time->runPosted();
    EXPECT_NE(row->imageView()->image(), nullptr);
}

TEST_F(KTRAXVelaFenceViewTest, PlatformGone_KeepsWhatIsShown) {
    const auto row = rowFor(annsFence(kLeaving));
    time->runPosted();
    const auto image = row->imageView()->image();
    Platform::install(nullptr);
    row->updateFenceView();
    layOut(row, 300.0);
    time->runPosted();
    EXPECT_EQ(row->imageView()->image(), image);
    Platform::install(platform);
}

}  // namespace ktr
