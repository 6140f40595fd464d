#include "server/http/ListeningSocket.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <grp.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <utility>

#include "documents/FileSteps.h"
#include "documents/FileTrust.h"
#include "server/http/ClientAddress.h"

namespace ktr::server {

namespace {

/// How many clients may knock while we are busy; the system has a bound of its own.
constexpr int kBacklog = 1024;

struct Address {
    sockaddr_storage bytes{};
    socklen_t size = 0;
};

std::optional<Address> addressOf(const std::string& text, int port) {
    Address address;
    auto* four = reinterpret_cast<sockaddr_in*>(&address.bytes);
    auto* six = reinterpret_cast<sockaddr_in6*>(&address.bytes);
    if (::inet_pton(AF_INET, text.c_str(), &four->sin_addr) == 1) {
        four->sin_family = AF_INET;
        four->sin_port = htons(static_cast<std::uint16_t>(port));
        address.size = sizeof *four;
    } else if (::inet_pton(AF_INET6, text.c_str(), &six->sin6_addr) == 1) {
        six->sin6_family = AF_INET6;
        six->sin6_port = htons(static_cast<std::uint16_t>(port));
        address.size = sizeof *six;
    } else {
        return std::nullopt;
    }
    return address;
}

/// None when the system's sockets have no room for so long a path.
std::optional<Address> addressOfPath(const std::string& path) {
    Address address;
    auto* file = reinterpret_cast<sockaddr_un*>(&address.bytes);
    if (path.empty() || path.size() >= sizeof file->sun_path) {
        return std::nullopt;
    }
    file->sun_family = AF_UNIX;
    std::memcpy(file->sun_path, path.c_str(), path.size() + 1);
    address.size = sizeof *file;
    return address;
}

int made(const Address& address) {
    return ::socket(address.bytes.ss_family, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
}

sockaddr_storage nameOf(int descriptor) {
    sockaddr_storage bytes{};
    socklen_t size = sizeof bytes;
    if (::getsockname(descriptor, reinterpret_cast<sockaddr*>(&bytes), &size) != 0) {
        bytes.ss_family = AF_UNSPEC;
    }
    return bytes;
}

/// Empty when a socket may be made at the path, else why not.
std::string whyNotAt(const std::string& path, const Address& address) {
    if (std::string problem = documents::FileTrust::problemOfFolder(documents::FileSteps::absolute(path).parent_path());
        !problem.empty()) {
        return problem;
    }
    struct stat facts {};
    if (::lstat(path.c_str(), &facts) != 0) {
        return errno == ENOENT ? "" : std::strerror(errno);
    }
    if (!S_ISSOCK(facts.st_mode)) {
        return "is there already, and no socket";
    }
    const int probe = made(address);
    const bool isServed = probe < 0 ||
                          ::connect(probe, reinterpret_cast<const sockaddr*>(&address.bytes), address.size) == 0 ||
                          errno != ECONNREFUSED;
    if (probe >= 0) {
        ::close(probe);
    }
    return isServed ? "is served by another process" : "";
}

/// The group's number; -1, which changes nothing, without a name; none when nobody knows it.
std::optional<gid_t> groupOf(const std::string& name) {
    if (name.empty()) {
        return static_cast<gid_t>(-1);
    }
    std::array<char, 16384> room{};
    group entry{};
    group* found = nullptr;
    ::getgrnam_r(name.c_str(), &entry, room.data(), room.size(), &found);
    return found == nullptr ? std::nullopt : std::optional(entry.gr_gid);
}

}  // namespace

ListeningSocket::ListeningSocket(ListeningSocket&& other) noexcept
    : descriptor_(std::exchange(other.descriptor_, -1)),
      path_(std::exchange(other.path_, {})),
      device_(other.device_),
      inode_(other.inode_) {}

ListeningSocket::~ListeningSocket() {
    struct stat facts {};
    if (!path_.empty() && ::lstat(path_.c_str(), &facts) == 0 && facts.st_dev == device_ && facts.st_ino == inode_) {
        ::unlink(path_.c_str());
    }
    if (descriptor_ >= 0) {
        ::close(descriptor_);
    }
}

std::optional<ListeningSocket> ListeningSocket::onAddress(const std::string& text, int port, std::string& complaint) {
    const auto address = addressOf(text, port);
    if (!address) {
        complaint = text + ": is no address";
        return std::nullopt;
    }
    ListeningSocket socket(made(*address));
    const int yes = 1;
    // A port whose last user has ended is free; one in use is not (SO_REUSEPORT would share it).
    const bool listens =
        socket.descriptor_ >= 0 && ::setsockopt(socket.descriptor_, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes) == 0 &&
        ::bind(socket.descriptor_, reinterpret_cast<const sockaddr*>(&address->bytes), address->size) == 0 &&
        ::listen(socket.descriptor_, kBacklog) == 0;
    if (!listens) {
        complaint = "port " + std::to_string(port) + " of " + text + " cannot be used: " + std::strerror(errno);
        return std::nullopt;
    }
    return socket;
}

std::optional<ListeningSocket> ListeningSocket::at(const Place& place, std::string& complaint) {
    // It is made beside its place and moved there when it takes connections from those who may, and from nobody else.
    const std::string first = place.path + "." + std::to_string(::getpid());
    const auto address = addressOfPath(place.path);
    const auto firstAddress = addressOfPath(first);
    if (!address || !firstAddress) {
        complaint = place.path + ": expected a path of at most 90 bytes for a socket";
        return std::nullopt;
    }
    if (const std::string problem = whyNotAt(place.path, *address); !problem.empty()) {
        complaint = place.path + ": " + problem;
        return std::nullopt;
    }
    const auto group = groupOf(place.group);
    if (!group) {
        complaint = place.group + ": there is no such group";
        return std::nullopt;
    }
    ListeningSocket socket(made(*firstAddress));
    ::unlink(first.c_str());
    bool listens =
        socket.descriptor_ >= 0 &&
        ::bind(socket.descriptor_, reinterpret_cast<const sockaddr*>(&firstAddress->bytes), firstAddress->size) == 0;
    struct stat facts {};
    if (listens && ::lstat(first.c_str(), &facts) == 0) {
        socket.path_ = first;
        socket.device_ = facts.st_dev;
        socket.inode_ = facts.st_ino;
    }
    listens = listens && ::chown(first.c_str(), static_cast<uid_t>(-1), *group) == 0 &&
              ::chmod(first.c_str(), place.group.empty() ? 0600 : 0660) == 0 &&
              ::listen(socket.descriptor_, kBacklog) == 0 && ::rename(first.c_str(), place.path.c_str()) == 0;
    if (!listens) {
        complaint = place.path + ": the socket cannot be made: " + std::strerror(errno);
        return std::nullopt;
    }
    socket.path_ = place.path;
    return socket;
}

std::optional<ListeningSocket> ListeningSocket::inherited(int descriptor, std::string& complaint) {
    int listens = 0;
    int kind = 0;
    socklen_t size = sizeof listens;
    const bool takes = ::getsockopt(descriptor, SOL_SOCKET, SO_ACCEPTCONN, &listens, &size) == 0 && listens != 0 &&
                       ::getsockopt(descriptor, SOL_SOCKET, SO_TYPE, &kind, &size) == 0 && kind == SOCK_STREAM;
    const int flags = takes ? ::fcntl(descriptor, F_GETFL) : -1;
    if (flags < 0 || ::fcntl(descriptor, F_SETFL, flags | O_NONBLOCK) != 0 ||
        ::fcntl(descriptor, F_SETFD, FD_CLOEXEC) != 0) {
        complaint = "descriptor " + std::to_string(descriptor) + " takes no connections";
        return std::nullopt;
    }
    return ListeningSocket(descriptor);
}

int ListeningSocket::port() const {
    const sockaddr_storage bytes = nameOf(descriptor_);
    return bytes.ss_family == AF_INET6  ? ntohs(reinterpret_cast<const sockaddr_in6*>(&bytes)->sin6_port)
           : bytes.ss_family == AF_INET ? ntohs(reinterpret_cast<const sockaddr_in*>(&bytes)->sin_port)
                                        : 0;
}

bool ListeningSocket::isFile() const {
    return nameOf(descriptor_).ss_family == AF_UNIX;
}

bool ListeningSocket::isLocal() const {
    return ClientAddress::isLoopback(nameOf(descriptor_)) || isFile();
}

}  // namespace ktr::server
