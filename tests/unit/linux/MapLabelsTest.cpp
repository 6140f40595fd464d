#include "linux/maps/MapLabels.h"

#include <QImage>
#include <cmath>
#include <thread>

#include "linux/maps/MapDrawer.h"
#include "tests/support/NoMoreFiles.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

class MapLabelsTest : public test::PlatformTest {
  protected:
    static constexpr QRgb kPaper = 0xFFFFFFFF;

    MapLabels labels() {
        request.viewport.size = {300.0, 200.0};
        request.scale = 2.0;
        drawings.push_back(
            std::make_unique<MapDrawing>(MapDrawing{request, painter, painter, picture.size(), region, {}}));
        return MapLabels(*drawings.back(), shaper);
    }
    /// What is not paper any more, in points.
    QRectF ink(const MapLabels& placed) {
        picture.fill(kPaper);
        QPainter drawing(&picture);
        drawing.setRenderHint(QPainter::Antialiasing);
        drawing.scale(2.0, 2.0);
        placed.draw(drawing);
        drawing.end();
        QRect box;
        for (int y = 0; y < picture.height(); ++y) {
            for (int x = 0; x < picture.width(); ++x) {
                if (picture.pixel(x, y) != kPaper) {
                    box |= QRect(x, y, 1, 1);
                }
            }
        }
        return QRectF(box.x() / 2.0, box.y() / 2.0, box.width() / 2.0, box.height() / 2.0);
    }
    static LabelLook look(double size = 12.0) { return {QColor(Qt::black), QColor(Qt::yellow), size}; }
    static QPolygonF line(double angle, double length, const QPointF& middle = {150.0, 100.0}) {
        const QPointF half(std::cos(angle) * length / 2.0, std::sin(angle) * length / 2.0);
        return QPolygonF({middle - half, middle, middle + half});
    }

    platform::MapPictureRequest request;
    QImage picture{600, 400, QImage::Format_RGB32};
    QPainter painter;
    QRegion region{0, 0, 600, 400};
    LabelShaper shaper;
    std::vector<std::unique_ptr<MapDrawing>> drawings;
};

TEST_F(MapLabelsTest, FontThatCannotBeOpened_IsLeftOut) {
    if (!test::NoMoreFiles::kIsPossible) {
        GTEST_SKIP() << "not under the sanitizers";
    }
    // In a thread of its own, which has opened no font yet.
    bool isPlaced = true;
    std::thread([&] {
        auto placed = labels();
        const test::NoMoreFiles none;
        isPlaced = placed.placeAt("ᏣᎳᎩ", look(), {150.0, 100.0});
    }).join();
    EXPECT_FALSE(isPlaced);
}

TEST_F(MapLabelsTest, Label_StandsAroundItsPoint) {
    auto placed = labels();
    ASSERT_TRUE(placed.placeAt("Harbour", look(), {150.0, 100.0}));
    const QRectF box = ink(placed);
    EXPECT_NEAR(box.center().x(), 150.0, 1.0);
    EXPECT_NEAR(box.center().y(), 100.0, 2.0);
    EXPECT_NEAR(box.width(), placed.sizeOf("Harbour", look()).width(), 3.0);
}

TEST_F(MapLabelsTest, SecondLabelInTheSamePlace_IsLeftOut) {
    auto placed = labels();
    EXPECT_TRUE(placed.placeAt("Harbour", look(), {150.0, 100.0}));
    EXPECT_FALSE(placed.placeAt("Mill Lane", look(), {160.0, 104.0}));
    EXPECT_FALSE(placed.placeAlong("Mill Lane", look(), line(0.3, 70.0)));
    EXPECT_TRUE(placed.placeAt("Mill Lane", look(), {150.0, 130.0}));
}

TEST_F(MapLabelsTest, Label_IsNeverCut) {
    auto placed = labels();
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {20.0, 100.0}));
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {280.0, 100.0}));
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {150.0, 5.0}));
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {150.0, 198.0}));
    EXPECT_TRUE(placed.placeAt("Harbour", look(), {32.0, 100.0}));
    EXPECT_GE(ink(placed).left(), 3.0);
}

TEST_F(MapLabelsTest, ClearRectangle_StaysClear) {
    request.clear = {{100.0, 80.0, 100.0, 40.0}};
    auto placed = labels();
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {150.0, 100.0}));
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {90.0, 100.0}));
    // Along the street it moves aside.
    ASSERT_TRUE(placed.placeAlong("Quay", look(), line(0.0, 280.0)));
    EXPECT_FALSE(ink(placed).intersects(QRectF(100.0, 80.0, 100.0, 40.0)));
}

TEST_F(MapLabelsTest, PartOfThePicture_KeepsItsLabelsInside) {
    region = QRegion(0, 0, 300, 400);
    auto placed = labels();
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {145.0, 100.0}));
    EXPECT_FALSE(placed.placeAt("Harbour", look(), {220.0, 100.0}));
    ASSERT_TRUE(placed.placeAt("Harbour", look(), {80.0, 100.0}));
    EXPECT_LE(ink(placed).right(), 150.0);
}

