#include "plugin/KTRSnippetControllerFactory.h"

#include "model/LogCategory.h"
#include "platform/assistant/VASnippet.h"
#include "plugin/VAKTRGeoFenceSnippetController.h"
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"

namespace ktr {

using platform::FormatArgument;

namespace {

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
    // In this order: an object of two kinds is the first of them.
    if (located) {
        // The presence of a proximity counts, not its text.
        return located->proximity ? make<VAKTRMultipleLocationsSnippetController>(located)
                                  : make<VAKTRLocationSnippetController>(located);
    }
    if (visibility) {
        return make<VAKTRVisibilityController>(visibility);
    }
    return make<VAKTRGeoFenceSnippetController>(fenced);
}

std::shared_ptr<platform::Object> KTRSnippetControllerFactory::speakableNamespaceProviderForCueObject(
    const std::shared_ptr<platform::AssistantObject>& /*object*/) {
    return nullptr;
}

}  // namespace ktr
