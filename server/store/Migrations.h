#pragma once

#include <string>

#include "server/store/Database.h"

namespace ktr::server {

/// The tables of the store, as steps from nothing to today: each is run once, in order, with its number. A step that
/// was ever released does not change any more; what comes later appends one. One thread at a time.
class Migrations {
  public:
    /// The number of the last step.
    static int latest();
    /// Brings a database to the last step; empty when it is there, else a sentence without the database's name. `make`:
    /// it may be empty. Several processes may do it at once. All steps or none.
    static std::string run(Database& database, bool make);
};

}  // namespace ktr::server
