#include "platform/ui/View.h"

#include "platform/ui/Label.h"
#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

using namespace platform;

class ViewTest : public PlatformTest {
  public:
    static std::shared_ptr<View> view(const Rect& frame) { return create<View>(&View::initWithFrame, frame); }

    struct Client : WindowClient {
        std::vector<Rect> dirty;
        int layouts = 0;
        void windowNeedsDisplay(const Rect& rect) override { dirty.push_back(rect); }
        void windowNeedsLayout() override { ++layouts; }
    };

    std::shared_ptr<Window> window = create<Window>(&View::initWithFrame, Rect{0, 0, 400, 800});
    std::shared_ptr<Client> client = std::make_shared<Client>();
    void SetUp() override { window->setClient(client); }
};

TEST_F(ViewTest, AddSubview_MovesFromTheFormerSuperview) {
    const auto a = view({});
    const auto b = view({});
    const auto child = view({});
    a->addSubview(child);
    b->addSubview(child);
    EXPECT_TRUE(a->subviews().empty());
    EXPECT_EQ(child->superview(), b);
}

TEST_F(ViewTest, NeedForLayout_IsToldToTheWindowOnceUntilItHasLaidOut) {
    const auto outer = view({0, 0, 100, 100});
    const auto inner = view({0, 0, 10, 10});
    outer->addSubview(inner);
    inner->setNeedsLayout();
    window->addSubview(outer);
    window->layoutIfNeeded();
    client->layouts = 0;
    inner->setNeedsLayout();
    inner->setNeedsLayout();
    EXPECT_EQ(client->layouts, 1);
    window->layoutIfNeeded();
    EXPECT_EQ(client->layouts, 1);
    inner->setNeedsLayout();
    EXPECT_EQ(client->layouts, 2);
    // Nobody is told of a tree that has left.
    outer->removeFromSuperview();
    window->layoutIfNeeded();
    client->layouts = 0;
    inner->setNeedsLayout();
    EXPECT_EQ(client->layouts, 0);
}

TEST_F(ViewTest, AddSubview_OfItselfOrAnAncestor_DoesNothing) {
    const auto a = view({});
    const auto b = view({});
    a->addSubview(b);
    b->addSubview(a);
    b->addSubview(b);
    b->addSubview(nullptr);
    EXPECT_TRUE(b->subviews().empty());
    EXPECT_EQ(a->superview(), nullptr);
}

TEST_F(ViewTest, Superview_IsHeldWeakly) {
    const auto child = view({});
    {
        const auto parent = view({});
        parent->addSubview(child);
    }
    EXPECT_EQ(child->superview(), nullptr);
}

TEST_F(ViewTest, Window_IsTheRootOfTheTree_AndNoneWithoutOne) {
    const auto a = view({});
    const auto b = view({});
    a->addSubview(b);
    EXPECT_EQ(b->window(), nullptr);
    window->addSubview(a);
    EXPECT_EQ(b->window(), window);
    a->removeFromSuperview();
    EXPECT_EQ(b->window(), nullptr);
}

TEST_F(ViewTest, FrameInRoot_AddsUpOrigins) {
    const auto a = view({10, 20, 100, 100});
    const auto b = view({1, 2, 30, 40});
    window->addSubview(a);
    a->addSubview(b);
    EXPECT_EQ(b->frameInRoot(), (Rect{11, 22, 30, 40}));
}

TEST_F(ViewTest, SetBackgroundColor_AsksToPaintOnlyTheView_AndOnlyOnChange) {
    const auto a = view({10, 20, 100, 50});
    window->addSubview(a);
    client->dirty.clear();
    a->setBackgroundColor(Color::white(0.0, 0.2));
    ASSERT_EQ(client->dirty.size(), 1U);
    EXPECT_EQ(client->dirty[0], (Rect{10, 20, 100, 50}));
    a->setBackgroundColor(Color::white(0.0, 0.2));
    EXPECT_EQ(client->dirty.size(), 1U);
}

TEST_F(ViewTest, HiddenView_AsksForNoPainting) {
    const auto a = view({10, 20, 100, 50});
    const auto b = view({0, 0, 10, 10});
    a->addSubview(b);
    window->addSubview(a);
    a->setHidden(true);
    client->dirty.clear();
    b->setBackgroundColor(Color::white(0.0, 1.0));
    EXPECT_TRUE(client->dirty.empty());
}

TEST_F(ViewTest, Paint_SkipsWhatIsHiddenOrOutside) {
    const auto near = view({0, 0, 10, 10});
    const auto far = view({0, 700, 10, 10});
    const auto hidden = view({0, 0, 10, 10});
    for (const auto& child : {near, far, hidden}) {
        child->setBackgroundColor(Color::white(0.5, 1.0));
        window->addSubview(child);
    }
    hidden->setHidden(true);
    RecordingCanvas canvas;
    window->paint(canvas, {0, 0, 400, 100});
    ASSERT_EQ(canvas.calls.size(), 1U);
    EXPECT_EQ(canvas.calls[0].rect, (Rect{0, 0, 10, 10}));
}

TEST_F(ViewTest, BringSubviewToFront_IsPaintedLastAndHitFirst) {
    const auto a = view({0, 0, 10, 10});
    const auto b = view({0, 0, 10, 10});
    window->addSubview(a);
    window->addSubview(b);
    EXPECT_EQ(window->hitTest({5, 5}), b);
    window->bringSubviewToFront(a);
    EXPECT_EQ(window->hitTest({5, 5}), a);
    EXPECT_EQ(window->subviews().back(), a);
}

TEST_F(ViewTest, HitTest_PassesOverHiddenAndUntouchableViews) {
    const auto a = view({0, 0, 10, 10});
    const auto label = create<Label>(&View::initWithFrame, Rect{0, 0, 10, 10});
    a->addSubview(label);
    window->addSubview(a);
    EXPECT_EQ(window->hitTest({5, 5}), a);
    a->setHidden(true);
    EXPECT_EQ(window->hitTest({5, 5}), window);
    EXPECT_EQ(window->hitTest({500, 5}), nullptr);
}

}  // namespace ktr::test
