#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "linux/contacts/ContactFiles.h"
#include "platform/base/MainLoop.h"

class QThread;

namespace ktr::linux_ {

/// The user's contacts: vCard files and folders of them first, then the desktop's address books. They are read, and
/// followed when they change, on a thread of their own, since a disk, a bus and a service may each take as long as they
/// please. Main thread.
class UserContacts {
  public:
    using Paths = ContactFiles::Paths;
    using Contacts = ContactFiles::Contacts;

    /// How long a start waits for the first reading, seconds.
    static constexpr double kFirstWait = 1.0;

    /// Begins to read. `bus`: the address of the message bus on which the address books are; empty: the session's. The
    /// loop outlives this.
    UserContacts(const std::shared_ptr<platform::MainLoop>& mainLoop, Paths paths, std::string bus = "",
                 bool usesBooks = true);
    /// What is under way ends; a disk that does not answer is left alone after two seconds.
    ~UserContacts();
    UserContacts(const UserContacts&) = delete;
    UserContacts& operator=(const UserContacts&) = delete;

    /// Waits for the first reading, so long at most, and gives what has been read by then: nothing, perhaps. `error`
    /// says why the files could not be read; empty otherwise.
    Contacts first(double seconds, std::string& error);
    /// `changed` gets all contacts whenever they have become others since `first`, once a burst of changes is over.
    /// What cannot be read is a line in the log, and nothing changes.
    void follow(std::function<void(const Contacts&)> changed);
    /// Other files from now on; what they hold comes to `changed`, also if it is the same.
    void setPaths(Paths paths);
    /// Whether address books are read from now on; without them nothing is said to whoever keeps them.
    void setUsesBooks(bool usesBooks);

  private:
    class Reader;
    struct Shared;

    std::shared_ptr<Shared> shared_;
    std::unique_ptr<QThread> thread_;
    Reader* reader_ = nullptr;  ///< of the thread, which takes it along
};

}  // namespace ktr::linux_
