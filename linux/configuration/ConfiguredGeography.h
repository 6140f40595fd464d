#pragma once

#include <memory>
#include <utility>

#include "linux/configuration/ConfiguredAccountStore.h"
#include "platform/base/DeviceInformation.h"

namespace ktr::linux_ {

/// The geographic services' country: the configuration's, else that of the system's time zone. Main thread.
class ConfiguredGeography : public platform::GeographicSettings {
  public:
    explicit ConfiguredGeography(std::shared_ptr<const ConfiguredAccountStore> store) : store_(std::move(store)) {}
    /// None where the time zone belongs to no single country, as UTC does.
    std::optional<std::string> countryCode() const override;

  private:
    std::shared_ptr<const ConfiguredAccountStore> store_;
};

}  // namespace ktr::linux_
