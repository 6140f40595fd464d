#include <dlfcn.h>

#include "platform/host/PluginInterface.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

// The library as a host meets it: loaded with dlopen, known by its C functions alone.

namespace ktr {

using namespace platform;
using test::placedFriend;
using test::proximitySnippet;

class PluginEntryTest : public test::PlatformTest {
  protected:
    void SetUp() override {
        library_ = dlopen(KTR_PLUGIN_FILE, RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
        ASSERT_NE(library_, nullptr) << dlerror();
        query_ = reinterpret_cast<ktr_plugin_query_function>(dlsym(library_, KTR_PLUGIN_QUERY));
        create_ = reinterpret_cast<ktr_plugin_create_function>(dlsym(library_, KTR_PLUGIN_CREATE));
        destroy_ = reinterpret_cast<ktr_plugin_destroy_function>(dlsym(library_, KTR_PLUGIN_DESTROY));
        ASSERT_TRUE(query_ && create_ && destroy_);
    }

    void* library_ = nullptr;
    ktr_plugin_query_function query_ = nullptr;
    ktr_plugin_create_function create_ = nullptr;
    ktr_plugin_destroy_function destroy_ = nullptr;
};

TEST_F(PluginEntryTest, Query_NamesAbiBundleAndPrincipalClass) {
    const ktr_plugin_manifest* manifest = query_();
    ASSERT_NE(manifest, nullptr);
    EXPECT_EQ(manifest->abi, KTR_PLUGIN_ABI);
    EXPECT_EQ(manifest->size, sizeof(ktr_plugin_manifest));
    EXPECT_STREQ(manifest->bundle_identifier, "org.ktr.snippets");
    EXPECT_STREQ(manifest->principal_class, "KTRSnippetControllerFactory");
    EXPECT_STREQ(manifest->version, KTR_PLUGIN_VERSION);
    EXPECT_EQ(query_(), manifest);
}

TEST_F(PluginEntryTest, Snippet_IsDrawnByTheLoadedLibrary) {
    SnippetControllerFactory* factory = create_(platform.get());
    ASSERT_NE(factory, nullptr);
    const auto controller = factory->viewControllerForSnippet(proximitySnippet({placedFriend("Ann", "a@example.org")}));
    ASSERT_NE(controller, nullptr);
    const auto host = std::make_shared<test::FakeHost>();
    controller->setDelegate(host);
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 78.5);
    EXPECT_NE(controller->sashItem(), nullptr);
    EXPECT_EQ(factory->viewControllerForSnippet(nullptr), nullptr);
    destroy_(factory);
}

TEST_F(PluginEntryTest, ControllerAndDeferredWork_OutliveDestroyAndClose) {
    SnippetControllerFactory* factory = create_(platform.get());
    ASSERT_NE(factory, nullptr);
    auto controller = factory->viewControllerForSnippet(proximitySnippet({placedFriend("Ann", "a@example.org")}));
    ASSERT_NE(controller, nullptr);
    controller->desiredHeightForWidth(320.0);
    controller->viewWillAppear(false);
    destroy_(factory);
    dlclose(library_);
    time->advance(30.2);
    controller.reset();
    time->advance(60.0);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(PluginEntryTest, Create_AnyOtherPlatformThanTheInstalledOne_IsRefused) {
    Platform other;
    EXPECT_EQ(create_(&other), nullptr);
    EXPECT_EQ(create_(nullptr), nullptr);
    Platform::install(nullptr);
    EXPECT_EQ(create_(platform.get()), nullptr);
    EXPECT_EQ(create_(nullptr), nullptr);
}

TEST_F(PluginEntryTest, Destroy_EndsThePrincipalObject) {
    SnippetControllerFactory* factory = create_(platform.get());
    ASSERT_NE(factory, nullptr);
    const std::weak_ptr<Object> principal = factory->weak_from_this();
    EXPECT_FALSE(principal.expired());
    destroy_(factory);
    EXPECT_TRUE(principal.expired());
}

TEST_F(PluginEntryTest, Destroy_OfNoneOrTwice_IsIgnored) {
    SnippetControllerFactory* factory = create_(platform.get());
    SnippetControllerFactory* other = create_(platform.get());
    const std::weak_ptr<Object> principal = other->weak_from_this();
    destroy_(nullptr);
    destroy_(factory);
    destroy_(factory);
    // The other principal object is as it was: alive, and of use.
    ASSERT_FALSE(principal.expired());
    EXPECT_NE(other->viewControllerForSnippet(proximitySnippet({})), nullptr);
    EXPECT_NE(create_(platform.get()), nullptr);
    Platform::install(nullptr);
    EXPECT_TRUE(principal.expired());
    destroy_(factory);
    destroy_(other);
}

TEST_F(PluginEntryTest, EachCreate_MakesAPrincipalObjectOfItsOwn) {
    SnippetControllerFactory* first = create_(platform.get());
    SnippetControllerFactory* second = create_(platform.get());
    EXPECT_NE(first, second);
    destroy_(first);
    EXPECT_EQ(second->viewControllerForSnippet(nullptr), nullptr);
    destroy_(second);
}

TEST_F(PluginEntryTest, UninstallingThePlatform_EndsWhatWasNotDestroyed) {
    const std::weak_ptr<Object> principal = create_(platform.get())->weak_from_this();
    Platform::install(nullptr);
    EXPECT_TRUE(principal.expired());
}

TEST_F(PluginEntryTest, NothingButTheEntryIsExported) {
    // The principal class's type information stands for everything else: hidden, two libraries of one name never mix.
    EXPECT_EQ(dlsym(library_, "_ZTIN3ktr27KTRSnippetControllerFactoryE"), nullptr);
    EXPECT_EQ(dlsym(library_, "_ZN3ktr22LogCategory_UnspecifiedEv"), nullptr);
}

TEST_F(PluginEntryTest, ForeignLibrary_HasNoEntry) {
    // The platform library is a library, and no plugin: what a host asks of it is not found by way of the plugin.
    void* foreign = dlopen(KTR_PLATFORM_FILE, RTLD_NOW | RTLD_LOCAL);
    ASSERT_NE(foreign, nullptr) << dlerror();
    EXPECT_EQ(dlsym(foreign, KTR_PLUGIN_QUERY), nullptr);
    EXPECT_EQ(dlsym(foreign, KTR_PLUGIN_CREATE), nullptr);
    dlclose(foreign);
}

}  // namespace ktr
