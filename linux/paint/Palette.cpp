#include "linux/paint/Palette.h"

#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

namespace {

QColor hex(unsigned rgb) {
    return QColor::fromRgb(static_cast<QRgb>(rgb) | 0xff000000U);
}

QColor hex(unsigned rgb, double alpha) {
    QColor color = hex(rgb);
    color.setAlphaF(static_cast<float>(alpha));
    return color;
}

void setMapColors(Palette& p, bool isDark) {
    p.mapLand = isDark ? hex(0x282520) : hex(0xF3EEE4);
    p.mapNote = p.mapAttribution = isDark ? hex(0xD9CFC0) : hex(0x574C3F);
    p.mapScale = isDark ? hex(0xEDE5D8) : hex(0x3A332A);
    p.mapScaleHalo = isDark ? hex(0x1E1C18) : hex(0xFBF8F1);
    p.mapAttributionPill = isDark ? hex(0x2E2A25, 0.88) : hex(0xFFFDF8, 0.88);
    p.mapUserHalo = isDark ? hex(0x86CDB5, 0.18) : hex(0x1E6653, 0.18);
    p.friendPinEdge = isDark ? hex(0x5A3100) : hex(0x8A4B00);
    p.markerPinEdge = isDark ? hex(0xF8B4AC) : hex(0x7E1A13);
}

Palette light() {
    Palette p;
    setMapColors(p, false);
    p.window = hex(0xF5F1E9);
    p.card = hex(0xFFFDF8);
    p.bubble = hex(0xDCE7DC);
    p.highlight = hex(0xE3ECE3);
    p.ink = hex(0x2B2620);
    p.inkSoft = hex(0x635A4E);
    p.pine = hex(0x1E6653);
    p.onPine = hex(0xFFFFFF);
    p.fieldLine = hex(0x8A8478);
    p.sendIdle = hex(0xE4DFD4);
    p.amber = hex(0xAD5E08);
    p.warning = hex(0xA52A20);
    p.fence = hex(0xC8372D);
    p.fenceIcon = hex(0xC8372D);
    p.cardShadow = QColor(70, 52, 26, 26);  // alpha 0.10
    return p;
}

Palette dark() {
    Palette p;
    p.scheme = ColorScheme::Dark;
    setMapColors(p, true);
    p.window = hex(0x1B1916);
    p.card = hex(0x2E2A25);
    p.cardEdge = {hex(0x3B362F), 0.5};
    p.bubble = hex(0x2F4239);
    p.highlight = hex(0x37443D);
    p.ink = hex(0xF2ECE1);
    p.inkSoft = hex(0xBFB5A7);
    p.pine = hex(0x86CDB5);
    p.onPine = hex(0x10251E);
    p.fieldLine = hex(0x857D72);
    p.sendIdle = hex(0x3A352F);
    p.amber = hex(0xEF8F14);
    p.warning = hex(0xFF9C8F);
    p.fence = hex(0xC8372D);
    p.fenceIcon = hex(0xF0695C);
    p.cardShadow = QColor(0, 0, 0, 0);
    return p;
}

/// In high contrast shapes are told apart by edges in ink, not by their fills.
Palette highContrast(ColorScheme scheme) {
    const bool isDark = scheme == ColorScheme::Dark;
    const QColor ground = isDark ? hex(0x000000) : hex(0xFFFFFF);
    Palette p;
    p.scheme = scheme;
    p.contrast = Contrast::High;
    setMapColors(p, isDark);
    p.ink = isDark ? hex(0xFFFFFF) : hex(0x000000);
    p.window = p.card = p.bubble = p.highlight = p.sendIdle = ground;
    p.cardEdge = p.bubbleEdge = p.sendIdleEdge = {p.ink, 1.0};
    p.highlightEdge = {p.ink, 2.0};
    p.inkSoft = isDark ? hex(0xE9E2D6) : hex(0x2B2620);
    p.pine = isDark ? hex(0xB6F0DC) : hex(0x0B4536);
    p.onPine = ground;
    p.fieldLine = p.ink;
    p.amber = isDark ? hex(0xFFB65C) : hex(0x7A3F00);
    p.warning = isDark ? hex(0xFFC3BA) : hex(0x7F150D);
    p.fence = hex(0xC8372D);
    p.fenceIcon = isDark ? hex(0xFFC3BA) : hex(0x7F150D);
    p.cardShadow = QColor(0, 0, 0, 0);
    p.focusRing = 3;
    return p;
}

/// WCAG 2.1, "relative luminance".
double luminance(const QColor& color) {
    const auto linear = [](double v) { return v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4); };
    return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) + 0.0722 * linear(color.blueF());
}

