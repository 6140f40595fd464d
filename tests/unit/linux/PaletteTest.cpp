#include "linux/paint/Palette.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

using platform::Color;
using platform::ColorRole;

namespace {

/// Contrast ratio of two colours (WCAG 2.1, 1.4.3).
double luminance(const QColor& c) {
    const auto channel = [](double v) { return v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4); };
    return 0.2126 * channel(c.redF()) + 0.7152 * channel(c.greenF()) + 0.0722 * channel(c.blueF());
}
double contrast(const QColor& a, const QColor& b) {
    const double la = luminance(a);
    const double lb = luminance(b);
    return (std::max(la, lb) + 0.05) / (std::min(la, lb) + 0.05);
}

}  // namespace

TEST(PaletteTest, Text_ReadsOnWhatItStandsOn) {
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        for (const auto level : {Contrast::Normal, Contrast::High}) {
            const Palette& p = Palette::of(scheme, level);
            for (const QColor& ground : {p.window, p.card, p.bubble, p.highlight}) {
                EXPECT_GE(contrast(p.ink, ground), 4.5);
            }
            for (const QColor& ground : {p.window, p.card, p.sendIdle}) {
                EXPECT_GE(contrast(p.inkSoft, ground), 4.5);
            }
            EXPECT_GE(contrast(p.onPine, p.pine), 4.5);
            EXPECT_GE(contrast(p.pine, p.window), 3.0);
            EXPECT_GE(contrast(p.fieldLine, p.card), 3.0);
            EXPECT_GE(contrast(p.amber, p.card), 3.0);
            EXPECT_GE(contrast(p.warning, p.window), 3.0);
            EXPECT_GE(contrast(p.fenceIcon, p.card), 3.0);
        }
    }
}

TEST(PaletteTest, Accent_TakesThePlaceOfPine_AndReadsWhateverItIs) {
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        const Palette& own = Palette::of(scheme);
        EXPECT_EQ(own.withAccent(own.pine).pine, own.pine) << "what reads stays as it is";
        for (const QRgb chosen :
             {0x000000U, 0xFFFFFFU, 0xFFFF00U, 0x0000FFU, 0x3584E4U, 0xEF8F14U, 0xC8372DU, 0x808080U}) {
            const QColor accent = QColor::fromRgb(chosen);
            const Palette p = own.withAccent(accent);
            for (const QColor& ground : {p.window, p.card, p.highlight, p.mapLand, p.onPine}) {
                EXPECT_GE(contrast(p.pine, ground), 4.5) << chosen;
            }
            EXPECT_EQ(p.ink, own.ink);
            EXPECT_EQ(p.mapUserHalo, own.mapUserHalo) << "where the user is stays what it is";
            if (accent.saturation() == 255 && p.pine.saturation() > 0) {
                EXPECT_NEAR(p.pine.hue(), accent.hue(), 3) << chosen;
            }
        }
    }
}

TEST(PaletteTest, Accent_ChangesNothingInHighContrast) {
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        const Palette& own = Palette::of(scheme, Contrast::High);
        EXPECT_EQ(own.withAccent(QColor(Qt::magenta)).pine, own.pine);
    }
}

TEST(PaletteTest, Roles_AreLookedUp) {
    const Palette& light = Palette::of(ColorScheme::Light);
    const Palette& dark = Palette::of(ColorScheme::Dark);
    EXPECT_EQ(light.resolve(Color::ofRole(ColorRole::StandardText)), QColor(0x2B, 0x26, 0x20));
    EXPECT_EQ(dark.resolve(Color::ofRole(ColorRole::StandardText)), QColor(0xF2, 0xEC, 0xE1));
    EXPECT_EQ(light.resolve(Color::ofRole(ColorRole::Highlight)), QColor(0xE3, 0xEC, 0xE3));
    EXPECT_EQ(dark.resolve(Color::ofRole(ColorRole::Highlight)), QColor(0x37, 0x44, 0x3D));
}

TEST(PaletteTest, FixedColours_StandAsTheyAre) {
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        const Palette& p = Palette::of(scheme);
        EXPECT_EQ(p.resolve(Color::rgb(151 / 255.0, 158 / 255.0, 149 / 255.0)).rgba(), Palette::separator().rgba());
        EXPECT_EQ(p.resolve(Color::white(0.0, 0.2)).rgba(), Palette::pressed().rgba());
        EXPECT_EQ(p.resolve(Color::rgb(2.0, -1.0, 0.0)).rgba(), qRgb(255, 0, 0));
    }
}

TEST(PaletteTest, HighContrast_DrawsEdgesInsteadOfShadows) {
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        const Palette& p = Palette::of(scheme, Contrast::High);
        EXPECT_EQ(p.cardShadow.alpha(), 0);
        EXPECT_EQ(p.cardEdge.width, 1.0);
        EXPECT_EQ(p.highlightEdge.width, 2.0);
        EXPECT_EQ(p.focusRing, 3.0);
    }
    EXPECT_EQ(Palette::of(ColorScheme::Light).cardEdge.width, 0.0);
    EXPECT_EQ(Palette::of(ColorScheme::Dark).cardEdge.width, 0.5);
}

}  // namespace ktr::linux_
