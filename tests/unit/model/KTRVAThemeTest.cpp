#include "model/KTRVATheme.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Color;
using platform::ColorRole;
using platform::Font;
using platform::FontFace;
using platform::FontWeight;

class KTRVAThemeTest : public PlatformTest {
  protected:
    std::shared_ptr<FakeImage> addImage(const std::string& name) {
        auto image = std::make_shared<FakeImage>();
        images->named["org.ktr.snippets/" + name] = image;
        return image;
    }
};

TEST_F(KTRVAThemeTest, Fonts) {
    const auto light = [](double size) { return Font{FontFace::Light, FontWeight::Regular, size}; };
    const auto thin = [](double size) { return Font{FontFace::Thin, FontWeight::Regular, size}; };
    EXPECT_EQ(KTRVATheme::friendNameFont(), light(18.0));
    EXPECT_EQ(KTRVATheme::distanceFont(), light(18.0));
    EXPECT_EQ(KTRVATheme::friendLocationFont(), light(14.0));
    EXPECT_EQ(KTRVATheme::friendTimeFont(), light(14.0));
    EXPECT_EQ(KTRVATheme::geoFenceFriendLocationFont(), thin(14.0));
    EXPECT_EQ(KTRVATheme::showAllFont(), thin(18.0));
}

TEST_F(KTRVAThemeTest, Colours) {
    const Color text = Color::ofRole(ColorRole::StandardText);
    EXPECT_EQ(KTRVATheme::friendNameTextColor(), text);
    EXPECT_EQ(KTRVATheme::distanceTextColor(), text);
    EXPECT_EQ(KTRVATheme::friendLocationTextColor(), text);
    EXPECT_EQ(KTRVATheme::distanceColor(), text);
    EXPECT_EQ(KTRVATheme::selectionBackgroundColor(), Color::ofRole(ColorRole::Highlight));
    EXPECT_EQ(KTRVATheme::distanceShadowColor(), (Color{0.0, 0.0, 0.0, 0.5}));
}

TEST_F(KTRVAThemeTest, Orange_IsMadeOfSinglePrecisionQuotients) {
    const Color orange = KTRVATheme::ktrOrangeColor();
    EXPECT_EQ(orange.red, static_cast<double>(239.0F / 255.0F));
    EXPECT_EQ(orange.green, static_cast<double>(143.0F / 255.0F));
    EXPECT_EQ(orange.blue, static_cast<double>(20.0F / 255.0F));
    EXPECT_EQ(orange.alpha, 1.0);
    EXPECT_NEAR(orange.red, 0.9372549, 5e-8);
    EXPECT_NEAR(orange.green, 0.5607843, 5e-8);
    EXPECT_NEAR(orange.blue, 0.0784314, 5e-8);
    EXPECT_NE(orange.red, 239.0 / 255.0);
}

TEST_F(KTRVAThemeTest, ImagesComeFromThePluginsBundle) {
    const auto icon = addImage("appIcon_dyn");
    images->named["org.ktr.host/other"] = std::make_shared<FakeImage>();
    EXPECT_EQ(KTRVATheme::themeImageNamed("appIcon_dyn"), icon);
    EXPECT_EQ(KTRVATheme::themeImageNamed("other"), nullptr);
}

TEST_F(KTRVAThemeTest, TheIndicatorIsLookedUpOnce) {
    const auto indicator = addImage("location");
    EXPECT_EQ(KTRVATheme::locationIndicator(), indicator);
    addImage("location");
    EXPECT_EQ(KTRVATheme::locationIndicator(), indicator);
    EXPECT_EQ(images->lookups, 1);
}

TEST_F(KTRVAThemeTest, AFailedIndicatorLookupIsTriedAgain) {
    EXPECT_EQ(KTRVATheme::locationIndicator(), nullptr);
    const auto indicator = addImage("location");
    EXPECT_EQ(KTRVATheme::locationIndicator(), indicator);
    EXPECT_EQ(images->lookups, 2);
}

}  // namespace
}  // namespace ktr::test
