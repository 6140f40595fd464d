#include "linux/maps/WorldGround.h"

#include <QImage>
#include <algorithm>
#include <cmath>

#include "linux/maps/MapDrawer.h"
#include "linux/maps/MapStyle.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

class WorldGroundTest : public test::PlatformTest {
  protected:
    static platform::MapPictureRequest request(double latitude, double longitude, double zoom) {
        platform::MapPictureRequest made;
        made.viewport = {{latitude, longitude}, zoom, {200.0, 120.0}};
        return made;
    }
    MapDrawer::Result draw(const platform::MapPictureRequest& wanted) {
        const auto drawn = MapDrawer::draw(wanted, {ground}, {});
        EXPECT_TRUE(drawn.has_value());
        auto result = drawn.value_or(MapDrawer::Result());
        result.pixels = result.whole();
        return result;
    }
    /// The colour of the ground at the picture's middle: the labels keep away from it.
    QColor middle(double latitude, double longitude, double zoom) {
        auto wanted = request(latitude, longitude, zoom);
        wanted.clear = {{90.0, 50.0, 20.0, 20.0}};
        return draw(wanted).pixels.pixelColor(100, 60);
    }
    static bool hasColor(const QImage& pixels, const QRect& part, const QColor& color) {
        for (int y = part.top(); y <= part.bottom(); ++y) {
            for (int x = part.left(); x <= part.right(); ++x) {
                if (pixels.pixelColor(x, y) == color) {
                    return true;
                }
            }
        }
        return false;
    }

    const MapStyle& style = MapStyle::of(false, false);
    std::shared_ptr<WorldGround> ground = std::make_shared<WorldGround>(KTR_RESOURCES "/maps/world.bin");
};

TEST_F(WorldGroundTest, LandAndWater_AreWhereTheyAreAtEveryZoom) {
    for (const double zoom : {0.0, 1.5, 3.0, 4.6, 6.0, 8.2, 11.0, 15.0, 19.0, 24.0}) {
        EXPECT_EQ(middle(47.0, 2.5, zoom), style.land) << "France at " << zoom;
        EXPECT_EQ(middle(-23.5, 134.0, zoom), style.land) << "Australia at " << zoom;
        EXPECT_EQ(middle(0.0, -150.0, zoom), style.water) << "the Pacific at " << zoom;
        EXPECT_EQ(middle(42.0, 51.0, std::max(zoom, 3.0)), style.water) << "the Caspian Sea at " << zoom;
    }
}

TEST_F(WorldGroundTest, AtTheDateLine_LandGoesOn) {
    // Chukotka lies across it, on both sides and on the line.
    for (const double longitude : {179.0, 180.0, -180.0, -179.0, 178.0}) {
        EXPECT_EQ(middle(67.3, longitude, 7.0), style.land) << longitude;
    }
    for (const double longitude : {180.0, -180.0}) {
        EXPECT_EQ(middle(30.0, longitude, 5.0), style.water) << longitude;
    }
}

TEST_F(WorldGroundTest, AtThePoles_ThereIsIceAndSea) {
    for (const double zoom : {0.0, 3.0, 9.0, 17.0}) {
        EXPECT_EQ(middle(-90.0, 0.0, zoom), style.land) << zoom;
        EXPECT_EQ(middle(-84.0, 20.0, zoom), style.land) << zoom;
        // The ice shelf floats.
        EXPECT_EQ(middle(-84.0, 180.0, zoom), style.water) << zoom;
        EXPECT_EQ(middle(90.0, 0.0, zoom), style.water) << zoom;
    }
}

TEST_F(WorldGroundTest, TheWholeWorldRepeatsItselfInAWidePicture) {
    auto wanted = request(0.0, 0.0, 0.0);
    wanted.viewport.size = {768.0, 256.0};
    wanted.clear = {{0.0, 0.0, 768.0, 256.0}};
    const QImage pixels = draw(wanted).pixels;
    for (int y = 0; y < 256; y += 5) {
        for (int x = 0; x < 256; x += 5) {
            ASSERT_EQ(pixels.pixel(x, y), pixels.pixel(x + 256, y)) << x << " " << y;
            ASSERT_EQ(pixels.pixel(x, y), pixels.pixel(x + 512, y)) << x << " " << y;
        }
    }
}

TEST_F(WorldGroundTest, Labels_KeepOutOfWhatIsToBeClear) {
    auto wanted = request(52.52, 13.4, 6.0);
    const QRect whole(0, 0, 200, 120);
    EXPECT_TRUE(hasColor(draw(wanted).pixels, whole, style.label));
    wanted.clear = {{0.0, 0.0, 200.0, 120.0}};
    EXPECT_FALSE(hasColor(draw(wanted).pixels, whole, style.label));
}

TEST_F(WorldGroundTest, Names_StandInAPictureOfTheirOwn) {
    auto wanted = request(52.52, 13.4, 6.0);
    const auto drawn = MapDrawer::draw(wanted, {ground}, {});
    ASSERT_TRUE(drawn.has_value());
    const QRect whole(0, 0, 200, 120);
    EXPECT_FALSE(hasColor(drawn->pixels, whole, style.label)) << "a circle would lie over it";
    EXPECT_TRUE(hasColor(drawn->labels, whole, style.label));
    EXPECT_EQ(drawn->labels.pixelColor(0, 0).alpha(), 0);
}

