#pragma once

#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// What a row says of a person, taken apart, so that whoever speaks for a listener can tell what changed. A value.
struct AccessibilitySubject {
    enum class Whereabouts {
        Sought,   ///< not known yet
        Unknown,  ///< not known, or not told
        Known,
    };

    std::string person;
    std::string handle;  ///< tells two of one name apart; not said
    Whereabouts whereabouts = Whereabouts::Unknown;
    std::string place;           ///< in the row's words; empty for one without a name
    std::optional<int> ageBand;  ///< which of the five kinds of age, from 0, the newest; none without an age
    std::optional<double> metres;
    std::string distance;  ///< in the row's words; empty without one
    bool operator==(const AccessibilitySubject&) const = default;
};

/// A view that is about a person. Main thread.
class KTR_API AccessibilitySubjectView {
  public:
    virtual ~AccessibilitySubjectView();
    /// As it is now; none for a person of whom no news is told, such as the user.
    virtual std::optional<AccessibilitySubject> accessibilitySubject() const = 0;
};

}  // namespace ktr::platform
