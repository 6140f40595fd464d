#pragma once

#include <cstdint>
#include <string>

#include "server/store/Database.h"

namespace ktr::server {

/// Backups: a store of its own in one SQLite file, whichever database it was made of, without fixes, looks, and what
/// lasts minutes. Any thread; it waits for the disk.
class StoreCopy {
  public:
    /// Writes `file` (mode 0600) as a whole or not at all, as `database` is at one moment; others go on writing. Empty
    /// when done, else a sentence.
    static std::string write(Database& database, const std::string& file);

    /// A backup that is about to be read: a private copy of it, brought to today's form, in a folder beside `folder`'s
    /// files, which is gone with this.
    class Opened {
      public:
        /// Complains by `complaint`.
        Opened(const std::string& file, const std::string& folder);
        ~Opened();
        Opened(const Opened&) = delete;
        Opened& operator=(const Opened&) = delete;

        const std::string& complaint() const { return complaint_; }
        Database& database() const { return *database_; }

      private:
        std::string folder_;
        std::string complaint_;
        std::unique_ptr<Database> database_;
    };

    /// Replaces all that `database` keeps by what `backup` has, in the transaction that is open: readers wait for their
    /// person's word, and whoever was forgotten here or there stays forgotten.
    static void restore(Database& database, Database& backup, std::int64_t now);
};

}  // namespace ktr::server
