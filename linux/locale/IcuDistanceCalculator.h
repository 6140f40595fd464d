#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/client/DistanceCalculator.h"
#include "platform/location/Geodesy.h"

namespace ktr::linux_ {

/// Which units a person wants whatever the locale says.
enum class UnitSystem { Metric = 0, ImperialUS = 1, ImperialUK = 2 };

/// Words distances as road signs do, by ICU: unit and rounding follow the region's custom for roads (Unicode CLDR unit
/// preferences, usage "road"), but metres, yards and feet are rounded to tens throughout; words and digits the
/// language. The region is the one that the measurement-system locale names, else the one it most likely stands for. A
/// no-break space stands between number and unit. The host's text "DISTANCE_TEXT", where the localization has one,
/// frames the result ("%@"). Main thread.
class IcuDistanceCalculator : public platform::DistanceCalculator {
  public:
    /// `override` is what the person's preferences ask for; none: the units of the settings' locale.
    IcuDistanceCalculator(Settings settings, std::optional<UnitSystem> override,
                          std::shared_ptr<platform::Geodesy> geodesy);
    ~IcuDistanceCalculator() override;

    std::optional<std::string> localizedDistance(const platform::PlatformLocation& from,
                                                 const platform::PlatformLocation& to) override;
    long measurementSystem() const override;
    /// None for a distance that is negative or not finite.
    std::optional<std::string> localizedDistance(double metres) const;

  private:
    struct Formatter;
    /// Without the host's frame; empty for a distance that is negative or not finite.
    std::string worded(double metres) const;
    std::string framed(const std::string& text) const;

    Settings settings_;
    UnitSystem system_;
    std::shared_ptr<platform::Geodesy> geodesy_;
    /// The host's, read once.
    std::string frame_;
    /// Whether it is the distance and nothing else.
    bool isPlain_ = true;
    std::unique_ptr<Formatter> formatter_;
};

}  // namespace ktr::linux_
