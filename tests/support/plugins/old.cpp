// A plugin of another ABI: its other functions must not be called, and would end the process.
#include <cstdlib>

#include "platform/host/PluginInterface.h"

extern "C" {

__attribute__((visibility("default"))) const ktr_plugin_manifest* ktr_plugin_query() {
    static const ktr_plugin_manifest manifest = {KTR_PLUGIN_ABI + 7, sizeof(ktr_plugin_manifest), "org.ktr.old",
                                                 "0.0.1", "Old"};
    return &manifest;
}
__attribute__((visibility("default"))) ktr::platform::SnippetControllerFactory* ktr_plugin_create(
    ktr::platform::Platform*) {
    std::abort();
}
__attribute__((visibility("default"))) void ktr_plugin_destroy(ktr::platform::SnippetControllerFactory*) {
    std::abort();
}
}
