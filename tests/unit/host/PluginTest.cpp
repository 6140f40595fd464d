#include "host/Plugin.h"

#include <unistd.h>
#include <cstdlib>

#include <filesystem>
#include <fstream>

#include "host/PluginFinder.h"
#include "tests/support/PlatformTest.h"

namespace ktr::host {

namespace {

class KTRPluginTest : public test::PlatformTest {
  public:
    static std::string errorOf(const std::string& path) {
        const auto loaded = Plugin::load(path);
        const auto* error = std::get_if<std::string>(&loaded);
        return error == nullptr ? "no error" : *error;
    }
    static std::string testPlugin(const std::string& name) { return KTR_TEST_PLUGINS + name + ".so"; }
};

TEST_F(KTRPluginTest, RealPlugin_GivesItsPrincipalObject) {
    const auto loaded = Plugin::load(KTR_PLUGIN_FILE);
    const auto* plugin = std::get_if<std::unique_ptr<Plugin>>(&loaded);
    ASSERT_NE(plugin, nullptr) << std::get<std::string>(loaded);
    EXPECT_EQ((*plugin)->bundleIdentifier(), "org.ktr.snippets");
    EXPECT_FALSE((*plugin)->version().empty());
    EXPECT_EQ((*plugin)->factory().viewControllerForSnippet(nullptr), nullptr);
}

TEST_F(KTRPluginTest, MissingFile_IsTold) {
    EXPECT_EQ(errorOf("/nowhere/libx.so"), "/nowhere/libx.so: there is no such plugin");
    EXPECT_EQ(errorOf("/"), "/: this is no plugin, not even a file");
}

TEST_F(KTRPluginTest, FileThatIsNoLibrary_IsTold) {
    const auto path = std::filesystem::temp_directory_path() / ("ktr-no-library-" + std::to_string(::getpid()));
    std::ofstream(path) << "not a library";
    EXPECT_EQ(errorOf(path.string()).rfind("the plugin cannot be loaded: ", 0), 0u) << errorOf(path.string());
    std::filesystem::remove(path);
}

TEST_F(KTRPluginTest, ForeignLibrary_IsTold) {
    EXPECT_NE(errorOf(testPlugin("foreign")).find("this library is no plugin: it has no ktr_plugin_query"),
              std::string::npos);
}

TEST_F(KTRPluginTest, OtherAbi_IsToldBeforeAnythingIsCalled) {
    EXPECT_NE(errorOf(testPlugin("old")).find("its ABI number is 9, this host's is 2"), std::string::npos)
        << errorOf(testPlugin("old"));
}

TEST_F(KTRPluginTest, PrincipalObjectThatCannotBeMade_IsTold) {
    EXPECT_NE(errorOf(testPlugin("broken")).find("cannot make its principal object"), std::string::npos);
}

TEST_F(KTRPluginTest, Finder_PrefersWhatWasAskedThenTheEnvironmentThenItsPlaces) {
    ASSERT_EQ(setenv("KTR_PLUGIN", "/from/environment.so", 1), 0);
    EXPECT_EQ(PluginFinder::find("/asked.so"), "/asked.so");
    EXPECT_EQ(PluginFinder::find(""), "/from/environment.so");
    ASSERT_EQ(unsetenv("KTR_PLUGIN"), 0);
    EXPECT_TRUE(std::filesystem::equivalent(PluginFinder::find(""), KTR_PLUGIN_FILE));
}

}  // namespace

}  // namespace ktr::host
