#include "host/Environment.h"

#include <filesystem>
#include <optional>

#include "host/Resources.h"
#include "host/scenario/ScenarioAccounts.h"
#include "host/scenario/ScenarioClock.h"
#include "linux/configuration/ConfiguredAssistant.h"
#include "linux/contacts/ContactFiles.h"
#include "linux/contacts/MemoryContactStore.h"
#include "linux/contacts/PhonenumberLibrary.h"
#include "linux/contacts/PrefixedAssistantContacts.h"
#include "linux/contacts/ScriptContactFormatter.h"
#include "linux/device/FilteredLogSink.h"
#include "linux/device/LinuxDevice.h"
#include "linux/device/QtMainLoop.h"
#include "linux/device/StderrLogSink.h"
#include "linux/device/SystemClock.h"
#include "linux/locale/HomeCountry.h"
#include "linux/locale/IcuDistanceCalculatorFactory.h"
#include "linux/locale/IcuLengthFormatter.h"
#include "linux/locale/IcuNumberFormatter.h"
#include "linux/locale/IcuPluralRules.h"
#include "linux/locale/LocalCalendar.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/locale/QtLocalization.h"
#include "linux/locale/SettingsTelephony.h"
#include "linux/maps/ConfiguredMaps.h"
#include "linux/paint/QtAppearance.h"
#include "linux/paint/QtAvatarImages.h"
#include "linux/paint/QtImageSource.h"
#include "linux/paint/QtMonogramMakerFactory.h"
#include "linux/paint/QtTextEngine.h"
#include "linux/positions/GeographicLibGeodesy.h"
#include "linux/positions/ScenarioLocationManagerFactory.h"

