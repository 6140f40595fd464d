#include "linux/maps/ThreadedMapSource.h"

#include <QPainter>
#include <cmath>
#include <limits>
#include <optional>
#include <stdexcept>

#include "linux/paint/QtImage.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

using platform::MapPicture;
using platform::MapPictureRequest;

namespace {

/// Fills a part of every picture with one colour.
class ColorGround final : public MapGround {
  public:
    explicit ColorGround(QColor color, QRect part = QRect(0, 0, 10000, 10000)) : color_(color), part_(part) {}

    MapDrawn draw(const MapDrawing& drawing) override {
        ++drawings;
        asked = drawing.request;
        if (onDraw) {
            onDraw();
        }
        drawing.painter.resetTransform();
        drawing.painter.setClipRegion(drawing.region);
        drawing.painter.fillRect(part_, color_);
        return {QRegion(part_), attribution, isComplete};
    }
    void setChangeHandler(std::function<void()> changed) override { change = std::move(changed); }

    int drawings = 0;
    std::optional<MapPictureRequest> asked;
    std::function<void()> onDraw;
    std::function<void()> change;
    std::string attribution = "© Somebody";
    bool isComplete = true;

  private:
    QColor color_;
    QRect part_;
};

class ThrowingGround final : public MapGround {
  public:
    MapDrawn draw(const MapDrawing& /*drawing*/) override { throw std::runtime_error("a damaged file"); }
};

}  // namespace

class ThreadedMapSourceTest : public test::PlatformTest {
  protected:
    static MapPictureRequest request(double longitude = 13.4) {
        MapPictureRequest made;
        made.viewport = {{52.5, longitude}, 14.0, {40.0, 20.0}};
        made.scale = 2.0;
        return made;
    }
    int ask(const MapPictureRequest& wanted) {
        return source.requestPicture(wanted, [this](const MapPicture& picture) { pictures.push_back(picture); });
    }
    static QColor colorAt(const MapPicture& picture, int x, int y) {
        QImage canvas(static_cast<int>(picture.image->size().width), static_cast<int>(picture.image->size().height),
                      QImage::Format_ARGB32_Premultiplied);
        QPainter painter(&canvas);
        dynamic_cast<const QtImage&>(*picture.image)
            .draw(painter, QRectF(canvas.rect()), Palette::of(ColorScheme::Light));
        painter.end();
        return canvas.pixelColor(x, y);
    }

    std::shared_ptr<ColorGround> left = std::make_shared<ColorGround>(QColor(Qt::red), QRect(0, 0, 40, 40));
    std::shared_ptr<ColorGround> rest = std::make_shared<ColorGround>(QColor(Qt::blue));
    ThreadedMapSource source{time, {left, rest}};
    std::vector<MapPicture> pictures;
};

TEST_F(ThreadedMapSourceTest, Grounds_FillInWhatThoseBeforeThemLeft) {
    rest->attribution = "© Others";
    ask(request());
    EXPECT_TRUE(pictures.empty());
    time->runPosted();
    ASSERT_EQ(pictures.size(), 1U);
    EXPECT_EQ(pictures[0].viewport, request().viewport);
    EXPECT_EQ(pictures[0].image->size(), (platform::Size{40.0, 20.0}));
    EXPECT_EQ(colorAt(pictures[0], 19, 10), QColor(Qt::red));
    EXPECT_EQ(colorAt(pictures[0], 21, 10), QColor(Qt::blue));
    EXPECT_EQ(pictures[0].attribution, "© Somebody · © Others");
    EXPECT_TRUE(pictures[0].isComplete);
}

TEST_F(ThreadedMapSourceTest, SameRequest_IsDrawnOnce) {
    ask(request());
    ask(request());
    time->runPosted();
    EXPECT_EQ(pictures.size(), 2U);
    ask(request());
    EXPECT_EQ(pictures.size(), 2U) << "never inside the call";
    time->runPosted();
    EXPECT_EQ(pictures.size(), 3U);
    EXPECT_EQ(rest->drawings, 1);
    ask(request(14.0));
    time->runPosted();
    EXPECT_EQ(rest->drawings, 2);
}

TEST_F(ThreadedMapSourceTest, Cancelled_IsNotAnswered) {
    const int first = ask(request());
    const int queued = ask(request(14.0));
    source.cancel(first);
    source.cancel(queued);
    source.cancel(queued);
    source.cancel(4711);
    time->runPosted();
    EXPECT_TRUE(pictures.empty());
    EXPECT_EQ(rest->drawings, 0);
    ask(request());
    time->runPosted();
    const int known = ask(request());
    source.cancel(known);
    time->runPosted();
    EXPECT_EQ(pictures.size(), 1U);
}

