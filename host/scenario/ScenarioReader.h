#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "documents/DocumentError.h"
#include "host/scenario/Scenario.h"

namespace ktr::host {

/// Reads scenario files. Main thread.
class ScenarioReader {
  public:
    /// Whether a scenario's own clock counts, or the present alone: in a live conversation.
    enum class Clock { OfTheScenario, Present };

    /// `now` stands for the scenario's own clock where the file has none; ages in seconds count back from it.
    explicit ScenarioReader(platform::Date now, Clock clock = Clock::OfTheScenario) : now_(now), clock_(clock) {}

    /// Unknown members go to `warnings`, if there are any to go to.
    std::variant<Scenario, documents::DocumentError> readFile(const std::string& file,
                                                              documents::DocumentWarnings* warnings = nullptr) const;
    /// `file` names the text in messages, and its folder is what relative paths start from.
    std::variant<Scenario, documents::DocumentError> readText(std::string_view text, const std::string& file,
                                                              documents::DocumentWarnings* warnings = nullptr) const;

  private:
    platform::Date now_;
    Clock clock_;
};

}  // namespace ktr::host
