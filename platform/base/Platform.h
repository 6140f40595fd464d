#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <typeindex>
#include <unordered_map>

#include "platform/base/Api.h"

namespace ktr::platform {

class Calendar;
class Clock;
class LogSink;
class MainLoop;
class NotificationCenter;
class NumberFormatter;
class PluralRules;
class RegionSettings;
class AssistantSettings;
class Localization;
class ContactStore;
class ContactFormatter;
class AssistantContacts;
class MonogramMakerFactory;
class AvatarImages;
class PhoneNumberLibrary;
class Telephony;
class Geodesy;
class DistanceCalculatorFactory;
class LocationManagerFactory;
class LengthFormatter;
class MapPictureSource;
class MapsApplication;
class Device;
class TextEngine;
class ImageSource;
class AssistantAppearance;
class AccountStore;
class DeviceInformation;
class DeviceLock;
class FriendLocationRestrictions;
class GeographicSettings;
class HttpTransport;
class Preferences;

/// What a host gives the plugin: one implementation of every interface, installed for as long as the plugin runs.
/// Members that a host leaves empty are the host's error; tests fill what they use. Installing and uninstalling belong
/// to the main thread; the members are set before installing and not changed afterwards.
class KTR_API Platform {
  public:
    Platform();
    ~Platform();
    Platform(const Platform&) = delete;
    Platform& operator=(const Platform&) = delete;

    std::shared_ptr<LogSink> logSink;
    std::shared_ptr<MainLoop> mainLoop;
    std::shared_ptr<Clock> clock;
    std::shared_ptr<Calendar> calendar;
    std::shared_ptr<NotificationCenter> notificationCenter;  ///< made by the constructor
    std::shared_ptr<NumberFormatter> decimalNumbers;
    std::shared_ptr<PluralRules> pluralRules;  ///< may be none: plural texts then read as for "other"
    std::shared_ptr<RegionSettings> region;
    std::shared_ptr<LengthFormatter> lengths;
    std::shared_ptr<AssistantSettings> assistant;
    std::shared_ptr<Localization> localization;
    std::shared_ptr<ContactStore> contactStore;  ///< may be none
    std::shared_ptr<ContactFormatter> contactFormatter;
    std::shared_ptr<AssistantContacts> assistantContacts;
    std::shared_ptr<MonogramMakerFactory> monogramMakers;
    std::shared_ptr<AvatarImages> avatarImages;
    std::shared_ptr<PhoneNumberLibrary> phoneNumbers;
    std::shared_ptr<Telephony> telephony;
    std::shared_ptr<Geodesy> geodesy;
    std::shared_ptr<DistanceCalculatorFactory> distanceCalculators;
    std::shared_ptr<LocationManagerFactory> locationManagers;
    std::shared_ptr<MapPictureSource> maps;  ///< may be none: maps then show plain land
    std::shared_ptr<MapsApplication> mapsApplication;
    std::shared_ptr<Device> device;
    std::shared_ptr<TextEngine> textEngine;
    std::shared_ptr<ImageSource> images;
    std::shared_ptr<AssistantAppearance> appearance;
    std::shared_ptr<AccountStore> accounts;
    std::shared_ptr<DeviceInformation> deviceInformation;
    std::shared_ptr<DeviceLock> deviceLock;
    std::shared_ptr<FriendLocationRestrictions> restrictions;
    std::shared_ptr<GeographicSettings> geographicSettings;
    std::shared_ptr<Preferences> preferences;
    std::shared_ptr<HttpTransport> httpTransport;

    /// The installed platform, or none. Any thread.
    static std::shared_ptr<Platform> installed();
    /// Replaces the installed platform; none uninstalls. What `shared` made for the old one is dropped.
    static void install(std::shared_ptr<Platform> platform);

    /// Drops what `shared` made; called by `install` for the platform that goes.
    void dropShared();

  private:
    template <class T>
    friend std::shared_ptr<T> shared();
    std::shared_ptr<void> sharedObject(std::type_index type, const std::function<std::shared_ptr<void>()>& make);

    std::recursive_mutex mutex_;
    std::unordered_map<std::type_index, std::shared_ptr<void>> shared_;
};

/// The installed platform's one T, made by `T::makeShared()` on first use and dropped when that platform is
/// uninstalled. None without a platform. Any thread; the first use runs once.
template <class T>
std::shared_ptr<T> shared() {
    const auto platform = Platform::installed();
    if (!platform) {
        return nullptr;
    }
    return std::static_pointer_cast<T>(
        platform->sharedObject(typeid(T), [] { return std::static_pointer_cast<void>(T::makeShared()); }));
}

}  // namespace ktr::platform
