// The destructors here are each class's key function: type information lives in this library alone, so that kinds are
// told apart across host and plugin.
#include "platform/assistant/VASnippet.h"

namespace ktr::platform {

AssistantObject::~AssistantObject() = default;
VAEmail::~VAEmail() = default;
VAPhone::~VAPhone() = default;
VAPerson::~VAPerson() = default;
VAPersonAttribute::~VAPersonAttribute() = default;
VALocation::~VALocation() = default;
VAKtrLocation::~VAKtrLocation() = default;
VAKtrGeoFence::~VAKtrGeoFence() = default;
VASnippet::~VASnippet() = default;
VAKtrLocationSnippet::~VAKtrLocationSnippet() = default;
VAKtrGeoFenceSnippet::~VAKtrGeoFenceSnippet() = default;
VAKtrVisibilityView::~VAKtrVisibilityView() = default;

std::string VAPerson::description() const {
    return "<VAPerson " + fullName.value_or("(null)") + ">";
}

std::string VAKtrLocation::description() const {
    const auto handle = friend_ ? friend_->data : std::nullopt;
    return "<VAKtrLocation " + handle.value_or("(null)") + ">";
}

std::string VAKtrGeoFence::description() const {
    const auto handle = friend_ ? friend_->data : std::nullopt;
    return "<VAKtrGeoFence " + handle.value_or("(null)") + ">";
}

}  // namespace ktr::platform
