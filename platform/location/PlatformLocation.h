#pragma once

#include <optional>

#include "platform/base/Date.h"
#include "platform/base/Object.h"

namespace ktr::platform {

/// Degrees, WGS84.
struct Coordinate {
    double latitude = 0.0;
    double longitude = 0.0;
    bool operator==(const Coordinate&) const = default;
};

/// Latitude within -90..90 and longitude within -180..180; NaN is in no range.
KTR_API bool isValid(const Coordinate& coordinate);

/// A position. Immutable; shared.
class KTR_API PlatformLocation : public Object {
  public:
    struct Fix {
        Coordinate coordinate;
        double altitude = 0.0;            ///< metres
        double horizontalAccuracy = 0.0;  ///< metres; negative: invalid
        double verticalAccuracy = 0.0;    ///< metres; negative: invalid
        double course = 0.0;              ///< degrees from true north; negative: unknown
        double speed = 0.0;               ///< metres a second; negative: unknown
        std::optional<Date> timestamp;
        bool operator==(const Fix&) const = default;
    };

    explicit PlatformLocation(const Fix& fix) : fix_(fix) {}
    ~PlatformLocation() override;
    const Fix& fix() const { return fix_; }
    const Coordinate& coordinate() const { return fix_.coordinate; }
    /// Metres along the geodesic, by the installed geodesy; NaN when it cannot be measured. Main thread.
    double distanceFromLocation(const PlatformLocation& other) const;
    std::string description() const override;

  private:
    Fix fix_;
};

}  // namespace ktr::platform
