#include "platform/ui/StackView.h"
#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"

namespace ktr::platform {

/// Taking on an arrangement in one step, and letting views go together.
class StackViewArrangementTest : public test::PlatformTest {
  protected:
    using Views = std::vector<std::shared_ptr<View>>;

    static std::shared_ptr<View> makeView() { return create<View>(&View::initWithFrame, Rect{}); }

    std::shared_ptr<StackView> stack_ = create<StackView>(&StackView::initWithFrame, Rect{0.0, 0.0, 100.0, 100.0});
    std::shared_ptr<View> a_ = makeView();
    std::shared_ptr<View> b_ = makeView();
    std::shared_ptr<View> c_ = makeView();
};

TEST_F(StackViewArrangementTest, TakesViewsInOrderAndAddsThem) {
    stack_->setArrangedSubviews({b_, a_});
    EXPECT_EQ(stack_->arrangedSubviews(), (Views{b_, a_}));
    EXPECT_EQ(a_->superview(), stack_);
    EXPECT_EQ(b_->superview(), stack_);
}

TEST_F(StackViewArrangementTest, ReordersWithoutReadding) {
    stack_->setArrangedSubviews({a_, b_, c_});
    stack_->setArrangedSubviews({c_, a_, b_});
    EXPECT_EQ(stack_->arrangedSubviews(), (Views{c_, a_, b_}));
    EXPECT_EQ(stack_->subviews().size(), 3u);
}

TEST_F(StackViewArrangementTest, ViewNoLongerArranged_StaysSubview) {
    stack_->setArrangedSubviews({a_, b_});
    stack_->setArrangedSubviews({b_});
    EXPECT_EQ(stack_->presentedSubviews(), Views{b_});
    EXPECT_EQ(a_->superview(), stack_);
}

TEST_F(StackViewArrangementTest, DuplicatesNoneAndAncestors_AreLeftOut) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 100.0, 100.0});
    window->addSubview(stack_);
    stack_->setArrangedSubviews({a_, nullptr, a_, window, stack_, b_});
    EXPECT_EQ(stack_->arrangedSubviews(), (Views{a_, b_}));
}

TEST_F(StackViewArrangementTest, ViewOfAnotherStack_Moves) {
    const auto other = create<StackView>(&StackView::initWithFrame, Rect{});
    other->setArrangedSubviews({a_, b_});
    stack_->setArrangedSubviews({a_});
    EXPECT_EQ(other->arrangedSubviews(), Views{b_});
    EXPECT_EQ(other->subviews(), Views{b_});
    EXPECT_EQ(a_->superview(), stack_);
}

TEST_F(StackViewArrangementTest, RemoveSubviews_TakesThemOutOfTreeAndArrangement) {
    const auto stranger = makeView();
    stack_->setArrangedSubviews({a_, b_, c_});
    stack_->removeSubviews({c_, nullptr, stranger, a_});
    EXPECT_EQ(stack_->arrangedSubviews(), Views{b_});
    EXPECT_EQ(stack_->subviews(), Views{b_});
    EXPECT_EQ(a_->superview(), nullptr);
    EXPECT_EQ(c_->superview(), nullptr);
    EXPECT_EQ(b_->superview(), stack_);
}

}  // namespace ktr::platform
