#include "plugin/KTRSnippetControllerFactory.h"

#include "model/LogCategory.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"

namespace ktr {

using platform::FormatArgument;

std::shared_ptr<platform::HostSnippetViewController> KTRSnippetControllerFactory::viewControllerForSnippet(
    const std::shared_ptr<platform::AssistantObject>& snippet) {
    const auto located = std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(snippet);
    if (!located) {
        LogCategory_Unspecified()->line("Unrecognized snippet CueObject passed to %@: %@",
                                        FormatArgument("KTRSnippetControllerFactory").shown(), snippet);
        return nullptr;
    }
    const auto installed = platform::Platform::installed();
    if (installed && installed->device && platform::isAccessibilityCategory(installed->device->contentSizeCategory())) {
        LogCategory_Unspecified()->line("There are no rows for accessibility text sizes yet; nothing is drawn for: %@",
                                        snippet);
        return nullptr;
    }
    // The presence of a proximity counts, not its text.
    if (located->proximity) {
        return platform::create<VAKTRMultipleLocationsSnippetController>(
            &VAKTRMultipleLocationsSnippetController::initWithCueObject, located);
    }
    return platform::create<VAKTRLocationSnippetController>(&VAKTRLocationSnippetController::initWithCueObject,
                                                            located);
}

std::shared_ptr<platform::Object> KTRSnippetControllerFactory::speakableNamespaceProviderForCueObject(
    const std::shared_ptr<platform::AssistantObject>& /*object*/) {
    return nullptr;
}

}  // namespace ktr