TEST_F(MapLabelsTest, AlongALine_FollowsIt) {
    const double angle = 0.5;
    auto placed = labels();
    ASSERT_TRUE(placed.placeAlong("Lantern Street", look(), line(angle, 150.0)));
    const QRectF box = ink(placed);
    const double width = placed.sizeOf("Lantern Street", look()).width();
    EXPECT_NEAR(box.center().x(), 150.0, 3.0);
    EXPECT_NEAR(box.width(), width * std::cos(angle), 14.0);
    EXPECT_NEAR(box.height(), width * std::sin(angle), 18.0);
}

/// Light at its beginning and heavy at its end: where most of it stands tells the direction of reading.
TEST_F(MapLabelsTest, EveryDirection_ReadsUpright) {
    for (const double degrees : {0.0, 30.0, 60.0, 80.0, 95.0, 150.0, 180.0, 210.0, 260.0, 275.0, 330.0}) {
        picture.fill(kPaper);
        auto placed = labels();
        ASSERT_TRUE(placed.placeAlong("......mmmm", look(), line(degrees * M_PI / 180.0, 120.0))) << degrees;
        ink(placed);
        // The heavy end is to the right, or, on steep streets, above.
        double x = 0.0;
        double y = 0.0;
        int count = 0;
        for (int row = 0; row < picture.height(); ++row) {
            for (int column = 0; column < picture.width(); ++column) {
                if (qGray(picture.pixel(column, row)) < 40) {
                    x += column / 2.0;
                    y += row / 2.0;
                    ++count;
                }
            }
        }
        ASSERT_GT(count, 0);
        const double reading = std::atan2(100.0 - y / count, x / count - 150.0) * 180.0 / M_PI;
        EXPECT_GT(reading, -73.0) << degrees;
        EXPECT_LT(reading, 115.0) << degrees;
    }
}

TEST_F(MapLabelsTest, StreetThatIsTooShort_HasNoLabel) {
    auto placed = labels();
    EXPECT_FALSE(placed.placeAlong("Lantern Street", look(), line(0.0, 60.0)));
    EXPECT_FALSE(placed.placeAlong("Lantern Street", look(), QPolygonF()));
    EXPECT_FALSE(placed.placeAlong("Lantern Street", look(), QPolygonF({{10.0, 10.0}, {10.0, 10.0}})));
}

TEST_F(MapLabelsTest, SharpBend_IsAvoided) {
    auto placed = labels();
    // A right angle in the middle of the street, room on its longer arm.
    const QPolygonF bent({{150.0, 20.0}, {150.0, 70.0}, {290.0, 70.0}});
    ASSERT_TRUE(placed.placeAlong("Corner", look(), bent));
    const QRectF box = ink(placed);
    EXPECT_LT(box.height(), 20.0);
    auto tight = labels();
    EXPECT_FALSE(tight.placeAlong("Corner Street", look(), QPolygonF({{150.0, 60.0}, {150.0, 110.0}, {200.0, 110.0}})));
}

TEST_F(MapLabelsTest, JoinedScript_StaysOnOneLine) {
    auto placed = labels();
    QPolygonF arc;
    for (int step = 0; step <= 40; ++step) {
        const double angle = -M_PI + step * M_PI / 40.0;
        arc.append({150.0 + 45.0 * std::cos(angle), 120.0 + 45.0 * std::sin(angle)});
    }
    EXPECT_FALSE(placed.placeAlong("شارع الملك فهد", look(), arc));
    EXPECT_TRUE(placed.placeAlong("Король Ёж", look(), arc));
    EXPECT_TRUE(labels().placeAlong("شارع الملك فهد", look(), line(0.2, 200.0)));
}

TEST_F(MapLabelsTest, RightToLeft_IsWrittenInItsOrder) {
    const auto hebrew = shaper.shape("אב", {});
    const auto first = shaper.shape("א", {});
    ASSERT_TRUE(hebrew && first);
    ASSERT_EQ(hebrew->glyphs.size(), 2U);
    EXPECT_EQ(hebrew->glyphs[1].outline.boundingRect(), first->glyphs[0].outline.boundingRect());
    EXPECT_FALSE(hebrew->isJoined);
}

TEST_F(MapLabelsTest, HanForms_FollowTheLanguage) {
    const auto japanese = shaper.shape("直", {false, 0.2, "ja"});
    const auto chinese = shaper.shape("直", {false, 0.2, "zh-Hans"});
    ASSERT_TRUE(japanese && chinese);
    EXPECT_NE(japanese->glyphs[0].outline, chinese->glyphs[0].outline);
}

TEST_F(MapLabelsTest, NothingToSee_IsNoLabel) {
    auto placed = labels();
    for (const char* name : {"", "   ", "\u200B", "\n"}) {
        EXPECT_FALSE(placed.placeAt(name, look(), {150.0, 100.0})) << '"' << name << '"';
        EXPECT_TRUE(placed.sizeOf(name, look()).isEmpty());
    }
}

TEST_F(MapLabelsTest, ManyNames_AreKeptWithinBounds) {
    for (int index = 0; index < 4000; ++index) {
        shaper.shape("Street " + std::to_string(index), {});
    }
    const auto again = shaper.shape("Street 3999", {});
    EXPECT_EQ(shaper.shape("Street 3999", {}), again);
    ASSERT_NE(shaper.shape("Street 0", {}), nullptr);
}

}  // namespace ktr::linux_
