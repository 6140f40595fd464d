#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/MainLoop.h"
#include "platform/contacts/ContactStore.h"

class QFileSystemWatcher;
class QTimer;

namespace ktr::linux_ {

/// The user's contacts as vCard files and folders of them have them, read again in the background when one changes.
/// Main thread, but for `read`.
class ContactFiles {
  public:
    using Paths = std::vector<std::string>;
    using Contacts = platform::ContactStore::Contacts;

    /// The contacts of all paths, in their order. A card that cannot be read is passed over with a log line (error
    /// level) that names the file and the card's line. None, and the reason in `error`, when a path cannot be read at
    /// all. Any thread, one at a time; it reads the disk.
    static std::optional<Contacts> read(const Paths& paths, std::string& error);

    /// The loop outlives this.
    explicit ContactFiles(std::shared_ptr<platform::MainLoop> mainLoop);
    ~ContactFiles();
    ContactFiles(const ContactFiles&) = delete;
    ContactFiles& operator=(const ContactFiles&) = delete;

    /// Watches these from now on; `changed` gets what they hold whenever that has become another, once a burst of
    /// changes is over. What cannot be read then is an error line in the log, and nothing changes.
    void follow(const Paths& paths, std::function<void(Contacts)> changed);
    /// Others from now on.
    void setPaths(const Paths& paths);
    /// Reads in the background now, whether or not anything changed.
    void reload();

  private:
    struct State;
    static void reload(const std::shared_ptr<State>& state);
    static void watch(const std::shared_ptr<State>& state);
    std::shared_ptr<State> state_;
};

}  // namespace ktr::linux_
