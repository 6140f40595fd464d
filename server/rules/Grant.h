#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// How exactly a viewer sees somebody.
enum class Precision {
    Exact = 0,
    Kilometre = 1,  ///< a cell of 1 km
    Town = 2,       ///< a cell of 4 km
};

/// "exact", "1km", "town".
std::string wordOf(Precision precision);
std::optional<Precision> precisionOf(std::string_view word);

/// What somebody lets one other person see. A value.
struct Grant {
    Precision precision = Precision::Exact;
    std::int64_t from = 0;              ///< seconds since 1970: nothing from before is seen
    std::optional<std::int64_t> until;  ///< nothing is seen from then on

    bool operator==(const Grant&) const = default;
};

}  // namespace ktr::server
