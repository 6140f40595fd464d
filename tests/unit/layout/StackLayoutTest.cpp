// Where a stack puts its arranged subviews.
#include <algorithm>
#include <random>

#include "platform/layout/LayoutConstraint.h"
#include "platform/ui/Label.h"
#include "platform/ui/StackView.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"
#include "tests/unit/layout/PrintRect.h"

namespace ktr::test {

using namespace platform;

class StackLayoutTest : public PlatformTest {
  protected:
    /// A view that says itself how high it is.
    static std::shared_ptr<View> box(double height) {
        const auto view = create<View>(&View::initWithFrame, Rect{});
        view->heightAnchor().constraintEqualToConstant(height)->setActive(true);
        return view;
    }
    std::shared_ptr<Label> label(const std::string& text) {
        const auto made = create<Label>(&Label::initWithFrame, Rect{});
        made->setFont({FontFace::Text, FontWeight::Regular, 10.0});  // lines of 14
        made->setNumberOfLines(0);
        made->setLineBreakMode(LineBreakMode::WordWrapping);
        made->setText(text);
        return made;
    }

    std::shared_ptr<StackView> stack = create<StackView>(&StackView::initWithFrame, Rect{5, 5, 200, 100});
};

TEST_F(StackLayoutTest, OneUnderTheOther_AsWideAsTheStack_TheLastTakesTheRest) {
    const auto a = box(20);
    const auto b = box(30.5);
    stack->addArrangedSubview(a);
    stack->addArrangedSubview(b);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 20}));
    EXPECT_EQ(b->frame(), (Rect{0, 20, 200, 80}));
}

TEST_F(StackLayoutTest, FillEvenly_AllHaveTheSameOfWhatIsLeft) {
    stack->setDistribution(StackView::Distribution::FillEvenly);
    const auto a = box(20);
    const auto b = box(30);
    const auto c = box(10);
    for (const auto& view : {a, b, c}) {
        stack->addArrangedSubview(view);
    }
    c->setHidden(true);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 45}));
    EXPECT_EQ(b->frame(), (Rect{0, 45, 200, 55}));
    c->setHidden(false);
    stack->setFrame({5, 5, 200, 120});
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 40}));
    EXPECT_EQ(c->frame(), (Rect{0, 90, 200, 30}));
    stack->setFrame({5, 5, 200, 50});
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 20}));
    EXPECT_EQ(c->frame(), (Rect{0, 50, 200, 10}));
}

TEST_F(StackLayoutTest, HigherThanTheStack_GoesBeyondIt) {
    const auto a = box(70);
    const auto b = box(60);
    stack->addArrangedSubview(a);
    stack->addArrangedSubview(b);
    stack->layoutIfNeeded();
    EXPECT_EQ(b->frame(), (Rect{0, 70, 200, 60}));
}

TEST_F(StackLayoutTest, Hidden_TakesNoRoomUntilItIsShown) {
    const auto a = box(20);
    const auto b = box(30);
    const auto c = box(10);
    for (const auto& view : {a, b, c}) {
        stack->addArrangedSubview(view);
    }
    b->setHidden(true);
    c->setHidden(true);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 100}));
    EXPECT_EQ(stack->systemLayoutSizeFitting({200, 0}, 1000, 1).height, 20.0);
    b->setHidden(false);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 20}));
    EXPECT_EQ(b->frame(), (Rect{0, 20, 200, 80}));
    EXPECT_EQ(stack->systemLayoutSizeFitting({200, 0}, 1000, 1).height, 50.0);
}

TEST_F(StackLayoutTest, Order_IsThatOfTheArrangement) {
    const auto a = box(20);
    const auto b = box(30);
    stack->addArrangedSubview(a);
    stack->insertArrangedSubview(b, 0);
    stack->layoutIfNeeded();
    EXPECT_EQ(b->frame().y, 0.0);
    EXPECT_EQ(a->frame().y, 30.0);
    stack->insertArrangedSubview(a, 0);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->frame().y, 0.0);
    EXPECT_EQ(b->frame().y, 20.0);
}

TEST_F(StackLayoutTest, NotArranged_IsNotLaidOut) {
    const auto a = box(20);
    const auto b = box(30);
    stack->addArrangedSubview(a);
    stack->addArrangedSubview(b);
    stack->layoutIfNeeded();
    stack->removeArrangedSubview(a);
    stack->layoutIfNeeded();
    EXPECT_EQ(a->superview(), stack);
    EXPECT_EQ(a->frame(), (Rect{0, 0, 200, 20}));
    EXPECT_EQ(b->frame(), (Rect{0, 0, 200, 100}));
}

TEST_F(StackLayoutTest, ChangedWhileNotArranged_IsLaidOutWhenItIsBack) {
    const auto row = create<View>(&View::initWithFrame, Rect{});
    const auto text = label("one");
    text->setTranslatesAutoresizingMaskIntoConstraints(false);
    row->addSubview(text);
    for (const auto attribute :
         {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Left, LayoutAttribute::Right}) {
        text->anchor(attribute).constraintEqualTo(row->anchor(attribute))->setActive(true);
    }
    const auto last = box(1);
    stack->addArrangedSubview(row);
    stack->addArrangedSubview(last);
    stack->layoutIfNeeded();
    EXPECT_EQ(text->frame(), (Rect{0, 0, 200, 14}));
    stack->removeArrangedSubview(row);
    text->setText("one two three four five six");  // 270 points: two lines
    stack->layoutIfNeeded();
    EXPECT_EQ(text->frame(), (Rect{0, 0, 200, 14}));
    stack->insertArrangedSubview(row, 0);
    stack->layoutIfNeeded();
    EXPECT_EQ(row->frame(), (Rect{0, 0, 200, 28}));
    EXPECT_EQ(text->frame(), (Rect{0, 0, 200, 28}));
    EXPECT_EQ(last->frame().y, 28.0);
}

