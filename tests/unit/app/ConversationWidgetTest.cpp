// What hands and keys do to a conversation.
#include "app/window/ConversationWidget.h"

#include "tests/unit/app/ConversationWidgetFixture.h"

namespace ktr::app {

namespace {

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

}  // namespace

}  // namespace ktr::app
