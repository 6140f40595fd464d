#include "views/KTRVelaBaseView.h"

#include <cmath>

#include "platform/ui/TouchDispatcher.h"
#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;

namespace {

struct Opener : ViewURLHandler {
    std::vector<std::string> opened;
    void handleURL(const Url& url) override { opened.push_back(url.text()); }
};

struct RowWithUrl : KTRVelaBaseView {
    std::optional<Url> urlForTouch() override { return Url("wayloc://test/"); }
};

struct TouchRecorder : View {
    std::vector<std::string> heard;
    void touchesBegan(const Touches&, const TouchEvent&) override { heard.push_back("began"); }
    void touchesEnded(const Touches&, const TouchEvent&) override { heard.push_back("ended"); }
    void touchesCancelled(const Touches&, const TouchEvent&) override { heard.push_back("cancelled"); }
};

}  // namespace

class KTRVelaBaseViewTest : public test::PlatformTest {
  protected:
    static std::shared_ptr<KTRVelaBaseView> makeView() {
        return create<KTRVelaBaseView>(&KTRVelaBaseView::initWithFrame, Rect{0.0, 0.0, 320.0, 50.0});
    }
    static std::shared_ptr<RowWithUrl> makeRow() {
        return create<RowWithUrl>(&RowWithUrl::initWithFrame, Rect{0.0, 0.0, 320.0, 50.0});
    }
    static AttributedString text(const std::string& text) {
        return {text, Font{FontFace::Text, FontWeight::Regular, 10.0}};
    }

    const Color dimmed_ = Color::rgb(0.0, 0.0, 0.0, 0.2);
};

TEST_F(KTRVelaBaseViewTest, Creation_TakesTheFrame) {
    EXPECT_EQ(makeView()->frame(), (Rect{0.0, 0.0, 320.0, 50.0}));
}

TEST_F(KTRVelaBaseViewTest, TextSizeAndDirection_AreReadOnceAtCreation) {
    const auto plain = makeView();
    device->category = ContentSizeCategory::AX1;
    assistant->rightToLeft = true;
    const auto large = makeView();
    EXPECT_FALSE(plain->axSize());
    EXPECT_FALSE(plain->isRTLUI());
    EXPECT_TRUE(large->axSize());
    EXPECT_TRUE(large->isRTLUI());
}

TEST_F(KTRVelaBaseViewTest, LargestOrdinaryTextSize_IsNoAccessibilitySize) {
    device->category = ContentSizeCategory::XXXL;
    EXPECT_FALSE(makeView()->axSize());
}

TEST_F(KTRVelaBaseViewTest, BaseHasNoUrlAndNoHeight) {
    const auto view = makeView();
    EXPECT_FALSE(view->urlForTouch().has_value());
    EXPECT_EQ(view->estimagedHeightForView(), 0.0);
}

