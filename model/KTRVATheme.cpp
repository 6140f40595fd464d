#include "model/KTRVATheme.h"

#include "model/PluginBundle.h"
#include "platform/base/Assert.h"
#include "platform/base/Platform.h"
#include "platform/ui/Appearance.h"

namespace ktr {

using platform::Color;
using platform::Font;
using platform::Image;

namespace {

std::shared_ptr<platform::AssistantAppearance> appearance() {
    KTR_ASSERT_MAIN_THREAD();
    return platform::Platform::installed()->appearance;
}

/// The indicator once it was found.
struct IndicatorCache {
    static std::shared_ptr<IndicatorCache> makeShared() { return std::make_shared<IndicatorCache>(); }
    std::shared_ptr<Image> image;
};

/// A colour part of 255 as the single-precision number that it is stored as.
double singlePrecisionPart(float part) {
    return static_cast<double>(part / 255.0F);
}

}  // namespace

Font KTRVATheme::friendNameFont() {
    return appearance()->lightFont(18.0);
}
Font KTRVATheme::distanceFont() {
    return appearance()->lightFont(18.0);
}
Font KTRVATheme::friendLocationFont() {
    return appearance()->lightFont(14.0);
}
Font KTRVATheme::friendTimeFont() {
    return appearance()->lightFont(14.0);
}
Font KTRVATheme::geoFenceFriendLocationFont() {
    return appearance()->thinFont(14.0);
}
Font KTRVATheme::showAllFont() {
    return appearance()->thinFont(18.0);
}

Color KTRVATheme::friendNameTextColor() {
    return appearance()->standardTextColor();
}
Color KTRVATheme::distanceTextColor() {
    return appearance()->standardTextColor();
}
Color KTRVATheme::friendLocationTextColor() {
    return appearance()->standardTextColor();
}
Color KTRVATheme::distanceColor() {
    return appearance()->standardTextColor();
}
Color KTRVATheme::distanceShadowColor() {
    return Color::white(0.0, 0.5);
}
Color KTRVATheme::selectionBackgroundColor() {
    return appearance()->highlightColor();
}
Color KTRVATheme::ktrOrangeColor() {
    return Color::rgb(singlePrecisionPart(239.0F), singlePrecisionPart(143.0F), singlePrecisionPart(20.0F));
}

std::shared_ptr<Image> KTRVATheme::themeImageNamed(const std::string& name) {
    KTR_ASSERT_MAIN_THREAD();
    return platform::Platform::installed()->images->imageNamed(name, platform::kSnippetsBundle);
}

std::shared_ptr<Image> KTRVATheme::locationIndicator() {
    const auto cache = platform::shared<IndicatorCache>();
    if (!cache->image) {
        cache->image = themeImageNamed("location");
    }
    return cache->image;
}

}  // namespace ktr
