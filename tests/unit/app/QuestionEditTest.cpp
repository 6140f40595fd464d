#include "app/window/QuestionEdit.h"

#include <QClipboard>
#include <QCoreApplication>
#include <QGuiApplication>
#include <QInputMethodEvent>

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class KTRQuestionEditTest : public ::testing::Test {
  protected:
    KTRQuestionEditTest() { edit.resize(300, 40); }
    /// The caret's horizontal middle once painted, points.
    int caret() {
        edit.grab();
        return edit.inputMethodQuery(Qt::ImCursorRectangle).toRect().center().x();
    }
    QuestionEdit edit;
};

TEST_F(KTRQuestionEditTest, EmptyLine_BeginsAtTheStartOfTheReadingDirection) {
    edit.setLayoutDirection(Qt::LeftToRight);
    EXPECT_LT(caret(), 20);
    edit.setLayoutDirection(Qt::RightToLeft);
    EXPECT_GT(caret(), 280);
}

TEST_F(KTRQuestionEditTest, Question_StandsAtTheStartInEitherScript) {
    edit.setLayoutDirection(Qt::RightToLeft);
    edit.setText(QStringLiteral("ann"));
    EXPECT_GT(caret(), 280);
    edit.setText(QStringLiteral("أين"));
    EXPECT_GT(caret(), 200);
    edit.home(false);
    EXPECT_GT(caret(), 280);
}

TEST_F(KTRQuestionEditTest, PastedLines_AreOneQuestion) {
    for (const char* pasted : {"Where is\nAnn?", "Where is\r\nAnn?", "Where is\rAnn?", "Where is\u2028Ann?",
                               "Where is\u2029Ann?", "Where is\u0085Ann?", "Where is\vAnn?"}) {
        QGuiApplication::clipboard()->setText(QString::fromUtf8(pasted));
        edit.clear();
        edit.paste();
        EXPECT_EQ(edit.text(), QStringLiteral("Where is Ann?")) << pasted;
        EXPECT_EQ(edit.cursorPosition(), 13) << pasted;
    }
    QGuiApplication::clipboard()->setText(QStringLiteral("is\r\nour\r\nfriend "));
    edit.setText(QStringLiteral("Where Ann?"));
    edit.setCursorPosition(6);
    edit.paste();
    EXPECT_EQ(edit.text(), QStringLiteral("Where is our friend Ann?"));
    EXPECT_EQ(edit.cursorPosition(), 20) << "behind what was pasted";
}

TEST_F(KTRQuestionEditTest, DictatedLines_AreOneQuestion) {
    QInputMethodEvent dictated;
    dictated.setCommitString(QStringLiteral("Where is\nAnn?"));
    QCoreApplication::sendEvent(&edit, &dictated);
    EXPECT_EQ(edit.text(), QStringLiteral("Where is Ann?"));
}

}  // namespace

}  // namespace ktr::app
