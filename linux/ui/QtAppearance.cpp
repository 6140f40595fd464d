#include "linux/ui/QtAppearance.h"

namespace ktr::linux_ {

platform::Font QtAppearance::lightFont(double size) const {
    return {platform::FontFace::Light, platform::FontWeight::Regular, size};
}

platform::Font QtAppearance::thinFont(double size) const {
    return {platform::FontFace::Thin, platform::FontWeight::Regular, size};
}

platform::Color QtAppearance::standardTextColor() const {
    return platform::Color::ofRole(platform::ColorRole::StandardText);
}

platform::Color QtAppearance::highlightColor() const {
    return platform::Color::ofRole(platform::ColorRole::Highlight);
}

}  // namespace ktr::linux_
