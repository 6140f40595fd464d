#pragma once

#include <memory>

#include "app/FieldReader.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Date.h"

namespace ktr::app {

/// Makes assistant objects of JSON objects that carry their properties by name. Main thread.
class AssistantObjectReader {
  public:
    /// Ages ("ageSeconds") count back from `now`.
    explicit AssistantObjectReader(platform::Date now) : now_(now) {}

    /// The answer. Its "kind" is needed; a kind that is not known gives an UnknownAssistantObject.
    std::shared_ptr<platform::AssistantObject> readSnippet(FieldReader& fields, std::string& kind) const;

  private:
    std::shared_ptr<platform::VAKtrLocationSnippet> readLocationSnippet(FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrGeoFenceSnippet> readGeoFenceSnippet(FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrVisibilityView> readVisibilityView(FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrGeoFence> readGeoFence(FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrLocation> readLocation(FieldReader& fields) const;
    std::shared_ptr<platform::VAPersonAttribute> readPersonAttribute(FieldReader& fields) const;
    std::shared_ptr<platform::VAPerson> readPerson(FieldReader& fields) const;
    std::optional<double> readLocationDate(FieldReader& fields) const;

    platform::Date now_;
};

}  // namespace ktr::app