TEST_F(ThreadedMapSourceTest, CancelOneOfTwo_AnswersTheOther) {
    const int first = ask(request());
    ask(request());
    source.cancel(first);
    time->runPosted();
    EXPECT_EQ(pictures.size(), 1U);
}

TEST_F(ThreadedMapSourceTest, Change_TellsObserversAndDrawsAnew) {
    int changes = 0;
    auto connection = source.observeChanges([&] { ++changes; });
    left->isComplete = false;
    ask(request());
    time->runPosted();
    EXPECT_FALSE(pictures[0].isComplete);
    left->isComplete = true;
    left->change();
    EXPECT_EQ(changes, 0) << "on a later turn";
    time->runPosted();
    EXPECT_EQ(changes, 1);
    ask(request());
    time->runPosted();
    EXPECT_EQ(rest->drawings, 2);
    EXPECT_TRUE(pictures[1].isComplete);
    connection.reset();
    left->change();
    time->runPosted();
    EXPECT_EQ(changes, 1);
}

TEST_F(ThreadedMapSourceTest, ChangeWhileDrawing_IsNotKept) {
    left->onDraw = [this] {
        left->onDraw = nullptr;
        left->change();
    };
    ask(request());
    time->runPosted();
    EXPECT_EQ(pictures.size(), 1U);
    ask(request());
    time->runPosted();
    EXPECT_EQ(rest->drawings, 2);
}

TEST_F(ThreadedMapSourceTest, NewGrounds_DrawWhatWasAskedBefore) {
    const auto green = std::make_shared<ColorGround>(QColor(Qt::green));
    int changes = 0;
    const auto connection = source.observeChanges([&] { ++changes; });
    ask(request());
    source.setGrounds({green});
    time->runPosted();
    EXPECT_EQ(changes, 1);
    ASSERT_EQ(pictures.size(), 1U);
    EXPECT_EQ(colorAt(pictures[0], 10, 10), QColor(Qt::green));
    EXPECT_EQ(rest->drawings, 0);
}

TEST_F(ThreadedMapSourceTest, GroundThatThrows_IsPassedOver) {
    source.setGrounds({std::make_shared<ThrowingGround>(), rest});
    ask(request());
    time->runPosted();
    ASSERT_EQ(pictures.size(), 1U);
    EXPECT_EQ(colorAt(pictures[0], 5, 5), QColor(Qt::blue));
}

TEST_F(ThreadedMapSourceTest, NoGround_ShowsLand) {
    source.setGrounds({});
    auto dark = request();
    dark.isDark = true;
    ask(request());
    ask(dark);
    time->runPosted();
    ASSERT_EQ(pictures.size(), 2U);
    EXPECT_EQ(colorAt(pictures[0], 5, 5), QColor(0xF3, 0xEE, 0xE4));
    EXPECT_EQ(colorAt(pictures[1], 5, 5), QColor(0x28, 0x25, 0x20));
}

TEST_F(ThreadedMapSourceTest, RequestThatMakesNoPicture_IsDrawnAsTheNearestThatDoes) {
    MapPictureRequest odd;
    odd.viewport = {{std::nan(""), 1e300}, std::nan(""), {-5.0, 1e9}};
    odd.scale = std::numeric_limits<double>::infinity();
    odd.clear = {{std::nan(""), 0, 1, 1}};
    ask(odd);
    time->runPosted();
    ASSERT_EQ(pictures.size(), 1U);
    ASSERT_TRUE(rest->asked.has_value());
    EXPECT_EQ(rest->asked->viewport.size, (platform::Size{1.0, 4096.0}));
    EXPECT_EQ(rest->asked->viewport.zoom, 0.0);
    EXPECT_EQ(rest->asked->viewport.centre.latitude, 0.0);
    EXPECT_LE(std::abs(rest->asked->viewport.centre.longitude), 180.0);
    EXPECT_EQ(rest->asked->scale, 1.0);
    EXPECT_TRUE(rest->asked->clear.empty());
}

TEST_F(ThreadedMapSourceTest, SourceGone_AnswersNobody) {
    auto passing = std::make_unique<ThreadedMapSource>(time, ThreadedMapSource::Grounds{rest});
    passing->requestPicture(request(), [this](const MapPicture& picture) { pictures.push_back(picture); });
    passing.reset();
    time->runPosted();
    EXPECT_TRUE(pictures.empty());
}

TEST_F(ThreadedMapSourceTest, CallbackMayAskAgain) {
    bool asked = false;
    source.requestPicture(request(), [&](const MapPicture&) {
        asked = true;
        ask(request(15.0));
    });
    time->runPosted();
    EXPECT_TRUE(asked);
    EXPECT_EQ(pictures.size(), 1U);
}

}  // namespace ktr::linux_
