#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace ktr::app {

/// Somebody came or went, as the service told. A value.
struct Crossing {
    std::int64_t number = 0;  ///< grows with each, and never comes again
    std::string name;
    std::string handle;  ///< empty: none
    std::string place;   ///< its name; empty: it has none
    bool arrives = false;
    std::int64_t time = 0;  ///< seconds since 1970

    /// None for what is no crossing.
    static std::optional<Crossing> read(const std::string& json);
    /// In the form that `read` takes.
    std::string json() const;
    bool operator==(const Crossing&) const = default;
};

/// What a notification says of it. While the screen is locked neither who nor where.
struct CrossingWords {
    std::string title;
    std::string body;

    /// `text` gives the host's text of a key; `clock` words a time of day.
    static CrossingWords of(const Crossing& crossing, bool isLocked,
                            const std::function<std::string(const std::string& key)>& text,
                            const std::function<std::string(std::int64_t time)>& clock);
    /// What a click on it asks: where the one is whom it is about.
    static std::string question(const Crossing& crossing,
                                const std::function<std::string(const std::string& key)>& text);
    bool operator==(const CrossingWords&) const = default;
};

}  // namespace ktr::app
