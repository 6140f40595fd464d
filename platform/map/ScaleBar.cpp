#include "platform/map/ScaleBar.h"

#include <array>
#include <cmath>

namespace ktr::platform {

namespace {

constexpr double kShortest = 40.0;  // points
constexpr double kLongest = 100.0;

/// Up to where the small unit is counted: its next length would be a longer word than the large unit's.
struct Units {
    LengthUnit small;
    double most;
    LengthUnit large;
    double least;
};

Units unitsOf(LengthSystem system) {
    switch (system) {
        case LengthSystem::Metric:
            return {LengthUnit::Meter, 500.0, LengthUnit::Kilometer, 1.0};
        case LengthSystem::UnitedStates:
            return {LengthUnit::Foot, 2000.0, LengthUnit::Mile, 0.5};
        case LengthSystem::UnitedKingdom:
            return {LengthUnit::Yard, 500.0, LengthUnit::Mile, 0.5};
    }
    return {LengthUnit::Meter, 500.0, LengthUnit::Kilometer, 1.0};
}

/// The roundest amount of a unit within the limits; nothing when there is none.
ScaleBar roundest(LengthUnit unit, double least, double most, double metresPerPoint) {
    for (const double figure : {1.0, 5.0, 2.0}) {
        const double pointsAUnit = lengthOf(unit) / metresPerPoint;
        const double power = std::floor(std::log10(kLongest / pointsAUnit / figure) + 1e-9);
        const double amount = figure * std::pow(10.0, power);
        const double points = amount * pointsAUnit;
        if (points >= kShortest - 1e-9 && amount >= least && amount <= most) {
            return {amount, unit, points};
        }
    }
    return {};
}

}  // namespace

ScaleBar ScaleBar::at(double metresPerPoint, LengthSystem system) {
    if (!(metresPerPoint > 0.0) || !std::isfinite(metresPerPoint)) {
        return {};
    }
    const Units units = unitsOf(system);
    const ScaleBar large = roundest(units.large, units.least, HUGE_VAL, metresPerPoint);
    // Below a centimetre there is no map; the small unit's fractions are not wanted.
    return large.points > 0.0 ? large : roundest(units.small, 1.0, units.most, metresPerPoint);
}

}  // namespace ktr::platform
