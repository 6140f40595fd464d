#include "platform/ui/ImageView.h"

#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::platform {

namespace {

struct SizedImage : Image {
    Size size() const override { return {40.0, 30.0}; }
};

}  // namespace

class ImageViewTest : public test::PlatformTest {
  protected:
    Rect drawnAs(ContentMode mode) {
        view_->setContentMode(mode);
        test::RecordingCanvas canvas;
        view_->paint(canvas, {0.0, 0.0, 200.0, 200.0});
        return canvas.calls.empty() ? Rect{} : canvas.calls.at(0).rect;
    }

    std::shared_ptr<ImageView> view_ = create<ImageView>(&ImageView::initWithFrame, Rect{0.0, 0.0, 100.0, 10.0});
};

TEST_F(ImageViewTest, Image_FillsTheViewOrStandsInACornerAtItsOwnSize) {
    EXPECT_EQ(drawnAs(ContentMode::TopLeft), Rect{}) << "there is none yet";
    view_->setImage(std::make_shared<SizedImage>());
    EXPECT_EQ(drawnAs(ContentMode::ScaleToFill), (Rect{0.0, 0.0, 100.0, 10.0}));
    EXPECT_EQ(drawnAs(ContentMode::TopLeft), (Rect{0.0, 0.0, 40.0, 30.0}));
    EXPECT_EQ(drawnAs(ContentMode::TopRight), (Rect{60.0, 0.0, 40.0, 30.0}));
}

TEST_F(ImageViewTest, Awaiting_EndsWithTheImageOrWithNone) {
    EXPECT_FALSE(view_->isAwaitingImage());
    view_->awaitImage();
    EXPECT_TRUE(view_->isAwaitingImage());
    view_->setImage(nullptr);
    EXPECT_FALSE(view_->isAwaitingImage());
    view_->awaitImage();
    view_->setImage(std::make_shared<SizedImage>());
    EXPECT_FALSE(view_->isAwaitingImage());
}

}  // namespace ktr::platform
