#pragma once

#include <filesystem>
#include <memory>
#include <optional>
#include <string>

#include "linux/locale/IcuDistanceCalculator.h"

namespace ktr::linux_ {

/// Makes distance calculators. Preferences that override the units stand in the file "<suite>.conf" of a folder, as the
/// entry "system" ("metric", "us" or "uk") of the section "units"; a missing file or another word overrides nothing.
/// Main thread.
class IcuDistanceCalculatorFactory : public platform::DistanceCalculatorFactory {
  public:
    /// The folder of the preferences; none: nothing overrides the units (rendering and tests, where the result must not
    /// depend on whose session it is).
    /// `chosen` goes before those preferences.
    explicit IcuDistanceCalculatorFactory(std::shared_ptr<platform::Geodesy> geodesy,
                                          std::optional<std::filesystem::path> preferences = std::nullopt,
                                          std::optional<UnitSystem> chosen = std::nullopt);
    /// The folder "ktr" of the session's configuration (XDG_CONFIG_HOME, else ~/.config).
    static std::filesystem::path sessionPreferences();

    /// The file is read here, once for each calculator.
    std::shared_ptr<platform::DistanceCalculator> makeDistanceCalculator(
        const platform::DistanceCalculator::Settings& settings) override;

  private:
    std::optional<UnitSystem> preferredUnits(const std::string& suite) const;

    std::shared_ptr<platform::Geodesy> geodesy_;
    std::optional<std::filesystem::path> preferences_;
    std::optional<UnitSystem> chosen_;
};

}  // namespace ktr::linux_
