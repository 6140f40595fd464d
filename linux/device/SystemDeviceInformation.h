#pragma once

#include <filesystem>

#include "platform/base/DeviceInformation.h"

namespace ktr::linux_ {

/// This machine, as the system describes it; read once, by the constructor. Any thread.
class SystemDeviceInformation : public platform::DeviceInformation {
  public:
    /// `root` stands for "/", for tests; the identifier always comes from the running system.
    explicit SystemDeviceInformation(const std::filesystem::path& root = "/");

    /// Derived from the machine's identifier for this application alone (sd_id128_get_machine_app_specific), so that it
    /// tells nothing of it; 32 hexadecimal digits. None on a system without one.
    std::optional<std::string> uniqueDeviceIdentifier() const override { return identifier_; }
    /// The product name of the firmware (DMI), else the model of the device tree. None for a maker's filler text.
    std::optional<std::string> productType() const override { return product_; }
    /// VERSION_ID of os-release; a rolling system has none.
    std::optional<std::string> operatingSystemVersion() const override { return version_; }
    /// BUILD_ID of os-release, else the kernel's release.
    std::optional<std::string> operatingSystemBuild() const override { return build_; }

  private:
    std::optional<std::string> identifier_, product_, version_, build_;
};

}  // namespace ktr::linux_