namespace ktr::host {

namespace {

using platform::Platform;

std::vector<linux_::TimedPosition> walkOf(const std::vector<ScenarioPosition>& positions) {
    std::vector<linux_::TimedPosition> walk;
    for (const ScenarioPosition& position : positions) {
        linux_::TimedPosition timed;
        timed.seconds = position.at;
        timed.fix.coordinate = position.coordinate;
        timed.fix.horizontalAccuracy = position.accuracy;
        timed.fix.verticalAccuracy = -1.0;
        timed.fix.course = -1.0;
        timed.fix.speed = -1.0;
        walk.push_back(timed);
    }
    return walk;
}

std::shared_ptr<linux_::QtLocalization> readTexts(const HostSettings& settings, std::string& error) {
    auto texts = std::make_shared<linux_::QtLocalization>(settings.language);
    const auto folder = resourceFolder() / "localization";
    if (!texts->addBundle(platform::kSnippetsBundle, folder, "snippets") ||
        !texts->addBundle(linux_::QtLocalization::kHostBundle, folder, "host")) {
        error = "the program's texts cannot be read: " + folder.string();
    }
    return texts;
}

/// None: the session's.
std::optional<linux_::UnitSystem> chosenUnits(const HostSettings& settings) {
    using Chosen = linux_::Configuration::Distances;
    switch (settings.distances) {
        case Chosen::Kilometres:
            return linux_::UnitSystem::Metric;
        case Chosen::Miles:
            return linux_::LocaleRegion(settings.region).countryCode() == "GB" ? linux_::UnitSystem::ImperialUK
                                                                               : linux_::UnitSystem::ImperialUS;
        case Chosen::System:
            break;
    }
    return std::nullopt;
}

/// Lengths on maps are shown in the units of the distances beside them, whatever decides those.
platform::LengthSystem lengthSystem(const Platform& platform) {
    platform::DistanceCalculator::Settings settings;
    settings.defaultsSuite = "group.org.ktr";
    settings.measurementSystemLocale = platform.region->localeIdentifier();
    switch (platform.distanceCalculators->makeDistanceCalculator(settings)->measurementSystem()) {
        case 1:
            return platform::LengthSystem::UnitedStates;
        case 2:
            return platform::LengthSystem::UnitedKingdom;
        default:
            return platform::LengthSystem::Metric;
    }
}

void addMaps(Platform& platform, const HostSettings& settings, LiveServices* live, const Platform* earlier) {
    platform.lengths = std::make_shared<linux_::IcuLengthFormatter>(
        linux_::LocaleRegion(settings.region).localeWithLanguage(settings.language), lengthSystem(platform));
    if (earlier != nullptr) {
        platform.mapsApplication = earlier->mapsApplication;
        // What it has drawn and fetched is good in every language.
        platform.maps = earlier->maps;
        return;
    }
    linux_::Configuration configuration = live ? live->configuration() : linux_::Configuration{};
    if (!live) {
        configuration.maps = settings.maps;
    }
    const auto maps = linux_::ConfiguredMaps::make(configuration, resourceFolder(), platform.mainLoop,
                                                   live ? live->network() : nullptr);
    maps->setDensity(settings.mapDensity);
    platform.maps = maps;
    if (live) {
        live->drawConfiguredMaps(maps);
    }
}

void addUserInterface(Platform& platform, const HostSettings& settings, bool isWithoutWindow, const Platform* earlier) {
    auto device = std::make_shared<linux_::LinuxDevice>();
    device->setUserInterfaceIdiom(settings.idiom);
    device->setMainScreenScale(settings.scale);
    device->setContentSizeCategory(settings.textSize);
    platform.device = device;
    platform.textEngine = std::make_shared<linux_::QtTextEngine>(QString::fromStdString(settings.language));
    platform.images = std::make_shared<linux_::QtImageSource>((resourceFolder() / "images").string(), device);
    if (earlier != nullptr) {
        platform.appearance = earlier->appearance;
    } else {
        auto appearance = std::make_shared<linux_::QtAppearance>();
        // In real time without a window no motion is seen: at any moment maps are where they would come to rest.
        appearance->setReducesMotion(isWithoutWindow && settings.liveConfiguration.has_value());
        platform.appearance = appearance;
    }
    const auto faces = std::make_shared<linux_::QtAvatarImages>();
    platform.avatarImages = faces;
    platform.monogramMakers = std::make_shared<linux_::QtMonogramMakerFactory>(faces);
}

}  // namespace

std::optional<Failure> Environment::fill(Platform& made, const HostSettings& settings, const Contacts& contacts,
                                         const Platform* earlier) {
    made.calendar = std::make_shared<linux_::LocalCalendar>();
    made.assistant = std::make_shared<linux_::ConfiguredAssistant>(settings.language);
    const auto region = std::make_shared<linux_::LocaleRegion>(settings.region);
    made.region = region;
    made.decimalNumbers = std::make_shared<linux_::IcuNumberFormatter>(region->localeWithLanguage(settings.language));
    made.pluralRules = std::make_shared<linux_::IcuPluralRules>();
    made.geodesy = std::make_shared<linux_::GeographicLibGeodesy>();
    // A picture or a text must not depend on whose session it is made in.
    using Distances = linux_::IcuDistanceCalculatorFactory;
    made.distanceCalculators = std::make_shared<Distances>(
        made.geodesy, isVirtual_ ? std::nullopt : std::optional(Distances::sessionPreferences()),
        chosenUnits(settings));
    if (earlier != nullptr) {
        // Whoever walks goes on from where they are.
        made.locationManagers = earlier->locationManagers;
    } else {
        made.locationManagers = std::make_shared<linux_::ScenarioLocationManagerFactory>(
            walkOf(settings.positions), made.mainLoop, made.clock, made.geodesy);
    }
    const auto phoneNumbers = std::make_shared<linux_::PhonenumberLibrary>();
    made.phoneNumbers = phoneNumbers;
    made.telephony = std::make_shared<linux_::SettingsTelephony>(settings.country);
    made.contactFormatter = std::make_shared<linux_::ScriptContactFormatter>();
    made.assistantContacts = std::make_shared<linux_::PrefixedAssistantContacts>();
    std::string error;
    made.localization = readTexts(settings, error);
    if (!error.empty()) {
        return Failure{ExitCode::Failure, error};
    }
    made.contactStore = std::make_shared<linux_::MemoryContactStore>(
        contacts, phoneNumbers, linux_::HomeCountry::of(*made.telephony, *made.region));
    addUserInterface(made, settings, isVirtual_, earlier);
    if (settings.userName) {
        made.accounts = std::make_shared<ScenarioAccounts>(*settings.userName);
    }
    if (live) {
        live->addTo(made, settings.language, !settings.positions.empty());
    }
    addMaps(made, settings, live.get(), earlier);
    return std::nullopt;
}

std::optional<Environment::Contacts> Environment::readContacts(const HostSettings& settings, bool isLive,
                                                               std::string& error) {
    if (!isLive) {
        return linux_::ContactFiles::read(settings.contacts, error);
    }
    userContacts =
        std::make_unique<linux_::UserContacts>(platform->mainLoop, settings.contacts, "", settings.addressBooks);
    auto contacts = userContacts->first(linux_::UserContacts::kFirstWait, error);
    return error.empty() ? std::optional(std::move(contacts)) : std::nullopt;
}

std::variant<Environment, Failure> Environment::make(const HostSettings& settings, bool isVirtual) {
    Environment environment;
    environment.isVirtual_ = isVirtual;
    const auto foundation = std::make_shared<Platform>();
    const auto secrets = std::make_shared<linux_::KnownSecrets>();
    foundation->logSink = std::make_shared<linux_::FilteredLogSink>(
        std::make_shared<linux_::StderrLogSink>(linux_::StderrLogSink::environmentShowsPrivate(), stderr, secrets),
        linux_::FilteredLogSink::environmentLevel());
    const bool isLive = settings.liveConfiguration.has_value();
    if (isVirtual && !isLive) {
        environment.virtualTime = std::make_shared<platform::VirtualTime>(settings.start);
        foundation->mainLoop = environment.virtualTime;
        foundation->clock = environment.virtualTime;
    } else {
        foundation->mainLoop = std::make_shared<linux_::QtMainLoop>();
        foundation->clock = isLive ? std::shared_ptr<platform::Clock>(std::make_shared<linux_::SystemClock>())
                                   : std::make_shared<ScenarioClock>(settings.start);
    }
    Platform::install(foundation);
    environment.platform = std::make_shared<Platform>();
    environment.platform->logSink = foundation->logSink;
    environment.platform->mainLoop = foundation->mainLoop;
    environment.platform->clock = foundation->clock;
    if (isLive) {
        environment.live = std::make_unique<LiveServices>(*settings.liveConfiguration, secrets);
    }
    std::string error;
    auto contacts = environment.readContacts(settings, isLive, error);
    auto failure = contacts ? environment.fill(*environment.platform, settings, *contacts, nullptr)
                            : Failure{ExitCode::Failure, "the contacts cannot be read: " + error};
    if (failure) {
        Platform::install(nullptr);
        return *failure;
    }
    environment.contacts_ = std::move(*contacts);
    return environment;
}

std::optional<Failure> Environment::remake(const HostSettings& settings, const Contacts* contacts) {
    const auto next = std::make_shared<Platform>();
    next->logSink = platform->logSink;
    next->mainLoop = platform->mainLoop;
    next->clock = platform->clock;
    const auto& now = contacts ? *contacts : contacts_;
    if (auto failure = fill(*next, settings, now, platform.get())) {
        return failure;
    }
    platform = next;
    if (contacts) {
        contacts_ = *contacts;
    }
    return std::nullopt;
}

}  // namespace ktr::host
