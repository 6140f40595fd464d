// The live window: what its parts take of it, and what it asks of nobody while a page covers the conversation.
#include "app/window/ConversationWindow.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <QTemporaryDir>
#include <fstream>
#include <functional>
#include <memory>

#include "host/scenario/ScenarioReader.h"
#include "linux/configuration/ConfigurationReader.h"
#include "tests/support/EnvironmentVariable.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

/// Both timers of the card fire after a tenth of a second.
constexpr const char* kFriends =
    R"({"sentence": "Here they are.", "snippet": {"kind": "VAKtrLocationSnippet", "proximity": "here", "searchContext":
    "ktrServerContext://serverContext?minCallbackIntervalInMS=100&callbackTimeoutIntervalInMS=60000&", "locations": [
    {"friend": {"data": "ann@harbour.example", "object": {"fullName": "Ann Marsh",
     "emails": [{"emailAddress": "ann@harbour.example"}]}}},
    {"friend": {"data": "otto@mail.example", "object": {"fullName": "Otto Brandt",
     "emails": [{"emailAddress": "otto@mail.example"}]}}}]}})";

class KTRConversationWindowTest : public ::testing::Test {
  protected:
    KTRConversationWindowTest()
        : state("XDG_STATE_HOME", folder.filePath(QStringLiteral("state")).toUtf8().constData()) {
        std::ofstream(file()) << R"({"account": {"personId": "1000", "host": "service.example"},
                                     "positions": {"source": "none"}, "language": "en-GB"})";
    }
    std::string file() const { return folder.filePath(QStringLiteral("config.json")).toStdString(); }
    void open(platform::ContentSizeCategory size = platform::ContentSizeCategory::L) {
        window.reset();
        host.reset();
        host::HostSettings settings;
        settings.liveConfiguration = file();
        settings.follow(std::get<linux_::Configuration>(linux_::ConfigurationReader::readFile(file())));
        settings.textSize = size;
        auto made = host::Host::make(settings, host::Host::Time::Running, KTR_PLUGIN_FILE);
        ASSERT_TRUE(std::holds_alternative<std::unique_ptr<host::Host>>(made)) << std::get<host::Failure>(made).line;
        host = std::move(std::get<std::unique_ptr<host::Host>>(made));
        bool isReady = false;
        host->live()->start([&isReady] { isReady = true; });
        ASSERT_TRUE(eventually([&isReady] { return isReady; }));
        window = std::make_unique<ConversationWindow>(*host);
        window->openLinks(desktop);
        window->pages().setMotion(host::MotionStyle::None);
        // Nobody has signed in, which is another test's matter.
        window->pages().closeAll();
    }
    void TearDown() override {
        window.reset();
        host.reset();
    }
    static bool eventually(const std::function<bool()>& condition, int milliseconds = 10000) {
        const QDeadlineTimer deadline(milliseconds);
        while (!condition() && !deadline.hasExpired()) {
            QApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents, 20);
        }
        return condition();
    }
    void addCard() {
        const auto read = host::ScenarioReader({0.0}, host::ScenarioReader::Clock::Present).readText(kFriends, "test");
        ASSERT_TRUE(std::holds_alternative<host::Scenario>(read));
        ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
        host->layOut(400.0);
    }
    int asked() const {
        const auto notes = host->live()->service().notes();
        return notes.underWay + notes.failures;
    }

    QTemporaryDir folder;
    test::EnvironmentVariable state;
    linux_::DesktopOpener desktop{QString(), [](const std::string&) { return false; }};
    std::unique_ptr<host::Host> host;
    std::unique_ptr<ConversationWindow> window;
};

}  // namespace

TEST_F(KTRConversationWindowTest, CardsUnderAPage_AskNothingUntilItHasGone) {
    open();
    window->resize(400, 700);
    window->show();
    host->delegate().open(platform::Url("wayloc://friends"));
    ASSERT_TRUE(window->pages().isOpen());
    addCard();
    eventually([] { return false; }, 600);
    EXPECT_EQ(asked(), 0) << "nobody sees the card";
    window->pages().back();
    EXPECT_EQ(asked(), 1) << "its newest question, at once";
}

TEST_F(KTRConversationWindowTest, AFriendsPage_AsksAboutThatFriendAlone) {
    open();
    window->resize(400, 700);
    window->show();
    addCard();
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    const auto* page = dynamic_cast<FriendPage*>(window->pages().current());
    ASSERT_NE(page, nullptr);
    EXPECT_TRUE(page->asksAbout({"ann@harbour.example"}));
    EXPECT_FALSE(page->asksAbout({"otto@mail.example"}));
    EXPECT_FALSE(page->asksAbout({"ann@harbour.example", "otto@mail.example"})) << "that is the card's question";
    EXPECT_FALSE(page->asksAbout({}));
}

TEST_F(KTRConversationWindowTest, QuestionThatIsTooLong_IsNotAskedInPart_AndStaysToBeMadeShorter) {
    open();
    window->resize(400, 700);
    window->show();
    const QString longest(static_cast<int>(host::LiveConversation::kLongestQuestion), u'x');
    const std::size_t before = host->conversation()->turns().size();
    window->field()->edit().setText(longest + u'x');
    window->field()->button().click();
    EXPECT_EQ(window->notice().sentence(), QStringLiteral("That’s too long for a question. Please ask a shorter one."));
    EXPECT_EQ(window->field()->edit().text(), longest + u'x');
    EXPECT_EQ(host->conversation()->turns().size(), before);
    window->field()->edit().setText(longest);
    window->field()->button().click();
    EXPECT_EQ(window->field()->edit().text(), QString()) << "this one is asked";
}

TEST_F(KTRConversationWindowTest, StatusWithoutHelp_HasAButtonWithARealNameAllTheSame) {
    open();
    window->resize(400, 700);
    window->show();
    ASSERT_EQ(window->status()->help().words(), QString());
    EXPECT_FALSE(window->status()->help().isVisible());
    EXPECT_EQ(window->status()->help().accessibleName(), QStringLiteral("Check-up"));
}

TEST_F(KTRConversationWindowTest, EveryShape_FieldAndConversationNeverOverlap) {
    using platform::ContentSizeCategory;
    for (const auto size : {ContentSizeCategory::L, ContentSizeCategory::XXXL, ContentSizeCategory::AX3}) {
        open(size);
        for (const QSize& shape :
             {QSize(320, 200), QSize(320, 239), QSize(320, 240), QSize(400, 300), QSize(900, 200), QSize(1600, 900)}) {
            window->resize(shape);
            window->show();
            QApplication::processEvents();
            ASSERT_EQ(window->size(), shape) << "a window of " << shape.height() << " is possible";
            constexpr int kAround = AskField::kAround;
            const QRect field = window->field()->geometry().adjusted(kAround, kAround, -kAround, -kAround);
            const QRect conversation = window->conversation().geometry();
            EXPECT_GT(conversation.height(), 0);
            EXPECT_FALSE(field.intersects(conversation))
                << shape.width() << "x" << shape.height() << ": field from " << field.y() << ", conversation to "
                << conversation.bottom() << ", size " << static_cast<int>(size);
            EXPECT_TRUE(window->rect().contains(field));
            const bool isLow = shape.height() < 240;
            EXPECT_EQ(window->status()->isVisible(), !isLow) << shape.height();
            if (!isLow) {
                EXPECT_TRUE(window->rect().contains(window->status()->geometry()));
                EXPECT_FALSE(window->status()->geometry().intersects(conversation));
            }
        }
    }
}

}  // namespace ktr::app
