// The live window: what its parts take of it, and what it asks of nobody while a page covers the conversation.
#include "app/window/ConversationWindow.h"

#include <QAccessible>
#include <QApplication>
#include <QKeyEvent>
#include <QScrollBar>
#include <cmath>
#include <string>

#include "tests/unit/app/LiveWindowFixture.h"
#include "tests/unit/app/TestHost.h"

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

constexpr const char* kAnswer =
    R"({"question": "Where is Ann?", "sentence": "Ann is on Salt Lane, 170 yards away.", "clock":
    "2026-05-16T17:44:00+01:00", "snippet": {"kind": "VAKtrLocationSnippet", "searchContext":
    "ktrServerContext://serverContext?clientId=demo&", "locations": [{"friend": {"data": "ann@harbour.example",
    "object": {"fullName": "Ann Marsh"}}, "latitude": 50.2104, "longitude": -3.12, "accuracy": 30, "ageSeconds": 300,
    "city": "Brinmouth"}]}})";

class KTRConversationWindowTest : public LiveWindowFixture {
  protected:
    int asked() const {
        const auto notes = host->live()->service().notes();
        return notes.underWay + notes.failures;
    }
};

}  // namespace

TEST_F(KTRConversationWindowTest, CardsUnderAPage_AskNothingUntilItHasGone) {
    openWindow({400, 700});
    host->delegate().open(platform::Url("wayloc://friends"));
    ASSERT_TRUE(window->pages().isOpen());
    addTurn(kFriends);
    eventually([] { return false; }, 600);
    EXPECT_EQ(asked(), 0) << "nobody sees the card";
    window->pages().back();
    EXPECT_EQ(asked(), 1) << "its newest question, at once";
}

TEST_F(KTRConversationWindowTest, AFriendsPage_AsksAboutThatFriendAlone) {
    openWindow({400, 700});
    addTurn(kFriends);
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    const auto* page = dynamic_cast<FriendPage*>(window->pages().current());
    ASSERT_NE(page, nullptr);
    EXPECT_TRUE(page->asksAbout({"ann@harbour.example"}));
    EXPECT_FALSE(page->asksAbout({"otto@mail.example"}));
    EXPECT_FALSE(page->asksAbout({"ann@harbour.example", "otto@mail.example"})) << "that is the card's question";
    EXPECT_FALSE(page->asksAbout({}));
}

TEST_F(KTRConversationWindowTest, QuestionThatIsTooLong_IsNotAskedInPart_AndStaysToBeMadeShorter) {
    openWindow({400, 700});
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
    openWindow({400, 700});
    ASSERT_EQ(window->status()->help().words(), QString());
    EXPECT_FALSE(window->status()->help().isVisible());
    EXPECT_EQ(window->status()->help().accessibleName(), QStringLiteral("Check-up"));
}

/// Of a widget's colours beneath a button, the conversation's own ground is the only one; a card's shadow may reach
/// there.
bool isGround(ConversationWindow& window) {
    const QImage picture = window.conversation().grab().toImage().convertToFormat(QImage::Format_RGB32);
    const double side = IconButton::inkSideOf(Icon::Settings);
    QRectF icon(0.0, 0.0, side, side);
    icon.moveCenter(QRectF(window.settings()->geometry()).center());
    const QColor ground = window.conversation().colors().window;
    const QRect bar = window.conversation().findChild<QScrollBar*>()->geometry();
    for (int y = static_cast<int>(icon.top()); y < static_cast<int>(icon.bottom()); ++y) {
        for (int x = static_cast<int>(icon.left()); x < static_cast<int>(icon.right()); ++x) {
            constexpr int kShadow = 16;
            if (bar.contains(x, y)) {
                return false;
            }
            const QColor there = picture.pixelColor(x, y);
            if (std::abs(there.lightness() - ground.lightness()) > kShadow ||
                std::abs(there.red() - ground.red()) > kShadow) {
                return false;
            }
        }
    }
    return true;
}

TEST_F(KTRConversationWindowTest, EveryShape_TheSettingsButtonStandsOnNothingThatIsSaid_AndIsThereAtTheTop) {
    for (const std::string language : {"en-GB", "ar"}) {
        for (const std::string size : {"L", "AX5"}) {
            openWindow({400, 820}, R"(, "language": ")" + language + R"(", "textSize": ")" + size + '"');
            addTurn(kAnswer);
            for (const QSize& shape :
                 {QSize(320, 200), QSize(320, 239), QSize(400, 240), QSize(400, 299), QSize(320, 420), QSize(400, 820),
                  QSize(900, 200), QSize(900, 420), QSize(1100, 300)}) {
                const std::string name =
                    language + "-" + size + "-" + std::to_string(shape.width()) + "x" + std::to_string(shape.height());
                window->resize(shape);
                window->conversation().scrollToNewest();
                QApplication::processEvents();
                keepPicture(*window, "settings-button-" + name);
                const bool isSeen = window->settings()->isVisible();
                EXPECT_EQ(isSeen, isGround(*window)) << name;
                EXPECT_EQ(!isSeen, QAccessible::queryAccessibleInterface(window->settings())->state().invisible);
                window->conversation().scrollTo(0.0);
                EXPECT_TRUE(window->settings()->isVisible()) << name;
                EXPECT_TRUE(isGround(*window)) << name;
            }
        }
    }
}

TEST_F(KTRConversationWindowTest, LowWindow_BeginsWithTheQuestion_AndTheKeyLeadsToTheSettingsAllTheSame) {
    openWindow({320, 200});
    addTurn(kAnswer);
    window->conversation().scrollToNewest();
    EXPECT_GT(window->conversation().scrolled(), 0.0) << "the room for the button is scrolled away";
    EXPECT_FALSE(window->settings()->isVisible());
    QKeyEvent key(QEvent::KeyPress, Qt::Key_Comma, Qt::ControlModifier);
    QApplication::sendEvent(window.get(), &key);
    EXPECT_TRUE(window->pages().isOpen());
    window->pages().back();
    EXPECT_FALSE(window->settings()->isVisible()) << "a page that goes brings nothing back";
    window->conversation().scrollTo(0.0);
    EXPECT_TRUE(window->settings()->isVisible());
}

TEST_F(KTRConversationWindowTest, EveryShape_FieldAndConversationNeverOverlap) {
    for (const std::string size : {"L", "XXXL", "AX3"}) {
        openWindow({400, 700}, R"(, "language": "en-GB", "textSize": ")" + size + '"');
        for (const QSize& shape :
             {QSize(320, 200), QSize(320, 239), QSize(320, 240), QSize(400, 300), QSize(900, 200), QSize(1600, 900)}) {
            window->resize(shape);
            QApplication::processEvents();
            ASSERT_EQ(window->size(), shape) << "a window of " << shape.height() << " is possible";
            constexpr int kAround = AskField::kAround;
            const QRect field = window->field()->geometry().adjusted(kAround, kAround, -kAround, -kAround);
            const QRect conversation = window->conversation().geometry();
            EXPECT_GT(conversation.height(), 0);
            EXPECT_FALSE(field.intersects(conversation))
                << shape.width() << "x" << shape.height() << ": field from " << field.y() << ", conversation to "
                << conversation.bottom() << ", size " << size;
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