TEST_F(StackLayoutTest, Label_IsAsHighAsItsTextAtTheStacksWidth) {
    const auto text = label(std::string(15, 'x') + " " + std::string(15, 'x'));
    const auto last = box(1);
    stack->addArrangedSubview(text);
    stack->addArrangedSubview(last);
    stack->layoutIfNeeded();
    EXPECT_EQ(text->frame(), (Rect{0, 0, 200, 28}));
    stack->setFrame({0, 0, 320, 100});
    stack->layoutIfNeeded();
    EXPECT_EQ(text->frame(), (Rect{0, 0, 320, 14}));
    EXPECT_EQ(last->frame().y, 14.0);
    text->setText("x\nx\nx");
    stack->layoutIfNeeded();
    EXPECT_EQ(text->frame(), (Rect{0, 0, 320, 42}));
    EXPECT_EQ(last->frame().y, 42.0);
}

TEST_F(StackLayoutTest, StackInAStack_IsAsHighAsItsContent) {
    const auto inner = create<StackView>(&StackView::initWithFrame, Rect{});
    inner->addArrangedSubview(box(20));
    inner->addArrangedSubview(box(25));
    const auto last = box(1);
    stack->addArrangedSubview(inner);
    stack->addArrangedSubview(last);
    stack->layoutIfNeeded();
    EXPECT_EQ(inner->frame(), (Rect{0, 0, 200, 45}));
    EXPECT_EQ(inner->arrangedSubviews().back()->frame(), (Rect{0, 20, 200, 25}));
    EXPECT_EQ(last->frame().y, 45.0);
}

TEST_F(StackLayoutTest, Empty_HasNoHeight) {
    stack->layoutIfNeeded();
    EXPECT_EQ(stack->systemLayoutSizeFitting({200, 70}, 1000, 1), (Size{200, 0}));
}

/// Only what changed is placed again; the outcome is that of a stack that was made so from the start.
TEST_F(StackLayoutTest, AnyChanges_EndWhereAFreshStackBegins) {
    std::mt19937 random(20260117);
    const auto below = [&random](unsigned limit) { return static_cast<std::size_t>(random() % limit); };
    std::vector<std::shared_ptr<Label>> labels;
    for (int i = 0; i < 60; ++i) {
        labels.push_back(label("text"));
        stack->addArrangedSubview(labels.back());
    }
    for (int round = 0; round < 300; ++round) {
        for (std::size_t changes = below(4); changes > 0; --changes) {
            const auto& one = labels[below(60)];
            switch (below(5)) {
                case 0:
                    one->setHidden(!one->hidden());
                    break;
                case 1:
                    stack->insertArrangedSubview(one, below(60));
                    break;
                case 2:
                    stack->removeArrangedSubview(one);
                    break;
                case 3:
                    stack->setFrame({5, 5, below(2) == 0 ? 200.0 : 150.0, 10.0 * static_cast<double>(below(100))});
                    break;
                default:
                    one->setText(std::string(1 + below(50), 'x'));
                    break;
            }
        }
        stack->layoutIfNeeded();
        const Size fitting = stack->systemLayoutSizeFitting({stack->frame().width, 0}, 1000, 1);
        double y = 0.0;
        std::shared_ptr<View> last;
        for (const auto& view : stack->arrangedSubviews()) {
            if (view->hidden()) {
                continue;
            }
            const double width = stack->frame().width;
            const double height = view->systemLayoutSizeFitting({width, 0}, 1000, 1).height;
            ASSERT_EQ(view->frame().origin(), (Point{0, y})) << "round " << round;
            ASSERT_EQ(view->frame().width, width) << "round " << round;
            ASSERT_GE(view->frame().height, height) << "round " << round;
            y += height;
            last = view;
        }
        ASSERT_EQ(fitting.height, y) << "round " << round;
        if (last) {
            ASSERT_DOUBLE_EQ(last->frame().maxY(), std::max(y, stack->frame().height)) << "round " << round;
        }
    }
}

TEST_F(StackLayoutTest, OnlyWhatMayTouchTheDirtyRectangle_IsPainted) {
    std::vector<std::shared_ptr<Label>> labels;
    for (int i = 0; i < 100; ++i) {
        labels.push_back(label("text" + std::to_string(i)));
        stack->addArrangedSubview(labels.back());
    }
    stack->layoutIfNeeded();
    RecordingCanvas canvas;
    stack->paint(canvas, {0, 14 * 40 + 1, 200, 14});
    std::size_t texts = 0;
    for (const auto& call : canvas.calls) {
        texts += call.kind == RecordingCanvas::Call::Kind::Text ? 1 : 0;
    }
    EXPECT_EQ(texts, 2U);  // what is left of one and the beginning of the next
}

}  // namespace ktr::test
