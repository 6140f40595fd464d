#include "views/KTRVelaSingleLabelView.h"

#include "model/KTRVATheme.h"
#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;

/// Subheadline at L is 13 points: lines are 18 high.
class KTRVelaSingleLabelViewTest : public test::PlatformTest {
  protected:
    std::shared_ptr<KTRVelaSingleLabelView> makeView(double width = 320.0) {
        auto view = create<KTRVelaSingleLabelView>(&KTRVelaSingleLabelView::initWithFrame, Rect{0.0, 0.0, width, 0.0});
        window_->addSubview(view);
        return view;
    }
    /// Gives the view its own height and lays it out.
    static void layOut(const std::shared_ptr<KTRVelaSingleLabelView>& view) {
        view->setFrame({0.0, 0.0, view->frame().width, view->estimagedHeightForView()});
        view->layoutIfNeeded();
    }

    std::shared_ptr<Window> window_ = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
};

TEST_F(KTRVelaSingleLabelViewTest, Label_IsMadeAtOnce) {
    const auto label = makeView()->label();
    ASSERT_NE(label, nullptr);
    EXPECT_EQ(label->font(), preferredFont(TextStyle::Subheadline));
    EXPECT_EQ(label->textColor(), KTRVATheme::friendLocationTextColor());
    EXPECT_EQ(label->backgroundColor(), Color::clear());
    EXPECT_EQ(label->numberOfLines(), 0);
    EXPECT_EQ(label->lineBreakMode(), LineBreakMode::WordWrapping);
    EXPECT_EQ(label->textAlignment(), TextAlignment::Center);
    EXPECT_EQ(label->contentCompressionResistancePriority(LayoutAxis::Horizontal), 1000.0);
    EXPECT_EQ(label->contentCompressionResistancePriority(LayoutAxis::Vertical), 1000.0);
    EXPECT_EQ(label->contentHuggingPriority(LayoutAxis::Horizontal), 250.0);
    EXPECT_EQ(label->contentHuggingPriority(LayoutAxis::Vertical), 1000.0);
    EXPECT_FALSE(label->translatesAutoresizingMaskIntoConstraints());
}

TEST_F(KTRVelaSingleLabelViewTest, AccessibilitySize_StillHasItsLabel) {
    device->category = ContentSizeCategory::AX3;
    EXPECT_NE(makeView()->label(), nullptr);
}

