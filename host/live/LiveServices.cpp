#include "host/live/LiveServices.h"

#include <utility>
#include <variant>

#include "host/Resources.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/ConfiguredGeography.h"
#include "linux/configuration/ConfiguredRestrictions.h"
#include "linux/configuration/FilePreferences.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/device/SystemDeviceInformation.h"
#include "linux/maps/ConfiguredMaps.h"
#include "linux/net/QtHttpTransport.h"
#include "linux/net/RememberedHostTransport.h"
#include "linux/positions/ConfiguredPositions.h"
#include "platform/base/Bundle.h"
#include "platform/base/MainLoop.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::host {

namespace {

/// Where the plugin keeps its preferences.
constexpr const char* kPreferences = platform::kSnippetsBundle;

linux_::QtHttpTransport::Settings transportSettings(const linux_::ConfiguredAccountStore& accounts) {
    const auto configuration = accounts.configuration();
    linux_::QtHttpTransport::Settings settings;
    if (configuration.account) {
        settings.serviceHost = configuration.account->host;
        settings.domains = configuration.account->domains;
    }
    settings.certificateFiles = configuration.certificates;
    return settings;
}

}  // namespace

LiveServices::LiveServices(std::filesystem::path configurationFile, std::shared_ptr<linux_::KnownSecrets> secrets)
    : file_(std::move(configurationFile)), accounts_(std::make_shared<linux_::ConfiguredAccountStore>(file_)) {
    accounts_->setKnownSecrets(std::move(secrets));
    // What is wrong with the file is reported when the account is read.
    auto read = linux_::ConfigurationReader::readFile(file_);
    if (auto* configuration = std::get_if<linux_::Configuration>(&read)) {
        configuration_ = std::move(*configuration);
    }
}

LiveServices::~LiveServices() {
    outdated_ = nullptr;
    // The loop waits for its workers when it ends.
    accounts_->giveUp();
    if (service_) {
        service_->setChanged(nullptr);
    }
}

void LiveServices::makeOnce(const platform::Platform& platform) {
    mainLoop_ = platform.mainLoop;
    evenClock_ = std::make_shared<linux_::EvenClock>(platform.clock);
    deviceInformation_ = std::make_shared<linux_::SystemDeviceInformation>();
    deviceLock_ = std::make_shared<linux_::LogindLock>();
    preferences_ = std::make_shared<linux_::FilePreferences>(linux_::XdgFolders::state() / "preferences");
    preferences_->load(kPreferences);
    const auto lane = [accounts = accounts_, network = network_]() -> std::shared_ptr<platform::HttpTransport> {
        return std::make_shared<linux_::QtHttpTransport>([accounts] { return transportSettings(*accounts); }, network);
    };
    lanes_ = std::make_shared<ServiceLanes>(lane, mainLoop_);
    const auto remembering = std::make_shared<linux_::RememberedHostTransport>(
        lanes_, preferences_, [accounts = accounts_] { return transportSettings(*accounts).serviceHost; },
        kPreferences);
    service_ = std::make_shared<ServiceWatch>(remembering, mainLoop_, evenClock_);
    requests_ = std::make_shared<SeenRequests>(service_, mainLoop_);
    service_->setChanged([this] {
        if (changed_) {
            changed_();
        }
    });
    // Asked on the main thread, at each question.
    assistant_ = std::make_unique<linux_::AssistantClient>(
        [this] {
            const auto configured = accounts_->configuration();
            const auto account = accounts_->deviceOwnerAccount();
            const auto token = account ? account->tokenOfType(platform::kFriendLocationService) : std::nullopt;
            const auto authorization =
                token ? platform::basicAuthorization(account->personIdentifier().value_or(""), *token) : std::nullopt;
            return linux_::AssistantClient::Settings{configured.account ? configured.account->assistant : std::nullopt,
                                                     authorization, configured.certificates, language_};
        },
        network_);
}

void LiveServices::addTo(platform::Platform& platform, const std::string& language, bool ownPositions) {
    using Source = linux_::Configuration::Positions::Source;
    if (!mainLoop_) {
        makeOnce(platform);
    }
    language_ = language;
    account_ = accounts_->deviceOwnerAccount();
    platform.accounts = accounts_;
    platform.deviceInformation = deviceInformation_;
    platform.deviceLock = deviceLock_;
    platform.restrictions = std::make_shared<linux_::ConfiguredRestrictions>(accounts_);
    platform.geographicSettings = std::make_shared<linux_::ConfiguredGeography>(accounts_);
    platform.preferences = preferences_;
    platform.httpTransport = requests_;
    if (!ownPositions) {
        if (!positions_ || positionsMade_ != configuration_.positions) {
            positionsMade_ = configuration_.positions;
            positions_ = linux_::ConfiguredPositions::make(positionsMade_, mainLoop_, platform.clock, platform.geodesy);
        }
        platform.locationManagers = positions_;
    }
    looksForPosition_ = ownPositions || configuration_.positions.source != Source::None;
}

void LiveServices::start(std::function<void()> ready) {
    watcher_ = std::make_unique<linux_::ConfigurationWatcher>(accounts_, mainLoop_, [this] { configurationChanged(); });
    watcher_->start([this, ready = std::move(ready)] {
        // Nothing has asked for the account before it is read for the first time.
        account_ = accounts_->deviceOwnerAccount();
        configurationChanged();
        // Before that a locked session would count as one without a lock.
        if (deviceLock_->isKnown()) {
            ready();
        } else {
            deviceLock_->setKnown(ready);
        }
    });
}

void LiveServices::drawConfiguredMaps(std::shared_ptr<linux_::ThreadedMapSource> maps) {
    maps_ = std::move(maps);
}

bool LiveServices::takeConfiguration() {
    const auto before = std::exchange(configuration_, accounts_->configuration());
    auto rest = configuration_;
    rest.contacts = before.contacts;
    rest.addressBooks = before.addressBooks;
    return rest != before || accounts_->deviceOwnerAccount() != account_;
}

void LiveServices::configurationChanged() {
    const auto now = accounts_->configuration();
    if (maps_ && (now.maps != configuration_.maps || now.certificates != configuration_.certificates)) {
        maps_->setGrounds(linux_::ConfiguredMaps::grounds(now, resourceFolder(), network_));
    }
    configuration_.maps = now.maps;
    configuration_.certificates = now.certificates;
    // The store keeps an account that reads as before.
    if ((now != configuration_ || accounts_->deviceOwnerAccount() != account_) && outdated_) {
        outdated_();
    }
    if (changed_) {
        changed_();
    }
}

bool LiveServices::isSignedIn() const {
    const auto account = accounts_->deviceOwnerAccount();
    return account && account->personIdentifier() && account->hostNameOfType(platform::kFriendLocationService) &&
           account->tokenOfType(platform::kFriendLocationService);
}

bool LiveServices::hasAssistant() const {
    const auto configured = accounts_->configuration();
    return configured.account && configured.account->assistant;
}

void LiveServices::setChanged(std::function<void()> changed) {
    changed_ = std::move(changed);
}

}  // namespace ktr::host
