#pragma once

namespace ktr::platform {

/// A colour that the appearance decides when it is painted, so that light, dark and high contrast change without a
/// rebuild.
enum class ColorRole {
    Fixed,
    StandardText,
    Highlight,
    MapLand,             ///< the ground of a map that has no picture
    MapNote,             ///< words on that ground
    MapScale,            ///< the scale bar and its words
    MapScaleHalo,        ///< around them
    MapAttribution,      ///< whose data a map shows
    MapAttributionPill,  ///< behind it
    MapUserHalo,         ///< around the user on a map
    FriendPinEdge,       ///< the dark line around a friend's pin
    MarkerPinEdge,       ///< the line around a marker
    PinShadow,           ///< on the ground under a pin's tip
};

/// Red, green, blue and alpha from 0 to 1 in sRGB; of a role other than Fixed only the role counts.
struct Color {
    double red = 0.0;
    double green = 0.0;
    double blue = 0.0;
    double alpha = 0.0;
    ColorRole role = ColorRole::Fixed;

    static Color rgb(double red, double green, double blue, double alpha = 1.0) { return {red, green, blue, alpha}; }
    static Color white(double level, double alpha) { return {level, level, level, alpha}; }
    static Color clear() { return {}; }
    /// The platform's red, of markers.
    static Color systemRed() { return rgb(200.0 / 255.0, 55.0 / 255.0, 45.0 / 255.0); }
    static Color ofRole(ColorRole role) { return {0.0, 0.0, 0.0, 1.0, role}; }
    bool isClear() const { return role == ColorRole::Fixed && alpha <= 0.0; }

    bool operator==(const Color&) const = default;
};

}  // namespace ktr::platform
