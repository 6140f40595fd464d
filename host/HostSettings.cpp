#include "host/HostSettings.h"

#include <algorithm>

#include "linux/device/LinuxDevice.h"
#include "linux/locale/LocaleRegion.h"

namespace ktr::host {

namespace {

constexpr double kLongestRun = 7.0 * 86400.0;

/// The first scenario's answer to a question that it may leave open.
template <class Member>
auto firstOf(const std::vector<Scenario>& scenarios, Member member) {
    for (const Scenario& scenario : scenarios) {
        if (scenario.*member) {
            return scenario.*member;
        }
    }
    return decltype(std::declval<Scenario>().*member){};
}

template <class T>
std::optional<T> either(const std::optional<T>& first, const std::optional<T>& second) {
    return first ? first : second;
}

std::optional<std::string> countryOf(const std::string& locale) {
    return linux_::LocaleRegion(locale).countryCode();
}

double usualWidth(platform::UserInterfaceIdiom idiom) {
    return idiom == platform::UserInterfaceIdiom::Phone ? 400.0 : 1100.0;
}

}  // namespace

std::variant<HostSettings, Failure> HostSettings::decide(const HostOptions& options,
                                                         const std::vector<Scenario>& scenarios,
                                                         const documents::IsoTime& now,
                                                         const linux_::Configuration& configuration) {
    HostSettings settings;
    settings.said.language = either(options.language, firstOf(scenarios, &Scenario::language));
    settings.said.region = firstOf(scenarios, &Scenario::region);
    settings.said.country = firstOf(scenarios, &Scenario::country);
    settings.idiom =
        either(options.idiom, firstOf(scenarios, &Scenario::idiom)).value_or(platform::UserInterfaceIdiom::Phone);
    settings.said.textSize = either(options.textSize, firstOf(scenarios, &Scenario::textSize));
    settings.scale = options.scale;
    settings.width = options.width > 0.0 ? options.width : usualWidth(settings.idiom);
    settings.said.dark = either(options.dark, firstOf(scenarios, &Scenario::dark));
    settings.userName = firstOf(scenarios, &Scenario::userName);
    settings.said.highContrast = options.highContrast;
    const documents::IsoTime start = firstOf(scenarios, &Scenario::clock).value_or(options.at.value_or(now));
    settings.start = start.date;
    settings.offsetSeconds = start.offsetSeconds;
    if (options.atSeconds) {
        settings.runSeconds = *options.atSeconds;
    } else if (options.at) {
        settings.runSeconds = options.at->date.secondsSinceReferenceDate - start.date.secondsSinceReferenceDate;
        if (settings.runSeconds < 0.0 || settings.runSeconds > kLongestRun) {
            return Failure{ExitCode::Usage,
                           "the moment of the picture: expected a time from the scenario's start to a week after it"};
        }
    }
    for (const Scenario& scenario : scenarios) {
        for (const std::string& path : scenario.contacts) {
            auto& contacts = settings.said.contacts;
            if (std::find(contacts.begin(), contacts.end(), path) == contacts.end()) {
                contacts.push_back(path);
            }
        }
        if (settings.positions.empty()) {
            settings.positions = scenario.positions;
        }
    }
    settings.follow(configuration);
    return settings;
}

void HostSettings::decideTextSize() {
    using platform::ContentSizeCategory;
    const bool isDisplay = idiom == platform::UserInterfaceIdiom::Display;
    // Who leaves the desktop at its usual size has not asked for the usual size on a kitchen's wall.
    const auto desktop = desktopTextScale && *desktopTextScale != 1.0
                             ? std::optional(linux_::LinuxDevice::categoryForTextScale(*desktopTextScale))
                             : std::nullopt;
    textSize = either(either(said.textSize, configuredTextSize), desktop)
                   .value_or(isDisplay ? ContentSizeCategory::XL : ContentSizeCategory::L);
}

void HostSettings::follow(const linux_::Configuration& configuration) {
    language = either(said.language, configuration.language).value_or(linux_::LocaleRegion::sessionLanguage());
    region = said.region.value_or(countryOf(language) ? language : linux_::LocaleRegion::sessionLocale());
    country = either(said.country, countryOf(region));
    configuredTextSize = configuration.textSize;
    decideTextSize();
    using Colors = linux_::Configuration::Colors;
    const Colors colors = configuration.colors;
    dark = said.dark;
    if (!dark && (colors == Colors::Light || colors == Colors::Dark)) {
        dark = colors == Colors::Dark;
    }
    highContrast = said.highContrast || colors == Colors::HighContrast;
    distances = configuration.distances;
    addressBooks = configuration.addressBooks;
    contacts = said.contacts;
    contacts.insert(contacts.end(), configuration.contacts.begin(), configuration.contacts.end());
}

}  // namespace ktr::host
