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

void VALocation::copyTo(VALocation& other) const {
    other.latitude = latitude;
    other.longitude = longitude;
    other.accuracy = accuracy;
    other.label = label;
    other.street = street;
}

std::shared_ptr<VALocation> VALocation::copy() const {
    auto other = std::make_shared<VALocation>();
    copyTo(*other);
    return other;
}

std::shared_ptr<VALocation> VAKtrLocation::copy() const {
    auto other = std::make_shared<VAKtrLocation>();
    copyTo(*other);
    other->friend_ = friend_;
    other->distance = distance;
    other->city = city;
    other->stateCode = stateCode;
    other->locationDate = locationDate;
    return other;
}

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
