#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "server/store/Database.h"

namespace ktr::server {

/// Where a store is: a folder with an SQLite file, a PostgreSQL server ("postgresql://…"), or the memory of this
/// process. A value.
struct StoreAddress {
    std::string text;

    /// A store that is gone when its last connection is: each call makes another one.
    static StoreAddress inMemory();
    static bool isServer(std::string_view text);
    bool isFolder() const;
    /// How complaints name it: never with a password.
    std::string name() const;
    /// None, with a sentence in `complaint`, when it cannot be opened.
    std::unique_ptr<Database> connect(std::string& complaint) const;
};

}  // namespace ktr::server
