#include "plugin/KTRSnippetControllerFactory.h"

#include "model/LogCategory.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"
#include "plugin/VAKTRGeoFenceSnippetController.h"
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"

namespace ktr {

using platform::FormatArgument;

namespace {

bool accessibilitySizeIsActive() {
    const auto installed = platform::Platform::installed();
    return installed && installed->device &&
           platform::isAccessibilityCategory(installed->device->contentSizeCategory());
}

template <class Controller>
std::shared_ptr<platform::HostSnippetViewController> make(const std::shared_ptr<platform::VASnippet>& snippet) {
    return platform::create<Controller>(&Controller::initWithCueObject, snippet);
}

}  // namespace

std::shared_ptr<platform::HostSnippetViewController> KTRSnippetControllerFactory::viewControllerForSnippet(
    const std::shared_ptr<platform::AssistantObject>& snippet) {
    const auto located = std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(snippet);
    const auto visibility = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(snippet);
    const auto fenced = std::dynamic_pointer_cast<platform::VAKtrGeoFenceSnippet>(snippet);
    if (!located && !visibility && !fenced) {
        LogCategory_Unspecified()->line("Unrecognized snippet CueObject passed to %@: %@",
                                        FormatArgument("KTRSnippetControllerFactory").shown(), snippet);
        return nullptr;
    }
    if (accessibilitySizeIsActive()) {
        LogCategory_Unspecified()->line("There are no rows for accessibility text sizes yet; nothing is drawn for: %@",
                                        snippet);
        return nullptr;
    }
    if (visibility) {
        return make<VAKTRVisibilityController>(visibility);
    }
    if (fenced) {
        return make<VAKTRGeoFenceSnippetController>(fenced);
    }
    // The presence of a proximity counts, not its text.
    return located->proximity ? make<VAKTRMultipleLocationsSnippetController>(located)
                              : make<VAKTRLocationSnippetController>(located);
}

std::shared_ptr<platform::Object> KTRSnippetControllerFactory::speakableNamespaceProviderForCueObject(
    const std::shared_ptr<platform::AssistantObject>& /*object*/) {
    return nullptr;
}

}  // namespace ktr
