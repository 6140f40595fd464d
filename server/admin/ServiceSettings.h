#pragma once

#include <optional>
#include <string>
#include <vector>

#include "server/names/PlaceNames.h"
#include "server/store/StoreAddress.h"

namespace ktr::server {

/// Under which name and port phones reach the service, and where its store and its maps are: "settings.json" in its
/// folder. A value.
struct ServiceSettings {
    std::string host;
    int port = 8443;
    std::string store;  ///< "postgresql://…"; empty: a file in the folder
    /// MBTiles files by which places are called something: whole paths, the first that knows a place goes first.
    std::vector<std::string> maps = {};

    /// None, with a sentence in `complaint`, when there is none or it is wrong.
    static std::optional<ServiceSettings> read(const std::string& folder, std::string& complaint);
    /// Empty when done.
    std::string write(const std::string& folder) const;
    /// Of the file's present state: another text whenever it may have changed.
    static std::string stateOf(const std::string& folder);
    /// A host name or an address, of letters that a certificate takes.
    static bool isHost(const std::string& text);
    StoreAddress storeAddress(const std::string& folder) const;
    std::string origin() const;
    PlaceNames::Setup names() const;
    /// How a certificate names the host, and how an authority is bound to it.
    std::string alternativeName() const;
    std::string constraint() const;
};

}  // namespace ktr::server
