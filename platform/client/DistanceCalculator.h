#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/assistant/Localization.h"
#include "platform/base/Object.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// Words distances for the user. Main thread.
class KTR_API DistanceCalculator : public Object {
  public:
    struct Settings {
        /// Whose preferences may override the units: an app-group container identifier.
        std::string defaultsSuite;
        /// The language of the words; none: the region's own.
        std::optional<std::string> languageLocale;
        /// The locale whose units are used; fixed for as long as the calculator lives.
        std::string measurementSystemLocale;
        std::shared_ptr<Localization> localizationDelegate;
    };

    /// The distance along the ground, such as "310 m" or "0.6 mi", in one line; none when it cannot be measured.
    virtual std::optional<std::string> localizedDistance(const PlatformLocation& from, const PlatformLocation& to) = 0;
    /// 0 metric, 1 imperial as in the US, 2 imperial as in the UK.
    virtual long measurementSystem() const = 0;
};

class KTR_API DistanceCalculatorFactory {
  public:
    virtual ~DistanceCalculatorFactory();
    /// Never none.
    virtual std::shared_ptr<DistanceCalculator> makeDistanceCalculator(
        const DistanceCalculator::Settings& settings) = 0;
};

}  // namespace ktr::platform
