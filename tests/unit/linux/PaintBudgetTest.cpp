#include "linux/maps/PaintBudget.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <cmath>

namespace ktr::linux_ {

class PaintBudgetTest : public testing::Test {
  protected:
    PaintBudgetTest() { request.viewport.size = {400.0, 200.0}; }
    PaintBudget budget() {
        return PaintBudget({request, painter, painter, QSize(800, 400), QRegion(), stop.get_token()});
    }
    /// From top to bottom and back, again and again.
    static QPolygonF tangle(int points) {
        QPolygonF line;
        for (int i = 0; i < points; ++i) {
            line << QPointF(400.0 * i / points, i % 2 == 0 ? 0.0 : 200.0);
        }
        return line;
    }
    static QPainterPath surface(const QPolygonF& ring) {
        QPainterPath path;
        path.addPolygon(ring);
        return path;
    }

    platform::MapPictureRequest request;
    QImage image{8, 8, QImage::Format_RGB32};
    QPainter painter{&image};
    std::stop_source stop;
};

TEST_F(PaintBudgetTest, ADenseTown_Fits) {
    PaintBudget town = budget();
    const QPolygonF house({{10.0, 10.0}, {20.0, 12.0}, {18.0, 22.0}, {8.0, 20.0}, {10.0, 10.0}});
    for (int i = 0; i < 4000; ++i) {
        EXPECT_TRUE(town.takeArea(surface(house)));
        EXPECT_TRUE(town.takeLine(house, 0.7));
    }
    QPolygonF street;
    for (int i = 0; i < 300; ++i) {
        street << QPointF(i, 100.0 + std::sin(i / 20.0) * 10.0);
    }
    for (int i = 0; i < 300; ++i) {
        EXPECT_TRUE(town.takeLine(street, 8.0));
    }
    QPolygonF shore;
    for (int i = 0; i < 20000; ++i) {
        shore << QPointF(200.0 + 150.0 * std::cos(i / 3183.0) + i % 3, 100.0 + 90.0 * std::sin(i / 3183.0) + i % 2);
    }
    EXPECT_TRUE(town.takeArea(surface(shore)));
}

TEST_F(PaintBudgetTest, Tangles_DoNot) {
    PaintBudget one = budget();
    EXPECT_FALSE(one.takeLine(tangle(5000), 2.0));
    EXPECT_FALSE(one.takeArea(surface(tangle(5000))));
    // What was refused has cost nothing.
    EXPECT_TRUE(one.takeLine(tangle(20), 2.0));
}

TEST_F(PaintBudgetTest, ManySmallTangles_UseItUp) {
    PaintBudget many = budget();
    int drawn = 0;
    while (drawn < 100000 && many.takeLine(tangle(40), 2.0)) {
        ++drawn;
    }
    EXPECT_GT(drawn, 20);
    EXPECT_LT(drawn, 5000);
}

TEST_F(PaintBudgetTest, NumbersThatAreNone_AreRefused) {
    PaintBudget one = budget();
    EXPECT_FALSE(one.takeLine({{0.0, 0.0}, {1.0, NAN}}, 1.0));
    EXPECT_FALSE(one.takeLine({{0.0, 0.0}, {1.0, INFINITY}}, 1.0));
}

TEST_F(PaintBudgetTest, Stopped_NothingIsDrawnAnyMore) {
    PaintBudget one = budget();
    EXPECT_TRUE(one.takeLine(tangle(2), 1.0));
    stop.request_stop();
    EXPECT_FALSE(one.takeLine(tangle(2), 1.0));
    EXPECT_TRUE(one.takeArea({}));
}

}  // namespace ktr::linux_
