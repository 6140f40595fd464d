#include "platform/ui/TouchDispatcher.h"

#include <string>
#include <vector>

#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

class TouchDispatcherTest : public PlatformTest {
  public:
    class Row : public View {
      public:
        std::vector<std::string> heard;
        void touchesBegan(const Touches& touches, const TouchEvent& event) override {
            heard.emplace_back("began");
            View::touchesBegan(touches, event);
        }
        void touchesEnded(const Touches&, const TouchEvent&) override { heard.emplace_back("ended"); }
        void touchesCancelled(const Touches&, const TouchEvent&) override { heard.emplace_back("cancelled"); }
    };

    std::shared_ptr<Window> window = create<Window>(&View::initWithFrame, Rect{0, 0, 400, 800});
    std::shared_ptr<Row> row = create<Row>(&View::initWithFrame, Rect{0, 0, 400, 78});
    TouchDispatcher dispatcher{window};
    int taps = 0;

    void SetUp() override {
        window->addSubview(row);
        row->addGestureRecognizer(std::make_shared<TapGestureRecognizer>([this] { ++taps; }));
    }
};

TEST_F(TouchDispatcherTest, PressAndRelease_IsATap) {
    dispatcher.press({10, 10}, 0.0);
    dispatcher.move({12, 14}, 0.1);
    dispatcher.release({12, 14}, 0.2);
    EXPECT_EQ(row->heard, (std::vector<std::string>{"began", "ended"}));
    EXPECT_EQ(taps, 1);
}

TEST_F(TouchDispatcherTest, MovingAway_CancelsAndIsNoTap) {
    dispatcher.press({10, 10}, 0.0);
    dispatcher.move({10, 31}, 0.1);
    dispatcher.release({10, 31}, 0.2);
    EXPECT_EQ(row->heard, (std::vector<std::string>{"began", "cancelled"}));
    EXPECT_EQ(taps, 0);
}

TEST_F(TouchDispatcherTest, SecondPress_CancelsTheFirst) {
    dispatcher.press({10, 10}, 0.0);
    dispatcher.press({20, 10}, 0.1);
    dispatcher.release({20, 10}, 0.2);
    EXPECT_EQ(row->heard, (std::vector<std::string>{"began", "cancelled", "began", "ended"}));
    EXPECT_EQ(taps, 1);
}

TEST_F(TouchDispatcherTest, ViewThatGoesWhilePressed_IsForgotten) {
    dispatcher.press({10, 10}, 0.0);
    row->removeFromSuperview();
    row.reset();
    EXPECT_FALSE(dispatcher.isPressed());
    dispatcher.release({10, 10}, 0.2);
    EXPECT_EQ(taps, 0);
}

TEST_F(TouchDispatcherTest, PressOutsideEverything_DoesNothing) {
    dispatcher.press({1000, 10}, 0.0);
    EXPECT_FALSE(dispatcher.isPressed());
}

TEST_F(TouchDispatcherTest, TapOnAViewWithoutRecognizer_GoesToItsAncestor) {
    const auto child = create<View>(&View::initWithFrame, Rect{0, 0, 20, 20});
    row->addSubview(child);
    dispatcher.press({10, 10}, 0.0);
    dispatcher.release({10, 10}, 0.1);
    EXPECT_EQ(taps, 1);
    EXPECT_EQ(row->heard.front(), "began");
}

}  // namespace ktr::test
