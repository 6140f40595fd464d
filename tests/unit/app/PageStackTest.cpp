// Pages over a conversation: every way back, who has the focus, what a screen reader hears, what lies below.
#include "app/window/pages/PageStack.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <QKeyEvent>
#include <QLineEdit>
#include <QMouseEvent>
#include <memory>

#include "app/window/Announcer.h"
#include "app/window/blocks/FormField.h"
#include "app/window/pages/ColumnPage.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class TestPage : public ColumnPage {
  public:
    explicit TestPage(QString name, bool canBeLeft = true)
        : ColumnPage(canBeLeft ? Bar::With : Bar::Without), name_(std::move(name)), canBeLeft_(canBeLeft) {
        first = new FormField;
        column().add(first, {});
    }
    QString name() const override { return name_; }
    QWidget* firstFocus() const override { return &first->edit(); }
    bool canBeLeft() const override { return canBeLeft_; }
    FormField* first;

  private:
    QString name_;
    bool canBeLeft_;
};

class KTRPageStackTest : public ::testing::Test {
  protected:
    KTRPageStackTest() : below(&window), stack(&window) {
        window.resize(400, 700);
        below.setFocusPolicy(Qt::StrongFocus);
        stack.resize(400, 700);
        stack.setMotion(host::MotionStyle::None);
        stack.setBelow([this](bool isSeen) { below.setVisible(isSeen); });
        window.show();
        window.activateWindow();
        below.setFocus();
        QApplication::processEvents();
    }
    TestPage& open(const QString& name, bool canBeLeft = true) {
        auto page = std::make_unique<TestPage>(name, canBeLeft);
        TestPage& opened = *page;
        stack.open(std::move(page));
        return opened;
    }
    void key(int code, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QKeyEvent event(QEvent::KeyPress, code, modifiers);
        QApplication::sendEvent(window.focusWidget(), &event);
    }
    QString heard() const { return announcer() == nullptr ? QString() : announcer()->message(); }
    const Announcer* announcer() const {
        for (const QWidget* widget : window.findChildren<QWidget*>()) {
            if (const auto* found = dynamic_cast<const Announcer*>(widget)) {
                return found;
            }
        }
        return nullptr;
    }

    QWidget window;
    QLineEdit below;
    PageStack stack;
};

}  // namespace

TEST_F(KTRPageStackTest, OpenPage_HidesWhatLiesBelowTakesTheFocusAndIsSaid) {
    TestPage& page = open(QStringLiteral("Settings"));
    EXPECT_FALSE(below.isVisible());
    EXPECT_EQ(window.focusWidget(), &page.first->edit());
    EXPECT_EQ(heard(), QStringLiteral("Settings"));
}

TEST_F(KTRPageStackTest, PageThatFades_TakesNoPress) {
    stack.setMotion(host::MotionStyle::Full);
    below.resize(window.size());
    open(QStringLiteral("Settings"));
    TestPage& second = open(QStringLiteral("Maps"));
    const QPoint middle(200, 350);
    ASSERT_TRUE(second.isAncestorOf(window.childAt(middle)) || window.childAt(middle) == &second);
    stack.back();
    ASSERT_TRUE(second.isVisible()) << "it does not fade";
    EXPECT_FALSE(second.isAncestorOf(window.childAt(middle)) || window.childAt(middle) == &second);
    EXPECT_TRUE(stack.isAncestorOf(window.childAt(middle))) << "the first page is there";
    stack.back();
    EXPECT_EQ(window.childAt(middle), &below);
    open(QStringLiteral("Settings"));
    EXPECT_TRUE(stack.isAncestorOf(window.childAt(middle)));
}

