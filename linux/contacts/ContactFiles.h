#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "platform/contacts/ContactStore.h"

namespace ktr::linux_ {

/// The user's contacts as vCard files and folders of them have them.
class ContactFiles {
  public:
    using Paths = std::vector<std::string>;
    using Contacts = platform::ContactStore::Contacts;

    /// The contacts of all paths, in their order. A card that cannot be read is passed over with a log line (error
    /// level) that names the file and the card's line. None, and the reason in `error`, when a path cannot be read at
    /// all. Any thread, one at a time; it reads the disk.
    static std::optional<Contacts> read(const Paths& paths, std::string& error);
    /// The contacts of a text; `name` stands in log lines for the file's. Any thread, one at a time.
    static Contacts readText(const std::string& text, const std::string& name);
    /// What to watch to hear of every change of what `read` gives: files, and folders. Any thread; it reads the disk.
    static Paths watched(const Paths& paths);
};

}  // namespace ktr::linux_
