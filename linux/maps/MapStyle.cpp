#include "linux/maps/MapStyle.h"

namespace ktr::linux_ {

namespace {

QColor faded(QRgb color, double alpha) {
    QColor made(color);
    made.setAlphaF(static_cast<float>(alpha));
    return made;
}

MapStyle light() {
    MapStyle style;
    style.land = 0xFFF3EEE4, style.builtUp = 0xFFEFE8DB;
    style.water = 0xFFC3D8DC, style.shore = 0xFFA9C4CA;
    style.park = 0xFFD5E2C8, style.parkEdge = 0xFFBDD0AC;
    style.square = 0xFFEAE3D2, style.pier = 0xFFE9E2D4;
    style.building = 0xFFE6DDCE, style.buildingEdge = 0xFFD8CCB9;
    style.major = 0xFFFFF1CF, style.majorCasing = 0xFFCDB98B;
    style.secondary = 0xFFFFFBF0, style.secondaryCasing = 0xFFD2C8B4;
    style.minor = 0xFFFFFFFF, style.minorCasing = 0xFFDBD3C3;
    style.path = 0xFFB4A78F;
    style.rail = 0xFFA2988B, style.railInner = 0xFFFFFDF8;
    style.boundary = faded(0xFF94799A, 0.75);
    style.label = 0xFF574C3F, style.halo = 0xFFFBF8F1, style.town = 0xFFFFFDF8;
    style.waterLabel = 0xFF315963;
    style.parkLabel = 0xFF49663A;
    style.boundaryLabel = 0xFF7A5F80, style.pointOfInterest = 0xFF6A5238;
    return style;
}

MapStyle dark() {
    MapStyle style;
    style.isDark = true;
    style.land = 0xFF282520, style.builtUp = 0xFF2C2924;
    style.water = 0xFF152A31, style.shore = 0xFF1F3A42;
    style.park = 0xFF27352A, style.parkEdge = 0xFF33463A;
    style.square = 0xFF302C26, style.pier = 0xFF37322A;
    style.building = 0xFF383329, style.buildingEdge = 0xFF443E33;
    style.major = 0xFF5F5339, style.majorCasing = 0xFF1A1815;
    style.secondary = 0xFF514A3F, style.secondaryCasing = 0xFF1C1A17;
    style.minor = 0xFF453F37, style.minorCasing = 0xFF1F1D19;
    style.path = 0xFF6C6355;
    style.rail = 0xFF7C7468, style.railInner = 0xFF282520;
    style.boundary = faded(0xFF8E7796, 0.75);
    style.label = 0xFFD9CFC0, style.halo = 0xFF1E1C18, style.town = 0xFF2E2A25;
    style.waterLabel = 0xFF8FB9C3;
    style.parkLabel = 0xFFA6C296;
    style.boundaryLabel = 0xFFB59CBC, style.pointOfInterest = 0xFFDCC9AE;
    return style;
}

/// Edges and casings that stand out, letters nearly black or white; the surfaces stay, so that pins and circles look as
/// they do on every map.
MapStyle stronger(MapStyle style) {
    const auto further = [&](const QColor& color) {
        return QColor((style.isDark ? color.lighter(190) : color.darker(165)).rgb());
    };
    for (QColor* edge : {&style.shore, &style.parkEdge, &style.buildingEdge, &style.path, &style.rail}) {
        *edge = further(*edge);
    }
    for (QColor* casing : {&style.majorCasing, &style.secondaryCasing, &style.minorCasing}) {
        // The dark map's casings are darker than the land: lighter streets stand out, not lighter casings.
        *casing = style.isDark ? QColor(0xFF000000) : further(*casing);
    }
    if (style.isDark) {
        for (QColor* street : {&style.major, &style.secondary, &style.minor}) {
            *street = street->lighter(150).rgb();
        }
    }
    style.boundary = faded(further(style.boundary).rgb(), 1.0);
    const QColor letters(style.isDark ? 0xFFFFFFFF : 0xFF14110D);
    style.halo = style.town = style.isDark ? 0xFF000000 : 0xFFFFFFFF;
    style.label = style.boundaryLabel = style.pointOfInterest = letters;
    style.waterLabel = style.isDark ? 0xFFC9E7EF : 0xFF0F3640;
    style.parkLabel = style.isDark ? 0xFFD5EFC6 : 0xFF1F3A12;
    return style;
}

}  // namespace

const MapStyle& MapStyle::of(bool isDark, bool isHighContrast) {
    static const MapStyle kStyles[] = {light(), stronger(light()), dark(), stronger(dark())};
    return kStyles[(isDark ? 2 : 0) + (isHighContrast ? 1 : 0)];
}

}  // namespace ktr::linux_
