#pragma once

#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// Facts about this device. Main thread; answers from memory. None for a fact that the device does not tell.
class KTR_API DeviceInformation {
  public:
    virtual ~DeviceInformation();
    /// The same for every run of this application on this device, and no other's.
    virtual std::optional<std::string> uniqueDeviceIdentifier() const = 0;
    /// The model, such as "XPS 13 9310".
    virtual std::optional<std::string> productType() const = 0;
    /// Such as "12.5" or "17.2.1".
    virtual std::optional<std::string> operatingSystemVersion() const = 0;
    /// The operating system's build, such as "6.1.0-18-amd64".
    virtual std::optional<std::string> operatingSystemBuild() const = 0;
};

/// How far the data on this device are protected at this moment. Main thread; answers from memory.
class KTR_API DeviceLock {
  public:
    static constexpr int kUnlocked = 0;
    /// Locked, and protected data cannot be read.
    static constexpr int kLocked = 1;
    /// On the way to being locked.
    static constexpr int kLocking = 2;
    /// The device has no lock.
    static constexpr int kWithoutLock = 3;
    /// Not unlocked since it was started.
    static constexpr int kNeverUnlocked = 4;

    virtual ~DeviceLock();
    /// One of the codes above. A system that does not tell: `kWithoutLock`.
    virtual int lockState() const = 0;
};

/// How the geographic services (maps, places) are set up. Main thread; answers from memory.
class KTR_API GeographicSettings {
  public:
    virtual ~GeographicSettings();
    /// Two letters in upper case (ISO 3166-1): the country whose rules the maps follow, whatever the user's locale.
    /// None when it is not configured.
    virtual std::optional<std::string> countryCode() const = 0;
};

}  // namespace ktr::platform