TEST_F(KTRVelaSingleLabelViewTest, Message_StandsAtTheLeadingEdgeAndIgnoresTaps) {
    const auto view = makeView();
    view->setLabelText("Locating");
    EXPECT_EQ(view->labelText(), "Locating");
    EXPECT_EQ(view->label()->text(), "Locating");
    EXPECT_EQ(view->label()->textAlignment(), TextAlignment::Natural);
    EXPECT_FALSE(view->urlForTouch().has_value());
    view->viewTouched();
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(KTRVelaSingleLabelViewTest, Message_LeftToRight_ExactRectangles) {
    const auto view = makeView();
    view->setLabelText("Locating");
    layOut(view);
    EXPECT_EQ(view->frame(), (Rect{0.0, 0.0, 320.0, 48.0}));
    EXPECT_EQ(view->label()->frame(), (Rect{15.0, 15.0, 290.0, 18.0}));
    EXPECT_EQ(view->label()->drawnTextRect(), (Rect{0.0, 0.0, 104.0, 18.0}));
}

TEST_F(KTRVelaSingleLabelViewTest, Message_RightToLeft_ExactRectangles) {
    assistant->rightToLeft = true;
    const auto view = makeView();
    view->setLabelText("Locating");
    layOut(view);
    EXPECT_EQ(view->label()->frame(), (Rect{15.0, 15.0, 290.0, 18.0}));
    EXPECT_EQ(view->label()->drawnTextRect(), (Rect{186.0, 0.0, 104.0, 18.0}));
}

TEST_F(KTRVelaSingleLabelViewTest, ShowAll_IsCentredAndOpensTheList) {
    const auto view = makeView();
    view->setIsShowAll(true);
    view->setLabelText("Show all");
    layOut(view);
    EXPECT_EQ(view->label()->drawnTextRect(), (Rect{93.0, 0.0, 104.0, 18.0}));
    ASSERT_TRUE(view->urlForTouch().has_value());
    EXPECT_EQ(view->urlForTouch()->text(), "wayloc://friends/");
}

TEST_F(KTRVelaSingleLabelViewTest, FlagAfterText_DoesNotRealign_IsKept) {
    const auto view = makeView();
    view->setLabelText("Show all");
    view->setIsShowAll(true);
    EXPECT_EQ(view->label()->textAlignment(), TextAlignment::Natural);
    view->setLabelText("Show all");
    EXPECT_EQ(view->label()->textAlignment(), TextAlignment::Center);
    view->setIsShowAll(false);
    EXPECT_EQ(view->label()->textAlignment(), TextAlignment::Center);
}

TEST_F(KTRVelaSingleLabelViewTest, Height_EmptyText_IsTheMarginsAlone) {
    EXPECT_EQ(makeView()->estimagedHeightForView(), 30.0);
}

TEST_F(KTRVelaSingleLabelViewTest, Height_NoRoomForText_IsTheMarginsAlone) {
    for (const double width : {0.0, 10.0, 30.0}) {
        const auto view = makeView(width);
        view->setLabelText("Locating");
        EXPECT_EQ(view->estimagedHeightForView(), 30.0) << width;
    }
}

TEST_F(KTRVelaSingleLabelViewTest, Height_CountsWrappedLines) {
    // 53 points: what is left between the margins and the padding is four glyphs of 13.
    const auto view = makeView(83.0);
    view->setLabelText("abcd abc ab");
    EXPECT_EQ(view->estimagedHeightForView(), 84.0);
}

TEST_F(KTRVelaSingleLabelViewTest, Height_FollowsTheFrame) {
    const auto view = makeView(83.0);
    view->setLabelText("abcd abc");
    EXPECT_EQ(view->estimagedHeightForView(), 66.0);
    view->setFrame({0.0, 0.0, 320.0, 66.0});
    EXPECT_EQ(view->estimagedHeightForView(), 48.0);
}

TEST_F(KTRVelaSingleLabelViewTest, WrappedText_FillsTheRow) {
    const auto view = makeView(83.0);
    view->setLabelText("abcd abc ab");
    layOut(view);
    EXPECT_EQ(view->label()->frame(), (Rect{15.0, 15.0, 53.0, 54.0}));
}

TEST_F(KTRVelaSingleLabelViewTest, LabelAbsent_TextIsKeptAndNothingElse) {
    const auto view = makeView();
    view->setLabel(nullptr);
    view->setLabelText("Locating");
    EXPECT_EQ(view->labelText(), "Locating");
    EXPECT_EQ(view->estimagedHeightForView(), 30.0);
}

TEST_F(KTRVelaSingleLabelViewTest, Accessibility_MessageIsText) {
    const auto view = makeView();
    view->setLabelText("Locating");
    layOut(view);
    const auto tree = accessibilityTree(window_, false);
    ASSERT_EQ(tree.children.size(), 1u);
    EXPECT_EQ(tree.children[0].role, AccessibilityRole::Text);
    EXPECT_EQ(tree.children[0].text, "Locating");
    EXPECT_FALSE(tree.children[0].pressable);
}

TEST_F(KTRVelaSingleLabelViewTest, Accessibility_ShowAllIsLinkWithItsText) {
    const auto view = makeView();
    view->setIsShowAll(true);
    view->setLabelText("Show all");
    layOut(view);
    const auto tree = accessibilityTree(window_, false);
    ASSERT_EQ(tree.children.size(), 1u);
    EXPECT_EQ(tree.children[0].role, AccessibilityRole::Link);
    EXPECT_TRUE(tree.children[0].pressable);
    EXPECT_TRUE(tree.children[0].children.empty());
    EXPECT_EQ(tree.children[0].text, "Show all");
    EXPECT_TRUE(accessibilityPress(tree.children[0]));
    EXPECT_TRUE(log->has(LogLevel::Default, "Opening URL: wayloc://friends/"));
}

}  // namespace ktr
