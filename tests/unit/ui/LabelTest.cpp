#include "platform/ui/Label.h"

#include <limits>

#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

using namespace platform;

class LabelTest : public PlatformTest {
  public:
    std::shared_ptr<Label> label = create<Label>(&View::initWithFrame, Rect{0, 0, 100, 40});
    static constexpr double kInfinite = std::numeric_limits<double>::infinity();
    void SetUp() override { label->setFont({FontFace::Text, FontWeight::Regular, 10}); }
};

TEST_F(LabelTest, IntrinsicSize_IsTheTextsOwn) {
    label->setText("abcd");
    EXPECT_EQ(label->intrinsicContentSize(kInfinite), (IntrinsicSize{40.0, 14.0}));
}

TEST_F(LabelTest, EmptyText_KeepsTheHeightOfALine) {
    EXPECT_EQ(label->intrinsicContentSize(kInfinite), (IntrinsicSize{0.0, 14.0}));
}

TEST_F(LabelTest, WrappedText_IsAsHighAsItsLinesAtTheWidth) {
    label->setNumberOfLines(0);
    label->setLineBreakMode(LineBreakMode::WordWrapping);
    label->setText("aaaa bbbb cccc");
    EXPECT_EQ(label->intrinsicContentSize(50.0), (IntrinsicSize{40.0, 42.0}));
    EXPECT_TRUE(label->intrinsicHeightDependsOnWidth());
}

TEST_F(LabelTest, PlatformGone_KeepsTheSizeItKnew) {
    label->setNumberOfLines(0);
    label->setLineBreakMode(LineBreakMode::WordWrapping);
    label->setText("aaaa bbbb cccc");
    const auto known = label->intrinsicContentSize(kInfinite);
    Platform::install(nullptr);
    EXPECT_EQ(label->intrinsicContentSize(50.0), known);
    EXPECT_EQ(label->textLayout(), nullptr);
}

TEST_F(LabelTest, SameText_CostsNothing) {
    label->setText("abcd");
    label->intrinsicContentSize(kInfinite);
    label->textLayout();
    const int before = textEngine->count();
    label->setText("abcd");
    label->intrinsicContentSize(kInfinite);
    label->textLayout();
    EXPECT_EQ(textEngine->count(), before);
}

TEST_F(LabelTest, Text_IsCentredOnTheHeight) {
    label->setText("ab");
    RecordingCanvas canvas;
    label->paint(canvas, label->bounds());
    ASSERT_EQ(canvas.calls.size(), 1U);
    EXPECT_EQ(canvas.calls[0].rect, (Rect{0, 13, 20, 14}));
    EXPECT_EQ(label->drawnTextRect(), (Rect{0, 13, 20, 14}));
}

TEST_F(LabelTest, NaturalAlignment_FollowsTheInterfacesDirection) {
    label->setText("ab");
    EXPECT_EQ(label->drawnTextRect().x, 0.0);
    assistant->rightToLeft = true;
    label->setTextAlignment(TextAlignment::Center);
    EXPECT_EQ(label->drawnTextRect().x, 40.0);
    label->setTextAlignment(TextAlignment::Natural);
    EXPECT_EQ(label->drawnTextRect().x, 80.0);
}

TEST_F(LabelTest, LongText_IsTruncatedToTheWidth) {
    label->setText("abcdefghijklmnop");
    const auto layout = label->textLayout();
    EXPECT_TRUE(layout->isTruncated());
    EXPECT_LE(layout->usedSize().width, 100.0);
}

}  // namespace ktr::test
