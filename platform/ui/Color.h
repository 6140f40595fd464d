#pragma once

namespace ktr::platform {

/// A colour that the appearance decides when it is painted, so that light, dark and high contrast change without a
/// rebuild.
enum class ColorRole { Fixed, StandardText, Highlight };

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
    static Color ofRole(ColorRole role) { return {0.0, 0.0, 0.0, 1.0, role}; }
    bool isClear() const { return role == ColorRole::Fixed && alpha <= 0.0; }

    bool operator==(const Color&) const = default;
};

}  // namespace ktr::platform
