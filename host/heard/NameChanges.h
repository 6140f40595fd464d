#pragma once

#include <optional>
#include <string>
#include <unordered_map>

#include "platform/ui/AccessibilitySubject.h"

namespace ktr::host {

/// Decides when whoever listens is told that an element's name has become another one. A name is computed when it is
/// read, and so never old: a notice is for what a listener would want to hear of, since each may be spoken. Of a person
/// that is another place, whereabouts, kind of age or closeness; for the distance alone, and for an element that is
/// about nobody, there is one notice a minute. Seconds of any clock that only goes forward. Any one thread.
class NameChanges {
  public:
    static constexpr double kLeastBetween = 60.0;
    /// How far beyond the limit between two kinds of closeness a distance has to be for the next kind, as a part of it.
    static constexpr double kHysteresis = 0.2;

    /// Whether to tell; an element that comes for the first time is only taken note of.
    bool isNews(const void* element, const std::string& name,
                const std::optional<platform::AccessibilitySubject>& subject, double now);
    void forget(const void* element) { told_.erase(element); }

    /// From 0, within 100 m, to 4, beyond 100 km; `before` is what it was, none: nothing holds it.
    static int closeness(double metres, std::optional<int> before);

  private:
    struct Told {
        std::string name;
        std::optional<platform::AccessibilitySubject> subject;
        std::optional<int> closeness;
        double at = 0.0;
    };

    std::unordered_map<const void*, Told> told_;
};

}  // namespace ktr::host
