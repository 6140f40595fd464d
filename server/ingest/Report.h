#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace ktr::server {

/// A position as a phone wrote it, before the rules of FixRules. Numbers may be anything.
struct RawFix {
    std::optional<double> time;  ///< seconds since 1970; none when it was not said
    double latitude = 0.0;
    double longitude = 0.0;
    std::optional<double> accuracy;

    bool operator==(const RawFix&) const = default;
};

/// A place to which a phone's owner gave a name in its app, before the rules of NamedPlace. Numbers may be anything.
struct RawPlace {
    std::string name;
    double latitude = 0.0;
    double longitude = 0.0;
    std::optional<double> radius;  ///< metres

    bool operator==(const RawPlace&) const = default;
};

/// What a phone's message says. Whatever else is in it (networks, regions, motion, tags, topics, battery) is not read.
struct Report {
    enum class Kind {
        Position,  ///< `fixes` has some
        Alive,     ///< understood, and nothing to keep of it: the phone was heard
        Junk,      ///< not understood
    };

    Kind kind = Kind::Junk;
    std::vector<RawFix> fixes;
    std::string device;   ///< the secret in a message that carries its own; else empty
    bool sealed = false;  ///< it came encrypted, and wants its answer so
    /// The bytes of the picture that its owner's card brings, before the rules of `Face`; none: it brings none.
    std::optional<std::string> face;
    std::vector<RawPlace> places;

    static Report alive() { return {Kind::Alive, {}, {}, false, {}, {}}; }
    bool operator==(const Report&) const = default;
};

}  // namespace ktr::server
