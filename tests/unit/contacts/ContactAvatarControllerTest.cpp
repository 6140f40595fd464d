#include "platform/contacts/ContactAvatarController.h"

#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

using namespace platform;

class ContactAvatarControllerTest : public PlatformTest {
  public:
    std::shared_ptr<ContactAvatarController> controller = std::make_shared<ContactAvatarController>();

    std::string painted() const {
        controller->view()->setFrame({0, 0, 54, 54});
        RecordingCanvas canvas;
        controller->view()->paint(canvas, controller->view()->bounds());
        return canvas.calls.size() == 1 ? static_cast<const FakeImage*>(canvas.calls[0].object)->name : "nothing";
    }
};

TEST_F(ContactAvatarControllerTest, BeforeContactsCome_TheBlankFigureIsShown) {
    EXPECT_EQ(painted(), "blank");
}

TEST_F(ContactAvatarControllerTest, FirstContact_IsShown) {
    auto ann = std::make_shared<Contact>();
    ann->identifier = "ann";
    controller->setContacts({ann, std::make_shared<Contact>()});
    EXPECT_EQ(painted(), "avatar ann");
}

TEST_F(ContactAvatarControllerTest, EmptyContact_IsTheBlankFigure) {
    controller->setContacts({std::make_shared<Contact>()});
    EXPECT_EQ(painted(), "blank");
}

TEST_F(ContactAvatarControllerTest, AnotherEmptyContact_IsNotDrawnAgain) {
    struct Screen : WindowClient {
        void windowNeedsDisplay(const Rect&) override { ++redrawn; }
        void windowNeedsLayout() override {}
        int redrawn = 0;
    };
    const auto window = create<Window>(&Window::initWithFrame, Rect{0, 0, 54, 54});
    window->addSubview(controller->view());
    controller->view()->setFrame({0, 0, 54, 54});
    const auto screen = std::make_shared<Screen>();
    window->setClient(screen);
    controller->setContacts({std::make_shared<Contact>()});
    EXPECT_EQ(screen->redrawn, 1);
    controller->setContacts({std::make_shared<Contact>()});
    EXPECT_EQ(screen->redrawn, 1);
    auto ann = std::make_shared<Contact>();
    ann->identifier = "ann";
    controller->setContacts({ann});
    EXPECT_EQ(screen->redrawn, 2);
    controller->setContacts({std::make_shared<Contact>()});
    EXPECT_EQ(screen->redrawn, 3);
}

TEST_F(ContactAvatarControllerTest, View_TakesNoTouches) {
    controller->view()->setFrame({0, 0, 54, 54});
    EXPECT_EQ(controller->view()->hitTest({10, 10}), nullptr);
}

}  // namespace ktr::test
