// A plugin that cannot make its principal object.
#include <cstdlib>

#include "platform/host/PluginInterface.h"

extern "C" {

__attribute__((visibility("default"))) const ktr_plugin_manifest* ktr_plugin_query() {
    static const ktr_plugin_manifest manifest = {KTR_PLUGIN_ABI, sizeof(ktr_plugin_manifest), "org.ktr.broken", "0.0.1",
                                                 "Broken"};
    return &manifest;
}
__attribute__((visibility("default"))) ktr::platform::SnippetControllerFactory* ktr_plugin_create(
    ktr::platform::Platform*) {
    return nullptr;
}
__attribute__((visibility("default"))) void ktr_plugin_destroy(ktr::platform::SnippetControllerFactory*) {
    std::abort();
}
}
