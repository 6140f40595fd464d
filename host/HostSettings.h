#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "host/Failure.h"
#include "host/HostOptions.h"
#include "host/scenario/Scenario.h"
#include "linux/configuration/Configuration.h"
#include "platform/base/Date.h"

namespace ktr::host {

/// The world of one conversation, decided: from the command line, else from the scenarios (the first that says it),
/// else from the session. A value.
struct HostSettings {
    std::string language;                ///< BCP 47
    std::string region;                  ///< BCP 47: whose units and numbers are used
    std::optional<std::string> country;  ///< of the phone numbers
    platform::ContentSizeCategory textSize = platform::ContentSizeCategory::L;
    platform::UserInterfaceIdiom idiom = platform::UserInterfaceIdiom::Phone;
    double scale = 1.0;         ///< pixels a point
    double width = 400.0;       ///< points
    std::optional<bool> dark;   ///< none: as the session has it
    bool highContrast = false;  ///< as options or the configuration say
    linux_::Configuration::Distances distances = linux_::Configuration::Distances::System;
    bool addressBooks = true;           ///< whether the desktop's are read, where something is live
    platform::Date start;               ///< the conversation's first moment
    int offsetSeconds = 0;              ///< of the clock face that is shown, east of UTC
    double runSeconds = 0.0;            ///< from the start to the moment of the picture
    std::vector<std::string> contacts;  ///< paths: the scenarios', then the configuration's
    std::vector<ScenarioPosition> positions;
    /// Of the account that the scenarios tell; a live conversation has its own.
    std::optional<std::string> userName;
    /// The configuration file of a live conversation: one with an account, a service and the present moment. None: the
    /// conversation stands for itself, and nothing outside it is asked.
    std::optional<std::filesystem::path> liveConfiguration;

    /// What options or scenarios say themselves; the rest follows the configuration, then the session.
    struct Said {
        std::optional<std::string> language;
        std::optional<std::string> region;
        std::optional<std::string> country;
        std::optional<platform::ContentSizeCategory> textSize;
        std::vector<std::string> contacts;
        std::optional<bool> dark;
        bool highContrast = false;
    };
    Said said;
    /// The configuration's.
    std::optional<platform::ContentSizeCategory> configuredTextSize;
    /// The desktop's: 1 is its usual size. Null where no desktop was asked, or none answered.
    std::optional<double> desktopTextScale;
    bool desktopHighContrast = false;  ///< the desktop's wish
    /// Of a conversation that is not live: the maps that it is drawn on, besides the built-in ones.
    linux_::Configuration::Maps maps;
    /// Pixels of its maps a pixel of everything else: more than 1 where the picture is not one of pixels.
    double mapDensity = 1.0;

    /// Where anybody wishes it.
    bool drawsHighContrast() const { return highContrast || desktopHighContrast; }

    /// Decides again what a configuration has a word in: language, region, country, text size, colours, units and
    /// contacts.
    void follow(const linux_::Configuration& configuration);
    /// Decides the text size again: as said, else configured, else the desktop's, else the idiom's usual one.
    void decideTextSize();

    /// `now` and its local offset serve where no scenario has a clock. A failure for what cannot be drawn: text sizes
    /// for accessibility, and a moment too far from the start. What `configuration` says counts after the scenarios; it
    /// is the default one where nothing is live.
    static std::variant<HostSettings, Failure> decide(const HostOptions& options,
                                                      const std::vector<Scenario>& scenarios,
                                                      const documents::IsoTime& now,
                                                      const linux_::Configuration& configuration = {});
};

}  // namespace ktr::host
