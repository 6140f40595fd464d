// The library's exported functions, and nothing else: everything behind them is hidden.
#include <memory>
#include <unordered_map>

#include "platform/base/Api.h"
#include "platform/base/Bundle.h"
#include "platform/host/PluginInterface.h"
#include "plugin/KTRSnippetControllerFactory.h"

namespace {

using ktr::platform::Platform;
using ktr::platform::SnippetControllerFactory;

constexpr ktr_plugin_manifest kManifest = {KTR_PLUGIN_ABI, sizeof(ktr_plugin_manifest), ktr::platform::kSnippetsBundle,
                                           KTR_PLUGIN_VERSION, "KTRSnippetControllerFactory"};

/// The principal objects that hosts hold; they go with the platform at the latest.
struct PrincipalObjects {
    static std::shared_ptr<PrincipalObjects> makeShared() { return std::make_shared<PrincipalObjects>(); }
    std::unordered_map<const SnippetControllerFactory*, std::shared_ptr<SnippetControllerFactory>> held;
};

}  // namespace

extern "C" {

KTR_API const ktr_plugin_manifest* ktr_plugin_query() {
    return &kManifest;
}

KTR_API SnippetControllerFactory* ktr_plugin_create(Platform* platform) {
    // Memory may run out, and a host written in C could not catch that.
    try {
        if (!platform || Platform::installed().get() != platform) {
            return nullptr;
        }
        const auto factory = std::make_shared<ktr::KTRSnippetControllerFactory>();
        ktr::platform::shared<PrincipalObjects>()->held.emplace(factory.get(), factory);
        return factory.get();
    } catch (...) {
        return nullptr;
    }
}

KTR_API void ktr_plugin_destroy(SnippetControllerFactory* factory) {
    try {
        if (const auto objects = ktr::platform::shared<PrincipalObjects>()) {
            objects->held.erase(factory);
        }
    } catch (...) {
        // The object goes with the platform instead.
    }
}
}
