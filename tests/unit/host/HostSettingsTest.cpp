#include "host/HostSettings.h"

#include <gtest/gtest.h>

namespace ktr::host {

namespace {

using platform::ContentSizeCategory;

HostSettings decided(const HostOptions& options = {}, const std::vector<Scenario>& scenarios = {},
                     const linux_::Configuration& configuration = {}) {
    return std::get<HostSettings>(HostSettings::decide(options, scenarios, {}, configuration));
}

ContentSizeCategory withDesktop(HostSettings settings, double scale) {
    settings.desktopTextScale = scale;
    settings.decideTextSize();
    return settings.textSize;
}

}  // namespace

TEST(KTRHostSettingsTest, TextSize_IsSaidElseConfiguredElseTheDesktopsElseUsual) {
    EXPECT_EQ(decided().textSize, ContentSizeCategory::L);
    EXPECT_EQ(withDesktop(decided(), 1.4), ContentSizeCategory::XXXL);
    EXPECT_EQ(withDesktop(decided(), 0.9), ContentSizeCategory::S);

    linux_::Configuration configuration;
    configuration.textSize = ContentSizeCategory::XL;
    EXPECT_EQ(decided({}, {}, configuration).textSize, ContentSizeCategory::XL);
    EXPECT_EQ(withDesktop(decided({}, {}, configuration), 1.4), ContentSizeCategory::XL);

    Scenario scenario;
    scenario.textSize = ContentSizeCategory::S;
    EXPECT_EQ(withDesktop(decided({}, {scenario}, configuration), 1.4), ContentSizeCategory::S);

    HostOptions options;
    options.textSize = ContentSizeCategory::XXL;
    EXPECT_EQ(withDesktop(decided(options, {scenario}, configuration), 1.4), ContentSizeCategory::XXL);
}

TEST(KTRHostSettingsTest, TextSize_FollowsAChangedConfiguration) {
    auto settings = decided();
    settings.desktopTextScale = 1.4;
    linux_::Configuration configuration;
    configuration.textSize = ContentSizeCategory::S;
    settings.follow(configuration);
    EXPECT_EQ(settings.textSize, ContentSizeCategory::S);
    settings.follow({});
    EXPECT_EQ(settings.textSize, ContentSizeCategory::XXXL) << "the desktop's again";
}

TEST(KTRHostSettingsTest, Display_StartsLargerUnlessTheDesktopSaysMore) {
    HostOptions options;
    options.idiom = platform::UserInterfaceIdiom::Display;
    EXPECT_EQ(decided(options).textSize, ContentSizeCategory::XL);
    EXPECT_EQ(withDesktop(decided(options), 1.0), ContentSizeCategory::XL);
    EXPECT_EQ(withDesktop(decided(options), 1.25), ContentSizeCategory::XXL);
}

}  // namespace ktr::host
