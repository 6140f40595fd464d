#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "server/names/MessageCatalogue.h"

namespace ktr::server {

/// The towns of the world by position, with their names in many languages: those of libgweather's "Locations.xml" where
/// that is installed, else the few hundred of the built-in world. One thread at a time.
class Gazetteer {
  public:
    struct Files {
        std::string towns = "/usr/share/libgweather-4/Locations.xml";
        std::string translations = "/usr/share/locale";  ///< LANGUAGE/LC_MESSAGES/libgweather-4.0-locations.mo
    };
    struct Town {
        double latitude = 0.0;  ///< degrees
        double longitude = 0.0;
        std::string name;       ///< in English
        std::string context;    ///< what tells it from towns of the same name; mostly empty
        std::string zone = {};  ///< the time zone that bears its name; mostly empty
    };
    struct Nearest {
        const Town* town = nullptr;
        double metres = 0.0;
    };

    /// The files are read when they are asked for first; of one that is missing or damaged the built-in towns, or their
    /// names, take the place.
    explicit Gazetteer(Files files) : files_(std::move(files)) {}

    Nearest nearest(double latitude, double longitude);
    /// In a language (BCP 47), or in English where it has none.
    std::string name(const Town& town, const std::string& language);
    std::size_t count();
    std::size_t bytes() const;
    /// How many towns were compared with places so far.
    std::uint64_t compared() const { return compared_; }

  private:
    using Direction = std::array<double, 3>;  ///< from the earth's middle, of length 1

    void load();
    std::vector<std::size_t> near(double latitude, double longitude);
    const MessageCatalogue* catalogue(const std::string& language);

    const Files files_;
    bool isLoaded_ = false;
    std::vector<Town> towns_;            ///< from south to north
    std::vector<Direction> directions_;  ///< of the towns
    std::uint64_t compared_ = 0;
    std::map<std::string, std::shared_ptr<const MessageCatalogue>> catalogues_;
};

}  // namespace ktr::server
