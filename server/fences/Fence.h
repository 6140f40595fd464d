#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "server/fences/FenceRules.h"

namespace ktr::server {

/// Where a wished fence lies. A value.
struct FencePlace {
    /// The subject's own place by the name that it may be called, or by its label; empty: `circle`, or where the
    /// subject is seen.
    std::string name = {};
    /// None, and no name: around where the subject is seen now.
    std::optional<FenceCircle> circle = std::nullopt;

    bool operator==(const FencePlace&) const = default;
};

/// Somebody wishes to be told when somebody comes or goes. A value.
struct FenceWish {
    std::int64_t watcher = 0;
    std::int64_t subject = 0;  ///< 0: nobody has the handle that was asked for
    FencePlace place;
    bool arrives = false;  ///< told of arriving; else of leaving
    bool once = true;      ///< it ends when it has told
};

/// A fence that is kept. A value.
struct Fence {
    std::int64_t id = 0;
    std::int64_t watcher = 0;
    std::int64_t subject = 0;
    std::string name = {};   ///< of the place; empty: it has none
    std::string label = {};  ///< as `NamedPlace::label`
    FenceCircle circle = {};
    bool arrives = false;
    bool once = true;
    std::int64_t made = 0;  ///< seconds since 1970

    bool operator==(const Fence&) const = default;
};

/// What became of a wish.
enum class FenceOutcome {
    Set,
    Refused,  ///< nobody, or somebody who does not let the watcher be told: these cannot be told apart
    NoPlace,  ///< there is no such place, or nobody knows where the subject is
    TooMany,
    Failed,  ///< the store could not be written
};

/// A fence as one of its two people is shown it. A value.
struct FenceFacts {
    Fence fence;
    std::string other;   ///< the name of the other one
    std::string handle;  ///< the other one's preferred handle; empty: none

    bool operator==(const FenceFacts&) const = default;
};

/// Somebody came or went, to be told to one device. A value.
struct FenceEvent {
    /// After this long nobody wants to know any more. Seconds.
    static constexpr std::int64_t kLasts = std::int64_t{6} * 3600;

    std::int64_t number = 0;  ///< grows by the device's own count, and never comes again
    std::string name = {};    ///< of whom
    std::string handle = {};  ///< by which the watcher can ask; empty: none
    std::string place = {};   ///< the name of the place; empty: it has none
    std::string label = {};
    FenceCircle circle = {};
    bool arrives = false;
    std::int64_t time = 0;  ///< when it happened, seconds since 1970
    std::int64_t made = 0;  ///< when the fence was set
    /// The time of the fix of the post that a phone was told in; 0: of none.
    std::int64_t post = 0;

    bool operator==(const FenceEvent&) const = default;
};

}  // namespace ktr::server
