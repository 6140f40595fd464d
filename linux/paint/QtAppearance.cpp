#include "linux/paint/QtAppearance.h"

#include "platform/base/NotificationCenter.h"
#include "platform/base/Platform.h"

namespace ktr::linux_ {

namespace {

void tellOfChange() {
    if (const auto installed = platform::Platform::installed()) {
        installed->notificationCenter->post({platform::kAppearanceChangedNotification, nullptr});
    }
}

}  // namespace

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

void QtAppearance::show(ColorScheme scheme, Contrast contrast) {
    if (scheme != scheme_ || contrast != contrast_) {
        scheme_ = scheme;
        contrast_ = contrast;
        tellOfChange();
    }
}

void QtAppearance::setReducesMotion(bool reduces) {
    if (reduces != reducesMotion_) {
        reducesMotion_ = reduces;
        tellOfChange();
    }
}

}  // namespace ktr::linux_