TEST_F(KTRVelaBaseViewTest, TapOnBase_DoesNothingAndLogsNothing) {
    const auto view = makeView();
    const auto opener = std::make_shared<Opener>();
    view->setUrlHandler(opener);
    ASSERT_EQ(view->gestureRecognizers().size(), 1u);
    view->gestureRecognizers().front()->fire();
    EXPECT_TRUE(opener->opened.empty());
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(KTRVelaBaseViewTest, Tap_OpensTheSubclassesUrlAndLogsIt) {
    const auto view = makeRow();
    const auto opener = std::make_shared<Opener>();
    view->setUrlHandler(opener);
    view->gestureRecognizers().front()->fire();
    EXPECT_EQ(opener->opened, std::vector<std::string>{"wayloc://test/"});
    ASSERT_EQ(log->lines().size(), 1u);
    EXPECT_EQ(log->lines().front().format, "Opening URL: %@");
    EXPECT_TRUE(log->has(LogLevel::Default, "Opening URL: wayloc://test/"));
}

TEST_F(KTRVelaBaseViewTest, Tap_HandlerGone_IsIgnored) {
    const auto view = makeRow();
    auto opener = std::make_shared<Opener>();
    view->setUrlHandler(opener);
    opener.reset();
    view->viewTouched();
    EXPECT_EQ(view->urlHandler(), nullptr);
    EXPECT_TRUE(log->has(LogLevel::Default, "Opening URL: wayloc://test/"));
}

TEST_F(KTRVelaBaseViewTest, RecognizerOutlivesView_FiresIntoNothing) {
    auto view = makeRow();
    const auto recognizer = view->gestureRecognizers().front();
    const std::weak_ptr<View> gone = view;
    view.reset();
    EXPECT_TRUE(gone.expired());
    recognizer->fire();
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(KTRVelaBaseViewTest, Press_DimsUntilItEnds) {
    const auto view = makeView();
    view->touchesBegan({}, {});
    EXPECT_EQ(view->backgroundColor(), dimmed_);
    view->touchesEnded({}, {});
    EXPECT_EQ(view->backgroundColor(), Color::clear());
}

TEST_F(KTRVelaBaseViewTest, Press_SlidesOffIntoScroll_ClearsHighlightAndOpensNothing) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto view = makeRow();
    const auto opener = std::make_shared<Opener>();
    view->setUrlHandler(opener);
    window->addSubview(view);
    TouchDispatcher dispatcher{std::weak_ptr<View>(window)};
    dispatcher.press({10.0, 10.0}, 0.0);
    EXPECT_EQ(view->backgroundColor(), dimmed_);
    dispatcher.move({10.0, 60.0}, 0.1);
    EXPECT_EQ(view->backgroundColor(), Color::clear());
    dispatcher.release({10.0, 60.0}, 0.2);
    EXPECT_TRUE(opener->opened.empty());
}

TEST_F(KTRVelaBaseViewTest, Touches_GoOnToTheSuperview) {
    const auto parent = create<TouchRecorder>(&TouchRecorder::initWithFrame, Rect{0.0, 0.0, 320.0, 100.0});
    const auto view = makeView();
    parent->addSubview(view);
    view->touchesBegan({}, {});
    view->touchesEnded({}, {});
    view->touchesCancelled({}, {});
    EXPECT_EQ(parent->heard, (std::vector<std::string>{"began", "ended", "cancelled"}));
}

TEST_F(KTRVelaBaseViewTest, SizeForText_NoWidthOrNoText_IsZero) {
    const auto view = makeView();
    for (const double width : {0.0, -1.0, -1e300, std::nan("")}) {
        EXPECT_EQ(view->sizeForText(text("abc"), width), Size{}) << width;
    }
    EXPECT_EQ(view->sizeForText(text(""), 100.0), Size{});
    EXPECT_EQ(view->sizeForText({}, 100.0), Size{});
}

TEST_F(KTRVelaBaseViewTest, SizeForText_PaddingIsPartOfTheUsedWidth) {
    // Four glyphs of 10 points, half a point at either end; a line of 10 points is 14 high.
    EXPECT_EQ(makeView()->sizeForText(text("abcd"), 100.0), (Size{41.0, 14.0}));
}

TEST_F(KTRVelaBaseViewTest, SizeForText_PaddingNarrowsTheLine) {
    const auto view = makeView();
    EXPECT_EQ(view->sizeForText(text("ab cd"), 51.0).height, 14.0);
    EXPECT_EQ(view->sizeForText(text("ab cd"), 50.0).height, 28.0);
}

TEST_F(KTRVelaBaseViewTest, SizeForText_AvoidsExclusionPaths) {
    const auto view = makeView();
    EXPECT_EQ(view->sizeForText(text("ab cd"), 60.0).height, 14.0);
    EXPECT_EQ(view->sizeForText(text("ab cd"), 60.0, {Rect{0.0, 0.0, 20.0, 14.0}}).height, 28.0);
}

TEST_F(KTRVelaBaseViewTest, MapHeight_FollowsTheIdiom) {
    const std::vector<std::pair<std::optional<UserInterfaceIdiom>, double>> cases = {
        {UserInterfaceIdiom::Phone, 219.0},
        {UserInterfaceIdiom::Tablet, 389.0},
        {UserInterfaceIdiom::Desktop, 219.0},
        {UserInterfaceIdiom::Display, 219.0},
        {std::nullopt, 219.0},
    };
    for (const auto& [idiom, height] : cases) {
        device->idiom = idiom;
        EXPECT_EQ(KTRVelaBaseView::mapHeight(), height);
    }
}

}  // namespace ktr
