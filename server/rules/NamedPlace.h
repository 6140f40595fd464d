#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "server/ingest/Fix.h"
#include "server/ingest/Report.h"

namespace ktr::server {

/// A place that somebody has given a name. A value.
struct NamedPlace {
    static constexpr double kLeastRadius = 100.0;  ///< metres: below it a phone's fixes do not tell in from out
    static constexpr double kMostRadius = 5000.0;
    static constexpr int kMost = 100;  ///< of one person, by what phones send

    std::int64_t id = 0;
    std::string name;   ///< the owner's word for it
    std::string label;  ///< "home", "work", "school", "gym", "other", or empty
    double latitude = 0.0;
    double longitude = 0.0;
    double radius = 150.0;  ///< metres
    bool said = false;      ///< viewers may hear its name

    /// Of a place to which a phone's owner gave a name in its app: not said to anybody until its owner allows that. A
    /// radius outside of what makes sense is the nearest that does. None: no name, or no place on earth.
    static std::optional<NamedPlace> of(const RawPlace& raw);
    /// Whether a fix lies in it, and is exact enough to tell: its accuracy, if it has one, is no worse than the radius
    /// or 200 m, whichever is more.
    bool holds(const Fix& fix) const;
    /// Of the places whose name may be said the one that holds a fix, the smallest of several; null when none does.
    static const NamedPlace* saidAt(const std::vector<NamedPlace>& places, const Fix& fix);
    /// 1 to 40 letters on one line, which can be read aloud.
    static bool isName(std::string_view text);
    static bool isLabel(std::string_view word);

    bool operator==(const NamedPlace&) const = default;
};

}  // namespace ktr::server
