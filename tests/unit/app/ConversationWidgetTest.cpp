#include "app/window/ConversationWidget.h"

#include <QAccessible>
#include <QApplication>
#include <QDeadlineTimer>
#include <QEventLoop>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPointingDevice>
#include <QProxyStyle>
#include <QTouchEvent>
#include <QWheelEvent>
#include <memory>

#include "host/conversation/Measures.h"
#include "host/scenario/ScenarioReader.h"
#include "platform/base/Platform.h"
#include "platform/ui/Appearance.h"
#include "platform/ui/Label.h"
#include "tests/support/qt/EventLoops.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class GrowingController : public platform::HostSnippetViewController {
  public:
    double height = 1000.0;
    double desiredHeightForWidth(double) override { return height; }
    bool searching = false;
    bool isSearching() const override { return searching; }
};

/// A desktop that lets things move, which the one without a screen does not.
class MovingStyle : public QProxyStyle {
  public:
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override {
        constexpr int kDuration = 200;
        return hint == SH_Widget_Animation_Duration ? kDuration : QProxyStyle::styleHint(hint, option, widget, data);
    }
};

/// The demo scenario in a window, with the real plugin.
class KTRConversationWidgetTest : public ::testing::Test {
  public:
    void open(const std::vector<std::string>& names, int width = 400, int height = 700) {
        std::vector<host::Scenario> scenarios;
        for (const std::string& name : names) {
            auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/" + name + ".json");
            ASSERT_TRUE(std::holds_alternative<host::Scenario>(read))
                << std::get<documents::DocumentError>(read).text();
            scenarios.push_back(std::get<host::Scenario>(read));
        }
        host::HostOptions options;
        options.dark = false;
        const auto settings = host::HostSettings::decide(options, scenarios, {});
        ASSERT_TRUE(std::holds_alternative<host::HostSettings>(settings));
        auto made =
            host::Host::make(std::get<host::HostSettings>(settings), host::Host::Time::Virtual, KTR_PLUGIN_FILE);
        ASSERT_TRUE(std::holds_alternative<std::unique_ptr<host::Host>>(made)) << std::get<host::Failure>(made).line;
        host = std::move(std::get<std::unique_ptr<host::Host>>(made));
        for (const host::Scenario& scenario : scenarios) {
            ASSERT_FALSE(host->addTurn(scenario));
        }
        host->delegate().open = [this](const platform::Url& url) {
            opened.push_back(url.text());
            return true;
        };
        widget = std::make_unique<ConversationWidget>(*host);
        widget->resize(width, height);
        widget->show();
        QApplication::processEvents();
    }
    void TearDown() override {
        widget.reset();
        host.reset();
    }

    static std::shared_ptr<platform::Label> labelOf(const platform::View& within, const std::string& text) {
        for (const auto& view : within.subviews()) {
            auto label = std::dynamic_pointer_cast<platform::Label>(view);
            if (!label || !label->text().starts_with(text)) {
                label = labelOf(*view, text);
            }
            if (label) {
                return label;
            }
        }
        return nullptr;
    }

