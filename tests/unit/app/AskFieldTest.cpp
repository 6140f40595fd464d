// What the field does with questions besides sending them.
#include "app/window/AskField.h"

#include <QKeyEvent>
#include <memory>

#include "host/Host.h"
#include "host/HostOptions.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class KTRAskFieldTest : public ::testing::Test {
  protected:
    void SetUp() override {
        const auto settings = host::HostSettings::decide(host::HostOptions(), {}, {});
        auto made =
            host::Host::make(std::get<host::HostSettings>(settings), host::Host::Time::Virtual, KTR_PLUGIN_FILE);
        ASSERT_TRUE(std::holds_alternative<std::unique_ptr<host::Host>>(made));
        host_ = std::move(std::get<std::unique_ptr<host::Host>>(made));
        field = std::make_unique<AskField>(AskField::Texts{"Ask", "Send", "Ask", "Stop asking"});
        field->setAnimated(false);
        field->resize(400, 62);
        field->setAsked([this](const std::string& question) { asked.push_back(question); });
        field->setStopped([this] { ++stopped; });
    }
    void TearDown() override {
        field = nullptr;
        host_ = nullptr;
    }
    void send(const char* question) {
        field->edit().setText(QString::fromUtf8(question));
        field->button().click();
    }
    bool press(int key) { return field->recall(QKeyEvent(QEvent::KeyPress, key, Qt::NoModifier)); }
    std::string text() const { return field->edit().text().toStdString(); }

    std::unique_ptr<host::Host> host_;
    std::unique_ptr<AskField> field;
    std::vector<std::string> asked;
    int stopped = 0;
};

}  // namespace

TEST_F(KTRAskFieldTest, Up_BringsBackWhatWasAsked_AndDownComesForward) {
    EXPECT_FALSE(press(Qt::Key_Up)) << "nothing was asked";
    send("Where is Ann?");
    send("Where is Otto?");
    send("Where is Otto?");
    EXPECT_TRUE(press(Qt::Key_Up));
    EXPECT_EQ(text(), "Where is Otto?");
    EXPECT_TRUE(press(Qt::Key_Up));
    EXPECT_EQ(text(), "Where is Ann?");
    EXPECT_FALSE(press(Qt::Key_Up));
    EXPECT_TRUE(press(Qt::Key_Down));
    EXPECT_EQ(text(), "Where is Otto?");
    EXPECT_TRUE(press(Qt::Key_Down));
    EXPECT_EQ(text(), "");
    EXPECT_FALSE(press(Qt::Key_Down));
    EXPECT_FALSE(press(Qt::Key_PageUp));
}

TEST_F(KTRAskFieldTest, Up_TakesNothingThatIsBeingTyped) {
    send("Where is Ann?");
    field->edit().setText(QStringLiteral("Wh"));
    EXPECT_FALSE(press(Qt::Key_Up));
    EXPECT_EQ(text(), "Wh");
}

TEST_F(KTRAskFieldTest, OfferedQuestion_StandsReadyToBeSent_AndIsWithdrawnUnlessChanged) {
    field->offer("Where is Ann?");
    EXPECT_EQ(text(), "Where is Ann?");
    EXPECT_FALSE(field->edit().hasSelectedText());
    EXPECT_TRUE(field->button().isEnabled());
    field->withdraw();
    EXPECT_EQ(text(), "");
    field->offer("Where is Ann?");
    field->edit().setText(QStringLiteral("Where is Anna?"));
    field->withdraw();
    EXPECT_EQ(text(), "Where is Anna?");
    field->offer("Where is Otto?");
    EXPECT_EQ(text(), "Where is Anna?") << "something else was typed meanwhile";
}

TEST_F(KTRAskFieldTest, WhileAsking_TheButtonStops_UntilSomethingIsTyped) {
    EXPECT_FALSE(field->button().isEnabled());
    field->setAsking(true);
    EXPECT_TRUE(field->button().isEnabled());
    EXPECT_EQ(field->button().accessibleName(), QStringLiteral("Stop asking"));
    field->button().click();
    EXPECT_EQ(stopped, 1);
    field->edit().setText(QStringLiteral("Where is Otto?"));
    EXPECT_EQ(field->button().accessibleName(), QStringLiteral("Send"));
    field->button().click();
    EXPECT_EQ(asked, (std::vector<std::string>{"Where is Otto?"}));
    EXPECT_EQ(stopped, 1);
    field->setAsking(false);
    EXPECT_FALSE(field->button().isEnabled());
    EXPECT_EQ(field->button().accessibleName(), QStringLiteral("Send"));
}

}  // namespace ktr::app
