#pragma once

#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

enum class LengthSystem { Metric, UnitedStates, UnitedKingdom };
enum class LengthUnit { Meter, Kilometer, Foot, Yard, Mile };
/// "25 m" or "25 metres".
enum class LengthWidth { Short, Spoken };

/// Lengths in the assistant's language, in the units of the user's region. Main thread; answers from memory.
class KTR_API LengthFormatter {
  public:
    virtual ~LengthFormatter();
    virtual LengthSystem system() const = 0;
    /// The amount as it is, with at most one decimal digit; a no-break space before an abbreviated unit.
    virtual std::string text(double amount, LengthUnit unit, LengthWidth width) const = 0;

    /// A length on the ground, rounded as people say it: to two digits, in metres or kilometres, feet or yards or
    /// miles.
    std::string textForMetres(double metres, LengthWidth width) const;
};

/// Metres.
KTR_API double lengthOf(LengthUnit unit);

}  // namespace ktr::platform