    void mouse(QEvent::Type type, QPointF at) {
        const bool move = type == QEvent::MouseMove;
        QMouseEvent event(type, at, widget->mapToGlobal(at), move ? Qt::NoButton : Qt::LeftButton,
                          type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(widget.get(), &event);
    }
    void touch(QEvent::Type type, QPointF at) {
        const auto state = type == QEvent::TouchBegin    ? QEventPoint::Pressed
                           : type == QEvent::TouchUpdate ? QEventPoint::Updated
                                                         : QEventPoint::Released;
        QTouchEvent event(type, &finger, Qt::NoModifier, {QEventPoint(1, state, at, widget->mapToGlobal(at))});
        QApplication::sendEvent(widget.get(), &event);
    }
    void key(int code, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QKeyEvent event(QEvent::KeyPress, code, modifiers);
        QApplication::sendEvent(widget.get(), &event);
    }
    void wheel(int eighths, QPointF at = {200.0, 300.0}) {
        QWheelEvent event(at, widget->mapToGlobal(at), {}, {0, eighths}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(widget.get(), &event);
    }
    /// The middle of a row in the widget's coordinates.
    QPointF row(const std::string& name) const {
        QPointF found(-1.0, -1.0);
        const auto visit = [&](const auto& self, const platform::AccessibilityNode& node) -> void {
            for (const auto& child : node.children) {
                if (child.text.find(name) != std::string::npos || node.text.find(name) != std::string::npos) {
                    const auto& frame = child.frame;
                    found = {frame.x + frame.width / 2.0, frame.y + frame.height / 2.0 - widget->scrolled()};
                }
                self(self, child);
            }
        };
        visit(visit, platform::accessibilityTree(host->window(), host->rightToLeft()));
        return found;
    }

    QPointingDevice finger{QStringLiteral("finger"),
                           1,
                           QInputDevice::DeviceType::TouchScreen,
                           QPointingDevice::PointerType::Finger,
                           QInputDevice::Capability::Position,
                           1,
                           0};
    std::unique_ptr<host::Host> host;
    std::unique_ptr<ConversationWidget> widget;
    std::vector<std::string> opened;
};

TEST_F(KTRConversationWidgetTest, Click_OpensTheFriendUnderIt) {
    open({"dinner"});
    const QPointF ann = row("Ann Marsh");
    ASSERT_GT(ann.y(), 0.0);
    mouse(QEvent::MouseButtonPress, ann);
    mouse(QEvent::MouseButtonRelease, ann);
    EXPECT_EQ(opened, std::vector<std::string>{"wayloc://friend/ann@harbour.example"});
}

TEST_F(KTRConversationWidgetTest, PressThatMovesAway_OpensNothing) {
    open({"dinner"});
    const QPointF ann = row("Ann Marsh");
    mouse(QEvent::MouseButtonPress, ann);
    mouse(QEvent::MouseMove, ann + QPointF(0.0, 40.0));
    mouse(QEvent::MouseButtonRelease, ann + QPointF(0.0, 40.0));
    EXPECT_TRUE(opened.empty());
}

TEST_F(KTRConversationWidgetTest, Keyboard_WalksTheRowsAndOpensThem) {
    open({"dinner"});
    key(Qt::Key_Tab);
    EXPECT_TRUE(widget->rows().hasFocus());
    key(Qt::Key_Return);
    key(Qt::Key_Tab);
    key(Qt::Key_Return);
    key(Qt::Key_Backtab, Qt::ShiftModifier);
    key(Qt::Key_Enter);
    EXPECT_EQ(opened,
              (std::vector<std::string>{"wayloc://friend/ann@harbour.example", "wayloc://friend/l.haddad@mail.example",
                                        "wayloc://friend/ann@harbour.example"}));
    key(Qt::Key_Escape);
    EXPECT_FALSE(widget->rows().hasFocus());
}

TEST_F(KTRConversationWidgetTest, Keyboard_ReachesShowAllLast) {
    open({"show-all"});
    key(Qt::Key_Tab);
    key(Qt::Key_Tab);
    key(Qt::Key_Return);
    EXPECT_EQ(opened, std::vector<std::string>{"wayloc://friends/"});
    key(Qt::Key_Tab);
    EXPECT_FALSE(widget->rows().hasFocus()) << "beyond the last row the focus leaves";
}

TEST_F(KTRConversationWidgetTest, Keyboard_BeginsWithTheNewestAnswerAndReachesTheEarlier) {
    open({"dinner", "show-all"});
    key(Qt::Key_Tab);
    const auto& turns = host->conversation()->turns();
    ASSERT_TRUE(widget->rows().focused());
    EXPECT_TRUE(widget->rows().focused()->isDescendantOf(*turns[1]));
    key(Qt::Key_Up);
    ASSERT_TRUE(widget->rows().focused());
    EXPECT_TRUE(widget->rows().focused()->isDescendantOf(*turns[0]));
    key(Qt::Key_Down);
    key(Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_TRUE(widget->rows().focused()->isDescendantOf(*turns[0]));
}

TEST_F(KTRConversationWidgetTest, Keyboard_NewestAnswerWithoutRowsIsPassedOver) {
    open({"dinner", "locating"});
    key(Qt::Key_Tab);
    ASSERT_TRUE(widget->rows().focused());
    EXPECT_TRUE(widget->rows().focused()->isDescendantOf(*host->conversation()->turns()[0]));
}

TEST_F(KTRConversationWidgetTest, ArrowsHomeAndEnd_MoveAmongRowsAndStayAtTheEnds) {
    open({"dinner"});
    key(Qt::Key_Down);
    EXPECT_FALSE(widget->rows().hasFocus()) << "without a focus they scroll";
    key(Qt::Key_Tab);
    const auto first = widget->rows().focused();
    key(Qt::Key_Up);
    EXPECT_EQ(widget->rows().focused(), first);
    key(Qt::Key_Down);
    EXPECT_NE(widget->rows().focused(), first);
    key(Qt::Key_End);
    const auto last = widget->rows().focused();
    key(Qt::Key_Down);
    EXPECT_EQ(widget->rows().focused(), last);
    key(Qt::Key_Return);
    EXPECT_EQ(opened, std::vector<std::string>{"wayloc://friends/"});
    key(Qt::Key_Home);
    EXPECT_EQ(widget->rows().focused(), first);
}

TEST_F(KTRConversationWidgetTest, FocusByKey_StopsAtARowAndByMouseAtNone) {
    open({"dinner"});
    const auto focus = [&](Qt::FocusReason reason) {
        QFocusEvent in(QEvent::FocusIn, reason);
        QApplication::sendEvent(widget.get(), &in);
    };
    const auto leave = [&](Qt::FocusReason reason) {
        QFocusEvent out(QEvent::FocusOut, reason);
        QApplication::sendEvent(widget.get(), &out);
    };
    focus(Qt::MouseFocusReason);
    EXPECT_FALSE(widget->rows().hasFocus());
    focus(Qt::TabFocusReason);
    EXPECT_TRUE(widget->rows().hasFocus());
    leave(Qt::ActiveWindowFocusReason);
    EXPECT_TRUE(widget->rows().hasFocus()) << "who comes back to the window goes on there";
    leave(Qt::MouseFocusReason);
    EXPECT_FALSE(widget->rows().hasFocus());
    focus(Qt::BacktabFocusReason);
    key(Qt::Key_Return);
    EXPECT_EQ(opened, std::vector<std::string>{"wayloc://friends/"}) << "backwards it comes to the last row";
}

TEST_F(KTRConversationWidgetTest, Focus_BringsItsRowIntoView) {
    open({"forty-friends"});
    for (int i = 0; i < 40; ++i) {
        key(Qt::Key_Tab);
        const auto rect = widget->rows().focusedRect();
        ASSERT_TRUE(rect);
        EXPECT_GE(rect->y, widget->scrolled());
        EXPECT_LE(rect->maxY(), widget->scrolled() + widget->height());
    }
    EXPECT_GT(widget->scrolled(), 1000.0);
}

TEST_F(KTRConversationWidgetTest, Wheel_ScrollsAndStopsAtTheEnds) {
    open({"forty-friends"});
    wheel(-120);
    EXPECT_EQ(widget->scrolled(), 60.0);
    wheel(120 * 50);
    EXPECT_EQ(widget->scrolled(), 0.0);
    key(Qt::Key_End);
    const double end = widget->scrolled();
    EXPECT_NEAR(end, host->window()->frame().height - widget->height(), 1.0);
    wheel(-120);
    EXPECT_EQ(widget->scrolled(), end);
    key(Qt::Key_Home);
    EXPECT_EQ(widget->scrolled(), 0.0);
}

TEST_F(KTRConversationWidgetTest, Finger_TapsAndScrolls) {
    open({"forty-friends"});
    touch(QEvent::TouchBegin, {200.0, 300.0});
    touch(QEvent::TouchEnd, {202.0, 303.0});
    EXPECT_EQ(opened.size(), 1u);
    touch(QEvent::TouchBegin, {200.0, 400.0});
    touch(QEvent::TouchUpdate, {200.0, 360.0});
    touch(QEvent::TouchUpdate, {200.0, 300.0});
    EXPECT_EQ(widget->scrolled(), 100.0);
    touch(QEvent::TouchCancel, {200.0, 300.0});
    EXPECT_EQ(opened.size(), 1u) << "a finger that scrolled opens nothing";
}

TEST_F(KTRConversationWidgetTest, Finger_HighlightsNothing) {
    open({"dinner"});
    widget->repaint();
    const QPointF ann = row("Ann Marsh");
    mouse(QEvent::MouseMove, ann);
    QApplication::processEvents();
    touch(QEvent::TouchBegin, ann);
    QApplication::processEvents();
    EXPECT_FALSE(widget->rows().isHovering());
    touch(QEvent::TouchCancel, ann);
    EXPECT_TRUE(opened.empty());
}

TEST_F(KTRConversationWidgetTest, Width_LaysOutAnew) {
    open({"dinner"});
    const double narrow = host->window()->frame().height;
    widget->resize(1100, 700);
    QApplication::processEvents();
    EXPECT_EQ(host->window()->frame().width, 1100.0);
    EXPECT_LT(host->window()->frame().height, narrow);
    EXPECT_EQ(host->conversation()->turns()[0]->card()->frame().width, 680.0);
}

TEST_F(KTRConversationWidgetTest, Hover_PaintsTheRowAlone) {
    open({"dinner"});
    widget->repaint();
    const QPointF ann = row("Ann Marsh");
    mouse(QEvent::MouseMove, ann);
    QApplication::processEvents();
    const QRect painted = widget->lastPainted().boundingRect();
    EXPECT_LT(painted.height(), 90);
    EXPECT_TRUE(painted.contains(ann.toPoint()));
}

TEST_F(KTRConversationWidgetTest, HeightChange_KeepsTheCardsTopOrItsBottom) {
    open({"dinner"});
    auto turn = platform::create<host::TurnView>(&host::TurnView::initWithFrame, platform::Rect{});
    const auto controller = platform::create<GrowingController>(&GrowingController::init);
    turn->setController(controller);
    host->conversation()->addTurn(turn);
    widget->resize(400, 701);
    QApplication::processEvents();
    const auto top = [&] { return turn->card()->frameInRoot().y - widget->scrolled(); };
    const auto bottom = [&] { return turn->card()->frameInRoot().maxY() - widget->scrolled(); };
    widget->scrollTo(turn->card()->frameInRoot().y + 100.0);
    const double topBefore = top();
    controller->height += 300.0;
    host->delegate().heightDidChange(*controller, true);
    QApplication::processEvents();
    EXPECT_NEAR(top(), topBefore, 1.0);
    const double bottomBefore = bottom();
    controller->height += 300.0;
    host->delegate().heightDidChange(*controller, false);
    EXPECT_NEAR(bottom(), bottomBefore, 1.0);
}

TEST_F(KTRConversationWidgetTest, TextThatChangesWithoutAWord_HasItsRoomOnTheNextTurn) {
    open({"dinner"});
    const auto distance = labelOf(*host->conversation(), "310");
    ASSERT_TRUE(distance);
    const double before = distance->frame().width;
    distance->setText("12,345 km");
    QApplication::processEvents();
    EXPECT_GT(distance->frame().width, before + 20.0);
    // Again, since the window has to have learnt that all is laid out.
    distance->setText("1 m");
    QApplication::processEvents();
    EXPECT_LT(distance->frame().width, before);
}

TEST_F(KTRConversationWidgetTest, Ring_GoesWhenTheSearchEndsThoughNobodyTells) {
    open({"dinner"});
    auto turn = platform::create<host::TurnView>(&host::TurnView::initWithFrame, platform::Rect{});
    const auto controller = platform::create<GrowingController>(&GrowingController::init);
    controller->searching = true;
    turn->card()->setController(controller);
    host->conversation()->addTurn(turn);
    widget->resize(400, 701);
    QApplication::processEvents();
    EXPECT_FALSE(turn->card()->ring()->hidden());
    controller->searching = false;
    const QDeadlineTimer limit(10000);
    while (!turn->card()->ring()->hidden() && !limit.hasExpired()) {
        QApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_TRUE(turn->card()->ring()->hidden());
}

TEST_F(KTRConversationWidgetTest, CardsScrolledAway_AreToldOnceScrollingRests) {
    open({"dinner", "locating", "dinner"}, 400, 300);
    widget->scrollToNewest();
    const auto& turns = host->conversation()->turns();
    EXPECT_TRUE(turns.front()->card()->isOnScreen()) << "not while it scrolls";
    EXPECT_TRUE(test::eventually([&] { return !turns.front()->card()->isOnScreen(); }));
    widget->scrollTo(0.0);
    EXPECT_TRUE(test::eventually([&] { return turns.front()->card()->isOnScreen(); }));
    EXPECT_TRUE(turns.back()->card()->isOnScreen()) << "the newest lives on";
}

TEST_F(KTRConversationWidgetTest, Ring_TurnsForNobody) {
    open({"dinner"});
    auto turn = platform::create<host::TurnView>(&host::TurnView::initWithFrame, platform::Rect{});
    const auto controller = platform::create<GrowingController>(&GrowingController::init);
    controller->searching = true;
    turn->setController(controller);
    host->conversation()->addTurn(turn);
    MovingStyle moving;
    widget->setStyle(&moving);
    widget->resize(400, 701);
    widget->scrollToNewest();
    test::wakesIn(1000);
    EXPECT_GT(test::wakesIn(1000), 15) << "it turns on screen";
    widget->setSeen(false);
    EXPECT_LE(test::wakesIn(1000), 2);
    widget->setSeen(true);
    EXPECT_GT(test::wakesIn(1000), 15) << "and again once it is seen";
    widget->setStyle(nullptr);
}

TEST_F(KTRConversationWidgetTest, SeveralTurns_BeginWithTheNewestAtTheTop) {
    open({"dinner", "locating"});
    widget->scrollToNewest();
    EXPECT_NEAR(widget->scrolled(), host->conversation()->turns()[1]->frame().y, 1.0);
}

TEST_F(KTRConversationWidgetTest, NewestOfAWideConversation_KeepsItsSpaceAbove) {
    open({"dinner", "locating"}, 1100, 700);
    widget->scrollToNewest();
    EXPECT_NEAR(widget->scrolled(), host->conversation()->turns()[1]->frame().y - host::measures::kCardToQuestion, 1.0);
}

TEST_F(KTRConversationWidgetTest, Accessibility_NamesRolesAndPress) {
    open({"dinner"});
    auto* root = QAccessible::queryAccessibleInterface(widget.get());
    ASSERT_NE(root, nullptr);
    std::vector<QAccessibleInterface*> links;
    std::vector<QString> texts;
    const auto visit = [&](const auto& self, QAccessibleInterface* node) -> void {
        for (int i = 0; i < node->childCount(); ++i) {
            QAccessibleInterface* child = node->child(i);
            ASSERT_NE(child, nullptr);
            EXPECT_EQ(child->parent(), node);
            EXPECT_EQ(node->indexOfChild(child), i);
            if (child->role() == QAccessible::Link) {
                links.push_back(child);
            } else if (child->role() == QAccessible::StaticText) {
                texts.push_back(child->text(QAccessible::Name));
            }
            self(self, child);
        }
    };
    visit(visit, root);
    ASSERT_EQ(links.size(), 6u);
    EXPECT_EQ(texts[1], QStringLiteral("Where are my friends near the harbour?"));
    EXPECT_TRUE(links[0]->text(QAccessible::Name).contains(QStringLiteral("Ann Marsh")));
    EXPECT_TRUE(links[0]->state().focusable);
    const QRect rect = links[0]->rect();
    EXPECT_TRUE(rect.contains(widget->mapToGlobal(row("Ann Marsh").toPoint())));
    ASSERT_NE(links[0]->actionInterface(), nullptr);
    links[0]->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(opened, std::vector<std::string>{"wayloc://friend/ann@harbour.example"});
}

TEST_F(KTRConversationWidgetTest, Accessibility_KeepsNodesOverLayouts) {
    open({"dinner"});
    auto* root = QAccessible::queryAccessibleInterface(widget.get());
    QAccessibleInterface* turn = root->child(0);
    widget->resize(1100, 700);
    QApplication::processEvents();
    EXPECT_EQ(root->child(0), turn);
    EXPECT_TRUE(turn->isValid());
}

TEST_F(KTRConversationWidgetTest, ReducedMotion_HoldsForMapsToo) {
    open({"single"});
    widget->setReducedMotion(true);
    EXPECT_TRUE(platform::Platform::installed()->appearance->reducesMotion());
    widget->setReducedMotion(false);
    const bool still = host->conversation()->motionStyle() == host::MotionStyle::Reduced;
    EXPECT_EQ(platform::Platform::installed()->appearance->reducesMotion(), still);
}

TEST_F(KTRConversationWidgetTest, RightToLeft_Mirrors) {
    open({"right-to-left"});
    EXPECT_TRUE(host->rightToLeft());
    EXPECT_EQ(widget->layoutDirection(), Qt::RightToLeft);
}

TEST_F(KTRConversationWidgetTest, Remade_SpeaksTheOtherLanguageAndKeepsWhatScreenReadersHold) {
    open({"dinner"});
    auto* root = QAccessible::queryAccessibleInterface(widget.get());
    ASSERT_NE(root, nullptr);
    ASSERT_GT(root->childCount(), 0);
    const auto conversation = host->conversation();
    host::HostSettings settings = host->settings();
    settings.language = "ar";
    settings.region = "ar";
    host->setRemade([this] { widget->remade(); });
    ASSERT_FALSE(host->remake(settings));
    QApplication::processEvents();
    EXPECT_EQ(widget->layoutDirection(), Qt::RightToLeft);
    EXPECT_EQ(host->conversation(), conversation);
    EXPECT_EQ(QAccessible::queryAccessibleInterface(widget.get()), root);
    QString spoken;
    const auto visit = [&](const auto& self, QAccessibleInterface* node) -> void {
        spoken += node->text(QAccessible::Name);
        for (int i = 0; i < node->childCount(); ++i) {
            self(self, node->child(i));
        }
    };
    visit(visit, root);
    EXPECT_TRUE(spoken.contains(QChar(0x0627))) << "Arabic letters: " << spoken.toStdString();
    // Back again: what was let go of is not touched.
    settings.language = "en-GB";
    ASSERT_FALSE(host->remake(settings));
    EXPECT_EQ(widget->layoutDirection(), Qt::LeftToRight);
}

}  // namespace

}  // namespace ktr::app
