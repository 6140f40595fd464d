// What changes in a conversation by itself, and what assistive technology finds in it.
#include "app/window/ConversationWidget.h"

#include <QAccessible>
#include <QDeadlineTimer>
#include <QEventLoop>
#include <QProxyStyle>

#include "host/conversation/Measures.h"
#include "platform/ui/Appearance.h"
#include "tests/support/qt/EventLoops.h"
#include "tests/unit/app/ConversationWidgetFixture.h"

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
