#pragma once

#include <cstddef>
#include <memory>

#include "documents/FieldReader.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Date.h"

namespace ktr::host {

/// Makes assistant objects of JSON objects that carry their properties by name. Main thread.
class AssistantObjectReader {
  public:
    /// Names of people and places are cut off after so many bytes: measuring and wrapping a megabyte of text for a row
    /// of one line takes seconds. A handle is never cut, since it would be another's; a longer one is none.
    static constexpr std::size_t kLongestText = 1000;

    /// Ages ("ageSeconds") count back from `now`.
    explicit AssistantObjectReader(platform::Date now) : now_(now) {}

    /// The answer. Its "kind" is needed; a kind that is not known gives an UnknownAssistantObject.
    std::shared_ptr<platform::AssistantObject> readSnippet(documents::FieldReader& fields, std::string& kind) const;

  private:
    std::shared_ptr<platform::VAKtrLocationSnippet> readLocationSnippet(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrGeoFenceSnippet> readGeoFenceSnippet(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrVisibilityView> readVisibilityView(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrGeoFence> readGeoFence(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAKtrLocation> readLocation(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAPersonAttribute> readPersonAttribute(documents::FieldReader& fields) const;
    std::shared_ptr<platform::VAPerson> readPerson(documents::FieldReader& fields) const;
    std::optional<double> readLocationDate(documents::FieldReader& fields) const;

    platform::Date now_;
};

}  // namespace ktr::host