/// WCAG 2.1, "contrast ratio".
double contrastOf(const QColor& one, const QColor& other) {
    const auto [low, high] = std::minmax(luminance(one), luminance(other));
    return (high + 0.05) / (low + 0.05);
}

QColor mixed(const QColor& from, const QColor& to, double share) {
    const auto part = [share](int a, int b) { return static_cast<int>(std::lround(a + (b - a) * share)); };
    return {part(from.red(), to.red()), part(from.green(), to.green()), part(from.blue(), to.blue())};
}

float channel(double value) {
    return static_cast<float>(std::clamp(value, 0.0, 1.0));
}

}  // namespace

const Palette& Palette::of(ColorScheme scheme, Contrast contrast) {
    static const Palette kLight = light();
    static const Palette kDark = dark();
    static const Palette kHighLight = highContrast(ColorScheme::Light);
    static const Palette kHighDark = highContrast(ColorScheme::Dark);
    if (contrast == Contrast::High) {
        return scheme == ColorScheme::Dark ? kHighDark : kHighLight;
    }
    return scheme == ColorScheme::Dark ? kDark : kLight;
}

Palette Palette::withAccent(const QColor& accent) const {
    Palette made = *this;
    if (contrast == linux_::Contrast::High) {
        return made;
    }
    constexpr double kReads = 4.5;
    constexpr int kSteps = 64;
    const QColor end = scheme == ColorScheme::Dark ? QColor(Qt::white) : QColor(Qt::black);
    const auto reads = [this](const QColor& color) {
        const auto on = {window, card, highlight, mapLand, onPine};
        return std::all_of(on.begin(), on.end(), [&](const QColor& one) { return contrastOf(color, one) >= kReads; });
    };
    // Towards the end of the grey scale that is not the grounds': the hue stays, and the end itself reads.
    for (int step = 0; step <= kSteps; ++step) {
        made.pine = mixed(accent, end, static_cast<double>(step) / kSteps);
        if (reads(made.pine)) {
            break;
        }
    }
    return made;
}

QColor Palette::resolve(const platform::Color& color) const {
    switch (color.role) {
        case platform::ColorRole::StandardText:
            return ink;
        case platform::ColorRole::Highlight:
            return highlight;
        case platform::ColorRole::MapLand:
            return mapLand;
        case platform::ColorRole::MapNote:
            return mapNote;
        case platform::ColorRole::MapScale:
            return mapScale;
        case platform::ColorRole::MapScaleHalo:
            return mapScaleHalo;
        case platform::ColorRole::MapAttribution:
            return mapAttribution;
        case platform::ColorRole::MapAttributionPill:
            return mapAttributionPill;
        case platform::ColorRole::MapUserHalo:
            return mapUserHalo;
        case platform::ColorRole::FriendPinEdge:
            return friendPinEdge;
        case platform::ColorRole::MarkerPinEdge:
            return markerPinEdge;
        case platform::ColorRole::PinShadow:
            return pinShadow();
        case platform::ColorRole::Fixed:
            break;
    }
    return QColor::fromRgbF(channel(color.red), channel(color.green), channel(color.blue), channel(color.alpha));
}

}  // namespace ktr::linux_
