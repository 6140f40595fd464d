#include "model/PluginBundle.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

class PluginBundleTest : public PlatformTest {};

TEST_F(PluginBundleTest, ThereIsOneBundle) {
    EXPECT_EQ(PluginBundle::bundle()->identifier(), "org.ktr.snippets");
    EXPECT_EQ(PluginBundle::bundle(), PluginBundle::bundle());
}

TEST_F(PluginBundleTest, TextsAreLookedUpInThePluginsDefaultTable) {
    localization->set("org.ktr.snippets", "APPLICATION_NAME", "Friends");
    localization->set("org.ktr.host", "SHOW_ALL", "the host's");
    EXPECT_EQ(AssistantLocalizedString("APPLICATION_NAME"), "Friends");
    EXPECT_EQ(AssistantLocalizedString("SHOW_ALL"), "SHOW_ALL") << "a text that is nowhere shows its key";
}

}  // namespace
}  // namespace ktr::test
