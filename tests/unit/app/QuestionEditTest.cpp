#include "app/window/QuestionEdit.h"

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

}  // namespace

}  // namespace ktr::app
