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
    Places = 3,     ///< only which of the owner's places whose names may be said, and nothing between them
};

/// "exact", "1km", "town", "places".
std::string wordOf(Precision precision);
std::optional<Precision> precisionOf(std::string_view word);

/// What somebody lets one other person see. A value.
struct Grant {
    /// A grant without an end asks its owner after this long whether it is still meant, and ends when nobody has
    /// answered for `kPatience` more. Seconds.
    static constexpr std::int64_t kQuestion = std::int64_t{90} * 86400;
    static constexpr std::int64_t kPatience = std::int64_t{7} * 86400;

    Precision precision = Precision::Exact;
    std::int64_t from = 0;              ///< seconds since 1970: nothing from before is seen
    std::optional<std::int64_t> until;  ///< nothing is seen from then on
    /// The owner's place on whose reaching it ends; 0: none. The store ends it with the fix that lies there.
    std::int64_t arrival = 0;
    bool aloud = false;  ///< what is seen may be said aloud
    std::optional<std::int64_t> confirmed =
        std::nullopt;  ///< when the owner last said that it is meant; none: when it was made
    /// The viewer may be told when the owner comes and goes; that also takes exact precision.
    bool fences = false;

    /// When it ends if nothing more is done about it.
    std::int64_t end() const;
    /// Whether the viewer may be told now when the owner comes and goes, unless the owner hides.
    bool tells(std::int64_t now) const;
    /// Whether the owner is being asked.
    bool asks(std::int64_t now) const;

    bool operator==(const Grant&) const = default;
};

}  // namespace ktr::server
