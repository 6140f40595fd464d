#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "linux/maps/MapStyle.h"
#include "linux/paint/Palette.h"

// What stands on a map is told from every ground that it may stand on.

namespace ktr::linux_ {

namespace {

const QColor kOrange(239, 143, 20);
const QColor kRed(200, 55, 45);
const QColor kUser(30, 122, 98);

/// Relative luminance and contrast ratio (WCAG 2.1, 1.4.3).
double luminance(const QColor& c) {
    const auto channel = [](double v) { return v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4); };
    return 0.2126 * channel(c.redF()) + 0.7152 * channel(c.greenF()) + 0.0722 * channel(c.blueF());
}
double contrast(const QColor& a, const QColor& b) {
    const double la = luminance(a);
    const double lb = luminance(b);
    return (std::max(la, lb) + 0.05) / (std::min(la, lb) + 0.05);
}

/// A colour of some alpha on another one.
QColor over(const QColor& color, double alpha, const QColor& ground) {
    const auto mixed = [alpha](float a, float b) { return static_cast<float>(alpha * a + (1.0 - alpha) * b); };
    return QColor::fromRgbF(mixed(color.redF(), ground.redF()), mixed(color.greenF(), ground.greenF()),
                            mixed(color.blueF(), ground.blueF()));
}

std::vector<QColor> grounds(const MapStyle& s) {
    return {s.land, s.builtUp, s.water, s.park, s.square, s.pier, s.building, s.major, s.secondary, s.minor};
}

class MapContrastTest : public ::testing::TestWithParam<bool> {
  protected:
    const MapStyle& style() const { return MapStyle::of(GetParam(), false); }
    const Palette& palette() const {
        return Palette::of(GetParam() ? ColorScheme::Dark : ColorScheme::Light, Contrast::Normal);
    }
};

}  // namespace

TEST_P(MapContrastTest, FriendPin_ByItsEdgeOrItsOrange) {
    for (const QColor& ground : grounds(style())) {
        const double told = std::max(contrast(palette().friendPinEdge, ground), contrast(kOrange, ground));
        EXPECT_GE(told, 3.0) << ground.name().toStdString();
    }
    // The tip stands in the circle.
    for (const QColor& ground : {style().land, style().builtUp, style().water, style().park}) {
        const QColor circle = over(kOrange, 0.2, ground);
        EXPECT_GE(std::max(contrast(palette().friendPinEdge, circle), contrast(kOrange, circle)), 3.0)
            << ground.name().toStdString();
    }
}

TEST_P(MapContrastTest, Marker_ByItsEdgeOrItsRed) {
    for (const QColor& ground : grounds(style())) {
        EXPECT_GE(std::max(contrast(palette().markerPinEdge, ground), contrast(kRed, ground)), 3.0)
            << ground.name().toStdString();
    }
}

TEST_P(MapContrastTest, User_ByTheDiscInItsRim) {
    // The white rim is always around it, whatever lies outside.
    EXPECT_GE(contrast(kUser, Qt::white), 4.5);
    for (const QColor& ground : grounds(style())) {
        EXPECT_GE(std::max(contrast(kUser, ground), contrast(Qt::white, ground)), 3.0) << ground.name().toStdString();
    }
}

TEST_P(MapContrastTest, Words_ReadOnWhatLiesUnderThem) {
    const MapStyle& s = style();
    EXPECT_GE(contrast(s.label, s.halo), 4.5);
    for (const QColor& street : {s.major, s.secondary, s.minor, s.building, s.land}) {
        EXPECT_GE(contrast(s.label, street), 4.5) << street.name().toStdString();
    }
    EXPECT_GE(contrast(s.waterLabel, s.water), 4.5);
    EXPECT_GE(contrast(s.parkLabel, s.park), 4.5);
    EXPECT_GE(contrast(s.parkLabel, s.halo), 4.5);
    EXPECT_GE(contrast(s.boundaryLabel, s.halo), 4.5);
    EXPECT_GE(contrast(s.pointOfInterest, s.halo), 4.5);
}

TEST_P(MapContrastTest, ScaleAndAttribution_ReadOnEveryGround) {
    const Palette& p = palette();
    EXPECT_GE(contrast(p.mapScale, p.mapScaleHalo), 4.5);
    for (const QColor& ground : grounds(style())) {
        EXPECT_GE(contrast(p.mapScale, ground), 3.0) << ground.name().toStdString();
        const QColor pill = over(p.mapAttributionPill, p.mapAttributionPill.alphaF(), ground);
        EXPECT_GE(contrast(p.mapAttribution, pill), 4.5) << ground.name().toStdString();
    }
}

INSTANTIATE_TEST_SUITE_P(LightAndDark, MapContrastTest, ::testing::Bool(),
                         [](const auto& tested) { return tested.param ? "Dark" : "Light"; });

}  // namespace ktr::linux_
