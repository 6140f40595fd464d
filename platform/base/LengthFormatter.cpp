#include "platform/base/LengthFormatter.h"

#include <cmath>

namespace ktr::platform {

LengthFormatter::~LengthFormatter() = default;

namespace {

/// To two digits, but never finer than a whole one below ten.
double toldAmount(double amount) {
    if (amount < 10.0) {
        return std::round(amount);
    }
    const double step = std::pow(10.0, std::floor(std::log10(amount)) - 1.0);
    return std::round(amount / step) * step;
}

}  // namespace

double lengthOf(LengthUnit unit) {
    switch (unit) {
        case LengthUnit::Meter:
            return 1.0;
        case LengthUnit::Kilometer:
            return 1000.0;
        case LengthUnit::Foot:
            return 0.3048;
        case LengthUnit::Yard:
            return 0.9144;
        case LengthUnit::Mile:
            return 1609.344;
    }
    return 1.0;
}

std::string LengthFormatter::textForMetres(double metres, LengthWidth width) const {
    const bool isMetric = system() == LengthSystem::Metric;
    const LengthUnit large = isMetric ? LengthUnit::Kilometer : LengthUnit::Mile;
    const LengthUnit small = isMetric                                 ? LengthUnit::Meter
                             : system() == LengthSystem::UnitedStates ? LengthUnit::Foot
                                                                      : LengthUnit::Yard;
    // Half a mile and more are miles; a kilometre and more are kilometres.
    const double limit = isMetric ? lengthOf(large) : lengthOf(large) / 2.0;
    const double told = toldAmount(metres / lengthOf(small));
    if (told * lengthOf(small) < limit) {
        return text(told, small, width);
    }
    const double amount = metres / lengthOf(large);
    return text(amount < 10.0 ? std::round(amount * 10.0) / 10.0 : toldAmount(amount), large, width);
}

}  // namespace ktr::platform