TEST_F(KTRPageStackTest, EveryWayBack_LeadsToTheConversationAndItsFocus) {
    for (int way = 0; way < 5; ++way) {
        below.setFocus();
        TestPage& page = open(QStringLiteral("Settings"));
        ASSERT_TRUE(stack.isOpen());
        switch (way) {
            case 0:
                page.bar()->back().press();
                break;
            case 1:
                key(Qt::Key_Escape);
                break;
            case 2:
                key(Qt::Key_Left, Qt::AltModifier);
                break;
            case 3:
                key(Qt::Key_Back);
                break;
            default: {
                QMouseEvent event(QEvent::MouseButtonPress, QPointF(5, 5), QPointF(5, 5), Qt::BackButton,
                                  Qt::BackButton, Qt::NoModifier);
                QApplication::sendEvent(&page.first->edit(), &event);
            }
        }
        EXPECT_FALSE(stack.isOpen()) << way;
        EXPECT_TRUE(below.isVisible()) << way;
        EXPECT_FALSE(stack.isVisible()) << way;
        EXPECT_EQ(window.focusWidget(), &below) << way;
    }
}

TEST_F(KTRPageStackTest, BackFromTheSecondPage_LeadsToTheFirstAndWhereItsFocusWas) {
    TestPage& first = open(QStringLiteral("Settings"));
    open(QStringLiteral("Check-up"));
    key(Qt::Key_Escape);
    EXPECT_EQ(stack.current(), &first);
    EXPECT_TRUE(first.isVisible());
    EXPECT_EQ(window.focusWidget(), &first.first->edit());
    EXPECT_EQ(heard(), QStringLiteral("Settings"));
    EXPECT_FALSE(below.isVisible());
}

TEST_F(KTRPageStackTest, ArrowPointsTheOtherWayFromRightToLeft) {
    window.setLayoutDirection(Qt::RightToLeft);
    open(QStringLiteral("Settings"));
    key(Qt::Key_Left, Qt::AltModifier);
    EXPECT_TRUE(stack.isOpen());
    key(Qt::Key_Right, Qt::AltModifier);
    EXPECT_FALSE(stack.isOpen());
}

TEST_F(KTRPageStackTest, PageThatCannotBeLeft_StaysUntilItIsDone) {
    open(QStringLiteral("Where are your friends?"), false);
    key(Qt::Key_Escape);
    EXPECT_TRUE(stack.isOpen());
    stack.closeAll();
    EXPECT_FALSE(stack.isOpen());
    EXPECT_TRUE(below.isVisible());
}

TEST_F(KTRPageStackTest, MovingPage_IsThereInTheEndAndGoneInTheEnd) {
    stack.setMotion(host::MotionStyle::Full);
    TestPage& page = open(QStringLiteral("Settings"));
    EXPECT_TRUE(stack.isMoving());
    EXPECT_TRUE(below.isVisible()) << "seen through the page that comes";
    const auto wait = [this] {
        const QDeadlineTimer deadline(5000);
        while (stack.isMoving() && !deadline.hasExpired()) {
            QApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
        }
    };
    wait();
    EXPECT_EQ(page.pos(), QPoint(0, 0));
    EXPECT_FALSE(below.isVisible());
    stack.back();
    EXPECT_TRUE(below.isVisible());
    wait();
    EXPECT_FALSE(stack.isVisible());
}

TEST_F(KTRPageStackTest, PageAtRest_LaysNothingOut) {
    class Counter : public QObject {
      public:
        int count = 0;
        bool eventFilter(QObject*, QEvent* event) override {
            count += event->type() == QEvent::LayoutRequest ? 1 : 0;
            return false;
        }
    } counter;
    TestPage& page = open(QStringLiteral("Settings"));
    for (int i = 0; i < 20; ++i) {
        QApplication::processEvents();
    }
    page.installEventFilter(&counter);
    page.column().installEventFilter(&counter);
    page.column().parentWidget()->installEventFilter(&counter);
    page.first->setNote(QStringLiteral("Nothing answers."));
    for (int i = 0; i < 100; ++i) {
        QApplication::processEvents();
    }
    EXPECT_GE(counter.count, 1);
    EXPECT_LE(counter.count, 8) << "one layout asks for the next";
}

TEST_F(KTRPageStackTest, PageThatLeavesFromItsOwnButton_IsNotUsedAfterwards) {
    TestPage& page = open(QStringLiteral("Settings"));
    bool went = false;
    page.bar()->setBack([&] {
        page.leave();
        page.leave();
        went = true;
    });
    page.bar()->back().press();
    EXPECT_TRUE(went);
    EXPECT_FALSE(stack.isOpen());
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

}  // namespace ktr::app
