#include "platform/map/KTAnnotationView.h"

#include <algorithm>

#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

using namespace platform;

namespace {

struct Friend : KTAnnotation {
    bool known = true;
    bool border = false;
    bool thisDevice = false;
    std::shared_ptr<Image> large;
    std::shared_ptr<Image> small;
    std::optional<Color> tint;
    Coordinate coordinate() const override { return {1.0, 2.0}; }
    bool hasKnownLocation() const override { return known; }
    bool isBorderEnabled() const override { return border; }
    std::shared_ptr<Image> largeAnnotationIcon() const override { return large; }
    std::shared_ptr<Image> smallAnnotationIcon() const override { return small; }
    std::shared_ptr<Image> largeOverlayIcon() const override { return nullptr; }
    std::shared_ptr<Image> smallOverlayIcon() const override { return nullptr; }
    std::optional<Color> tintColor() const override { return tint; }
    double distanceFromUser() const override { return 0.0; }
    double horizontalAccuracy() const override { return 0.0; }
    std::shared_ptr<KTAccuracyOverlay> overlay() const override { return nullptr; }
    bool isThisDevice() const override { return thisDevice; }
};

const Color kOrange = Color::rgb(0.9, 0.5, 0.1);

}  // namespace

class KTAnnotationViewTest : public PlatformTest {
  protected:
    KTAnnotationViewTest() {
        KTAnnotationView::setLargeAnnotationBorderVisible(false);
        pin_->large = std::make_shared<FakeImage>();
        using Initialiser =
            bool (KTAnnotationView::*)(const std::shared_ptr<MapAnnotation>&, const std::string&, const Color&);
        view_ = create<KTAnnotationView>(static_cast<Initialiser>(&KTAnnotationView::initWithAnnotation), pin_, "id",
                                         kOrange);
        view_->prepareForMap({376.0, 219.0}, 1.0);
    }
    /// In coordinates whose origin is the tip.
    std::vector<RecordingCanvas::Call> painted() {
        RecordingCanvas canvas;
        canvas.translate(-view_->anchorPoint().x, -view_->anchorPoint().y);
        view_->paint(canvas, view_->bounds());
        return canvas.calls;
    }
    std::optional<Rect> whiteDisc() {
        for (const auto& call : painted()) {
            if (call.kind == RecordingCanvas::Call::Kind::Path && call.color == Color::white(1.0, 1.0)) {
                return call.rect;
            }
        }
        return std::nullopt;
    }
    Rect icon() {
        for (const auto& call : painted()) {
            if (call.kind == RecordingCanvas::Call::Kind::Image) {
                return call.rect;
            }
        }
        return {};
    }

    std::shared_ptr<Friend> pin_ = std::make_shared<Friend>();
    std::shared_ptr<KTAnnotationView> view_;
};

TEST_F(KTAnnotationViewTest, Icon_StandsInADiscOf56AboveTheTip) {
    pin_->border = true;
    view_->prepareForMap({376.0, 219.0}, 1.0);
    const Rect disc = icon();
    EXPECT_DOUBLE_EQ(disc.width, 56.0);
    EXPECT_DOUBLE_EQ(disc.x, -28.0);
    EXPECT_DOUBLE_EQ(disc.y + 28.0, -44.75);
}

TEST_F(KTAnnotationViewTest, LargeMap_LargePin) {
    pin_->border = true;
    view_->prepareForMap({680.0, 389.0}, 1.0);
    const Rect disc = icon();
    EXPECT_DOUBLE_EQ(disc.width, 89.0);
    EXPECT_DOUBLE_EQ(disc.y + 44.5, -(44.5 + 3.0 + 6.0 + 0.75) - 15.0);
}

TEST_F(KTAnnotationViewTest, Border_OfTheAnnotationOrOfTheClass) {
    EXPECT_EQ(whiteDisc(), std::nullopt);
    pin_->border = true;
    view_->prepareForMap({376.0, 219.0}, 1.0);
    ASSERT_TRUE(whiteDisc().has_value());
    EXPECT_NEAR(whiteDisc()->width, 60.0, 1e-9);
    pin_->border = false;
    KTAnnotationView::setLargeAnnotationBorderVisible(true);
    view_->prepareForMap({376.0, 219.0}, 1.0);
    EXPECT_TRUE(whiteDisc().has_value());
}

TEST_F(KTAnnotationViewTest, Tint_OfTheAnnotationElseOfTheView) {
    const auto isFilledWith = [&](const Color& color) {
        const auto calls = painted();
        return std::any_of(calls.begin(), calls.end(), [&](const auto& call) { return call.color == color; });
    };
    EXPECT_TRUE(isFilledWith(kOrange));
    pin_->tint = Color::rgb(0.0, 0.0, 1.0);
    EXPECT_TRUE(isFilledWith(*pin_->tint));
    EXPECT_FALSE(isFilledWith(kOrange));
}

TEST_F(KTAnnotationViewTest, SmallIcon_StandsInForTheLargeOne) {
    pin_->large = nullptr;
    EXPECT_EQ(icon(), Rect{});
    pin_->small = std::make_shared<FakeImage>();
    EXPECT_NE(icon(), Rect{});
}

TEST_F(KTAnnotationViewTest, UnknownPlaceAndThisDevice_DrawNothing) {
    pin_->known = false;
    EXPECT_TRUE(painted().empty());
    pin_->known = true;
    pin_->thisDevice = true;
    EXPECT_TRUE(painted().empty());
}

TEST_F(KTAnnotationViewTest, ClassSettings_AreTheInstalledPlatforms) {
    EXPECT_FALSE(KTAnnotationView::isLayerMaskingEnabled());
    KTAnnotationView::setLayerMaskingEnabled(true);
    EXPECT_TRUE(KTAnnotationView::isLayerMaskingEnabled());
    Platform::install(std::make_shared<Platform>());
    EXPECT_FALSE(KTAnnotationView::isLayerMaskingEnabled());
    EXPECT_TRUE(KTAnnotationView::isLargeAnnotationBorderVisible());
    Platform::install(platform);
}

TEST_F(KTAnnotationViewTest, Marker_DrawsItsTintAndIconOnlyWhereItIsKnown) {
    const auto marker = create<MarkerAnnotationView>(&MarkerAnnotationView::initWithAnnotation, pin_, "id");
    marker->setMarkerTintColor(Color::systemRed());
    RecordingCanvas canvas;
    marker->paint(canvas, marker->bounds());
    const auto strokes = std::count_if(canvas.calls.begin(), canvas.calls.end(), [](const auto& call) {
        return call.kind == RecordingCanvas::Call::Kind::Stroke && call.color == Color::white(1.0, 1.0);
    });
    EXPECT_EQ(strokes, 6);
    pin_->known = false;
    RecordingCanvas empty;
    marker->paint(empty, marker->bounds());
    EXPECT_TRUE(empty.calls.empty());
}

}  // namespace ktr::test
