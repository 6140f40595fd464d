#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/ui/Font.h"

namespace ktr::linux_ {

/// What the configuration file says (docs/configuration.md). A value; the app token is not part of it.
struct Configuration {
    struct Account {
        std::string personId;  ///< never empty
        std::optional<std::string> userName;
        std::optional<std::string> host;  ///< with ":port" when the port is not 443
        /// Where commands may be redirected to besides the host; none: the host's own domain.
        std::optional<std::vector<std::string>> domains;
        /// The file that holds the app token, as an absolute path; none: the Secret Service, then the file "token"
        /// beside the configuration file.
        std::optional<std::string> tokenFile;
        /// A server that answers questions as they are typed, with ":port" when the port is not 443; none: they are
        /// understood here, and the service gets typed requests.
        std::optional<std::string> assistant;
        bool operator==(const Account&) const = default;
    };

    struct Positions {
        enum class Source { None, GeoClue, Gpsd, Track };
        Source source = Source::GeoClue;
        /// Of a track: a GPX file or a scenario; an absolute path.
        std::string file;
        std::string gpsdHost = "localhost";
        int gpsdPort = 2947;
        bool operator==(const Positions&) const = default;
    };

    struct Maps {
        /// The datum of the sources' data.
        enum class Datum { Wgs84, Gcj02 };
        struct Source {
            std::string file;  ///< MBTiles, an absolute path; empty for one with a `url`
            std::string url;   ///< of a tile, with "{z}", "{x}" and "{y}"; https
            /// Shown instead of what the data says; of a `url` never none.
            std::optional<std::string> attribution;
            int coarsest = 0;  ///< levels that a `url` has
            int finest = 19;
            bool operator==(const Source&) const = default;
        };
        std::vector<Source> sources;  ///< the first that has a place draws it
        Datum datum = Datum::Wgs84;
        int cacheMegabytes = 100;  ///< of tiles from URLs on disk
        bool operator==(const Maps&) const = default;
    };

    enum class Colors { System, Light, Dark, HighContrast };
    /// In which distances are told.
    enum class Distances { System, Kilometres, Miles };

    std::optional<Account> account;
    /// Files with certificates (PEM) that are trusted besides the system's; absolute paths.
    std::vector<std::string> certificates;
    /// vCard files, or folders of them: the user's contacts; absolute paths.
    std::vector<std::string> contacts;
    /// Whether the desktop's address books are read beside them.
    bool addressBooks = true;
    std::optional<std::string> language;  ///< the assistant's, BCP 47
    /// Instead of the desktop's.
    std::optional<platform::ContentSizeCategory> textSize;
    Colors colors = Colors::System;
    Distances distances = Distances::System;
    /// The country of the geographic services: two letters in upper case.
    std::optional<std::string> geographicCountry;
    bool friendLocationRestricted = false;
    bool friendLocationAllowed = true;
    Positions positions;
    Maps maps;
    bool operator==(const Configuration&) const = default;
};

}  // namespace ktr::linux_
