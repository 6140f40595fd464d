#pragma once

#include <sys/types.h>

#include <optional>
#include <string>

namespace ktr::server {

/// A socket that takes connections, and closes with its owner. One thread.
class ListeningSocket {
  public:
    /// A socket in the file system, for a proxy on this machine.
    struct Place {
        std::string path;
        std::string group;  ///< who else may connect (mode 0660); empty: the owner alone (0600)
    };

    /// None, with a sentence in `complaint`: `address` is none, or the port is somebody else's. Port 0: a free one.
    static std::optional<ListeningSocket> onAddress(const std::string& address, int port, std::string& complaint);
    /// Takes the place of one that nobody serves any more; nothing else is replaced. Others may not change the folder:
    /// whoever could put a socket of his own there would be told secrets.
    static std::optional<ListeningSocket> at(const Place& place, std::string& complaint);
    /// One that whoever started this process made. None when it does not take connections.
    static std::optional<ListeningSocket> inherited(int descriptor, std::string& complaint);

    ListeningSocket(ListeningSocket&& other) noexcept;
    ListeningSocket& operator=(ListeningSocket&&) = delete;
    ListeningSocket(const ListeningSocket&) = delete;
    ListeningSocket& operator=(const ListeningSocket&) = delete;
    /// Also takes the file away that it made, if that is still its own.
    ~ListeningSocket();

    int descriptor() const { return descriptor_; }
    /// Of an address; 0 of a file.
    int port() const;
    bool isFile() const;
    /// Whether only this machine reaches it.
    bool isLocal() const;

  private:
    explicit ListeningSocket(int descriptor) : descriptor_(descriptor) {}

    int descriptor_;
    std::string path_;  ///< of a file that it made
    dev_t device_ = 0;
    ino_t inode_ = 0;
};

}  // namespace ktr::server
