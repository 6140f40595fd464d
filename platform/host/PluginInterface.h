#pragma once

#include <cstdint>

#include "platform/base/Platform.h"
#include "platform/host/HostSnippetViewController.h"

/// The C entry of a plugin. A host loads the library with dlopen (RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE: deferred work
/// may outlive `destroy`), calls `ktr_plugin_query`, compares the ABI number, and only then makes the principal object.
/// All three functions belong to the main thread and never throw.
extern "C" {

/// Raised with every change of a class that host and plugin share.
#define KTR_PLUGIN_ABI 2u

struct ktr_plugin_manifest {
    std::uint32_t abi;
    std::uint32_t size;             ///< of this structure, bytes
    const char* bundle_identifier;  ///< reverse-domain
    const char* version;            ///< semantic version
    const char* principal_class;    ///< the class of the object that `create` makes
};

/// Never null; lives as long as the library.
typedef const ktr_plugin_manifest* (*ktr_plugin_query_function)();
/// Makes the plugin's principal object, owned by the plugin until `destroy`; null when it cannot be made. The host
/// hands it the platform that it has installed, which stays installed until after `destroy`; any other one is refused
/// with null.
typedef ktr::platform::SnippetControllerFactory* (*ktr_plugin_create_function)(ktr::platform::Platform* platform);
typedef void (*ktr_plugin_destroy_function)(ktr::platform::SnippetControllerFactory* factory);

#define KTR_PLUGIN_QUERY "ktr_plugin_query"
#define KTR_PLUGIN_CREATE "ktr_plugin_create"
#define KTR_PLUGIN_DESTROY "ktr_plugin_destroy"
}
