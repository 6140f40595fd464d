#include "host/Plugin.h"
#include "documents/FileSteps.h"

#include <dlfcn.h>

#include <filesystem>

namespace ktr::host {

namespace {

namespace fs = std::filesystem;

template <class Function>
Function symbol(void* library, const char* name) {
    // The one way from dlsym's object pointer to a function that POSIX promises to work.
    return reinterpret_cast<Function>(dlsym(library, name));
}

std::string lastError() {
    const char* error = dlerror();
    return error != nullptr ? error : "unknown reason";
}

}  // namespace

std::variant<std::unique_ptr<Plugin>, std::string> Plugin::load(const std::string& path) {
    std::error_code failure;
    if (!fs::exists(path, failure)) {
        return path + ": there is no such plugin";
    }
    if (!fs::is_regular_file(path, failure)) {
        return path + ": this is no plugin, not even a file";
    }
    // An absolute path: dlopen would look for a bare name in the system's folders.
    void* library = dlopen(documents::FileSteps::absolute(path).c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    if (library == nullptr) {
        return "the plugin cannot be loaded: " + lastError();
    }
    const auto query = symbol<ktr_plugin_query_function>(library, KTR_PLUGIN_QUERY);
    const auto create = symbol<ktr_plugin_create_function>(library, KTR_PLUGIN_CREATE);
    const auto destroy = symbol<ktr_plugin_destroy_function>(library, KTR_PLUGIN_DESTROY);
    if (query == nullptr || create == nullptr || destroy == nullptr) {
        return path + ": this library is no plugin: it has no " +
               std::string(query == nullptr    ? KTR_PLUGIN_QUERY
                           : create == nullptr ? KTR_PLUGIN_CREATE
                                               : KTR_PLUGIN_DESTROY);
    }
    const ktr_plugin_manifest* manifest = query();
    if (manifest == nullptr) {
        return path + ": the plugin has no manifest";
    }
    if (manifest->abi != KTR_PLUGIN_ABI || manifest->size < sizeof(ktr_plugin_manifest)) {
        return path + ": the plugin is built for another host: its ABI number is " + std::to_string(manifest->abi) +
               ", this host's is " + std::to_string(KTR_PLUGIN_ABI);
    }
    std::unique_ptr<Plugin> plugin(new Plugin);
    plugin->factory_ = create(platform::Platform::installed().get());
    if (plugin->factory_ == nullptr) {
        return path + ": the plugin cannot make its principal object";
    }
    plugin->destroy_ = destroy;
    plugin->bundleIdentifier_ = manifest->bundle_identifier;
    plugin->version_ = manifest->version;
    return plugin;
}

Plugin::~Plugin() {
    if (factory_ != nullptr) {
        destroy_(factory_);
    }
}

}  // namespace ktr::host