TEST_F(WorldGroundTest, BeyondTheStreets_TheMapGoesOutToATownThatItNames) {
    using Beyond = platform::MapPictureRequest::Beyond;
    // Some 30 km from a town that the world knows, and in the middle of one.
    for (const platform::Coordinate& place :
         {platform::Coordinate{52.5, 13.9}, {48.7, 2.6}, {-33.7, 150.95}, {52.52, 13.405}}) {
        auto wanted = request(place.latitude, place.longitude, 13.0);
        wanted.viewport.size = {376.0, 219.0};
        wanted.clear = {{156.0, 20.0, 64.0, 92.0}};
        const auto close = MapDrawer::draw(wanted, {ground}, {});
        ASSERT_TRUE(close.has_value());
        EXPECT_FALSE(close->hasStreets);
        EXPECT_EQ(close->coarseZoom, std::nullopt) << "nobody asked";
        wanted.beyond = Beyond::Tell;
        const auto told = MapDrawer::draw(wanted, {ground}, {});
        ASSERT_TRUE(told && told->coarseZoom);
        EXPECT_EQ(told->pixels, close->pixels) << "drawn as asked for";
        wanted.beyond = Beyond::Widen;
        const auto wide = MapDrawer::draw(wanted, {ground}, {});
        ASSERT_TRUE(wide && wide->coarseZoom);
        EXPECT_EQ(wide->coarseZoom, told->coarseZoom);
        platform::MapViewport shown = wanted.viewport;
        shown.zoom = *wide->coarseZoom;
        const double across = shown.metresPerPoint() * 219.0;
        EXPECT_GE(across, 19999.0);
        EXPECT_LE(across, 50001.0);
        EXPECT_TRUE(hasColor(wide->labels, QRect(0, 0, 376, 219), style.label)) << place.latitude;
        EXPECT_FALSE(hasColor(wide->labels, QRect(157, 21, 62, 90), style.label)) << "the pin stands there";
    }
}

TEST_F(WorldGroundTest, InTheMiddleOfNowhere_TheMapGoesOutNoFartherThanFiftyKilometres) {
    auto wanted = request(25.0, -40.0, 13.0);
    wanted.beyond = platform::MapPictureRequest::Beyond::Widen;
    const auto wide = MapDrawer::draw(wanted, {ground}, {});
    ASSERT_TRUE(wide && wide->coarseZoom);
    platform::MapViewport shown = wanted.viewport;
    shown.zoom = *wide->coarseZoom;
    EXPECT_NEAR(shown.metresPerPoint() * 120.0, 50000.0, 1.0);
}

TEST_F(WorldGroundTest, FarOut_NobodyMissesStreets) {
    auto wanted = request(52.52, 13.4, 6.0);
    wanted.beyond = platform::MapPictureRequest::Beyond::Widen;
    const auto drawn = MapDrawer::draw(wanted, {ground}, {});
    ASSERT_TRUE(drawn.has_value());
    EXPECT_TRUE(drawn->hasStreets);
    EXPECT_EQ(drawn->coarseZoom, std::nullopt);
}

TEST_F(WorldGroundTest, WhereAnotherGroundHasTheMiddle_NothingGoesOut_AndNotWhileItComes) {
    class Middle final : public MapGround {
      public:
        explicit Middle(bool isThere) : isThere_(isThere) {}
        MapDrawn draw(const MapDrawing&) override {
            return {isThere_ ? QRegion(50, 30, 100, 60) : QRegion(), "Streets", isThere_};
        }

      private:
        bool isThere_;
    };
    auto wanted = request(52.5, 13.9, 13.0);
    wanted.beyond = platform::MapPictureRequest::Beyond::Widen;
    for (const bool isThere : {true, false}) {
        const auto drawn = MapDrawer::draw(wanted, {std::make_shared<Middle>(isThere), ground}, {});
        ASSERT_TRUE(drawn.has_value());
        EXPECT_TRUE(drawn->hasStreets);
        EXPECT_EQ(drawn->coarseZoom, std::nullopt);
    }
}

TEST_F(WorldGroundTest, InsideTheRegionOnly) {
    class Half final : public MapGround {
      public:
        MapDrawn draw(const MapDrawing& drawing) override {
            drawing.painter.fillRect(QRectF(0.0, 0.0, 100.0, 120.0), Qt::red);
            return {QRegion(0, 0, 100, 120), "Red", true};
        }
    };
    const auto drawn = MapDrawer::draw(request(47.0, 2.5, 5.0), {std::make_shared<Half>(), ground}, {});
    ASSERT_TRUE(drawn.has_value());
    for (int y = 0; y < 120; ++y) {
        ASSERT_EQ(drawn->pixels.pixelColor(99, y), QColor(Qt::red)) << y;
    }
    EXPECT_NE(drawn->pixels.pixelColor(101, 5), QColor(Qt::red));
    EXPECT_EQ(drawn->attribution, std::string("Red · ") + WorldGround::kAttribution);
}

TEST_F(WorldGroundTest, WithoutItsFile_PlainLandAndALine) {
    expectErrorLine(
        "The built-in map /nowhere/world.bin cannot be used: there is no such file. Land without shores and names is "
        "drawn; it comes with ktr: install it again, or name the folder that has maps/world.bin in KTR_RESOURCES");
    ground = std::make_shared<WorldGround>("/nowhere/world.bin");
    EXPECT_EQ(middle(0.0, -150.0, 5.0), style.land);
    EXPECT_EQ(middle(0.0, -150.0, 5.0), style.land);
    EXPECT_FALSE(draw(request(0.0, 0.0, 0.0)).attribution.empty());
    EXPECT_EQ(log->texts(platform::LogLevel::Error).size(), 1U);
}

TEST_F(WorldGroundTest, InTheDark_ItIsDark) {
    auto wanted = request(47.0, 2.5, 9.0);
    wanted.isDark = true;
    EXPECT_EQ(draw(wanted).pixels.pixelColor(100, 60), MapStyle::of(true, false).land);
}

}  // namespace ktr::linux_
