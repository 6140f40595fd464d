#include "linux/device/Buses.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <future>
#include <optional>
#include <string_view>

namespace ktr::linux_ {

namespace {

using SteadyClock = std::chrono::steady_clock;
using Greeting = Buses::Greeting;

constexpr const char* kSessionVariable = "DBUS_SESSION_BUS_ADDRESS";
constexpr const char* kSystemVariable = "DBUS_SYSTEM_BUS_ADDRESS";
constexpr const char* kSystemAddress = "unix:path=/var/run/dbus/system_bus_socket";
/// No transport is called so: whoever asks for it is refused at once.
constexpr const char* kNoBus = "disabled:";

/// A socket whose calls all end at a deadline.
class Connection {
  public:
    explicit Connection(SteadyClock::time_point deadline) : deadline_(deadline) {}
    ~Connection() {
        if (socket_ >= 0) {
            ::close(socket_);
        }
    }
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    Greeting open(const sockaddr_un& address, socklen_t length) {
        socket_ = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
        if (socket_ < 0) {
            return Greeting::Refused;
        }
        if (::connect(socket_, reinterpret_cast<const sockaddr*>(&address), length) == 0) {
            return Greeting::Answered;
        }
        // A socket of this kind says so when no process takes connections from its queue.
        return errno == EAGAIN ? Greeting::Silent : Greeting::Refused;
    }

    Greeting write(std::string_view bytes) {
        while (!bytes.empty()) {
            const ssize_t count = ::send(socket_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
            if (count > 0) {
                bytes.remove_prefix(static_cast<std::size_t>(count));
            } else if (!isPassing() || !waitFor(POLLOUT)) {
                return isPassing() ? Greeting::Silent : Greeting::Refused;
            }
        }
        return Greeting::Answered;
    }

    /// Waits for a piece of what the other side says; `piece` gets it.
    Greeting read(std::string& piece) {
        for (;;) {
            std::array<char, 512> buffer;
            const ssize_t count = ::recv(socket_, buffer.data(), buffer.size(), 0);
            if (count > 0) {
                piece.assign(buffer.data(), static_cast<std::size_t>(count));
                return Greeting::Answered;
            }
            if (count == 0 || !isPassing()) {
                return Greeting::Refused;
            }
            if (!waitFor(POLLIN)) {
                return Greeting::Silent;
            }
        }
    }

  private:
    static bool isPassing() { return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR; }
    /// False once the deadline has passed.
    bool waitFor(short events) const {
        const std::chrono::duration<double, std::milli> left = deadline_ - SteadyClock::now();
        if (left.count() <= 0.0) {
            errno = EAGAIN;
            return false;
        }
        pollfd waiting{socket_, events, 0};
        ::poll(&waiting, 1, static_cast<int>(std::ceil(left.count())));
        return true;
    }

    SteadyClock::time_point deadline_;
    int socket_ = -1;
};

/// What stands behind a key of an address ("unix:path=/run/bus,guid=..."), with its escapes undone.
std::optional<std::string> valueOf(std::string_view address, std::string_view key) {
    std::size_t at = address.find(':');
    while (at != std::string_view::npos) {
        const std::string_view rest = address.substr(at + 1);
        const std::string_view pair = rest.substr(0, rest.find(','));
        if (pair.starts_with(key) && pair.substr(key.size(), 1) == "=") {
            std::string value;
            for (std::size_t i = key.size() + 1; i < pair.size(); ++i) {
                if (pair[i] == '%' && i + 2 < pair.size()) {
                    value += static_cast<char>(std::strtol(std::string(pair.substr(i + 1, 2)).c_str(), nullptr, 16));
                    i += 2;
                } else {
                    value += pair[i];
                }
            }
            return value;
        }
        at = address.find(',', at + 1);
    }
    return std::nullopt;
}

/// The place of a local socket; none for an address of another kind.
std::optional<std::pair<sockaddr_un, socklen_t>> socketOf(std::string_view address) {
    if (!address.starts_with("unix:")) {
        return std::nullopt;
    }
    sockaddr_un place{};
    place.sun_family = AF_UNIX;
    const auto path = valueOf(address, "path");
    const auto name = path ? std::nullopt : valueOf(address, "abstract");
    const std::string bytes = path ? *path : name ? std::string(1, '\0') + *name : "";
    if (bytes.empty() || bytes.size() >= sizeof(place.sun_path)) {
        return std::nullopt;
    }
    std::memcpy(place.sun_path, bytes.data(), bytes.size());
    const std::size_t length = offsetof(sockaddr_un, sun_path) + bytes.size() + (path ? 1 : 0);
    return std::pair(place, static_cast<socklen_t>(length));
}

/// The call of org.freedesktop.DBus.Hello, which every connection begins with (D-Bus specification, "Message Format").
std::string helloCall() {
    std::string fields;
    const auto number = [](std::uint32_t value) {
        std::string bytes;
        for (int shift = 0; shift < 32; shift += 8) {
            bytes += static_cast<char>(value >> shift & 0xFF);
        }
        return bytes;
    };
    const auto add = [&](char code, char type, const std::string& text) {
        fields.resize((fields.size() + 7) / 8 * 8);
        fields += {code, 1, type, 0};
        fields += number(static_cast<std::uint32_t>(text.size())) + text + '\0';
    };
    add(1, 'o', "/org/freedesktop/DBus");
    add(2, 's', "org.freedesktop.DBus");
    add(3, 's', "Hello");
    add(6, 's', "org.freedesktop.DBus");
    std::string call = {'l', 1, 0, 1};
    call += number(0) + number(1) + number(static_cast<std::uint32_t>(fields.size())) + fields;
    call.resize((call.size() + 7) / 8 * 8);
    return call;
}

Greeting greetSocket(const sockaddr_un& place, socklen_t length, SteadyClock::time_point deadline) {
    Connection bus(deadline);
    Greeting state = bus.open(place, length);
    if (state == Greeting::Answered) {
        std::string user;
        for (const char digit : std::to_string(::getuid())) {
            user += '3';
            user += digit;
        }
        state = bus.write(std::string(1, '\0') + "AUTH EXTERNAL " + user + "\r\n");
    }
    std::string said;
    if (state == Greeting::Answered) {
        state = bus.read(said);
    }
    if (state != Greeting::Answered || !said.starts_with("OK")) {
        // A bus that takes other users alone does answer.
        return state;
    }
    state = bus.write("BEGIN\r\n" + helloCall());
    return state == Greeting::Answered ? bus.read(said) : state;
}

std::string sessionAddress() {
    if (const char* address = std::getenv(kSessionVariable); address != nullptr && *address != '\0') {
        return address;
    }
    const char* folder = std::getenv("XDG_RUNTIME_DIR");
    return folder != nullptr && *folder != '\0' ? "unix:path=" + std::string(folder) + "/bus" : "";
}

std::string systemAddress() {
    const char* address = std::getenv(kSystemVariable);
    return address != nullptr && *address != '\0' ? address : kSystemAddress;
}

}  // namespace

Buses::Greeting Buses::greet(const std::string& address, double seconds) {
    const auto deadline =
        SteadyClock::now() + std::chrono::duration_cast<SteadyClock::duration>(std::chrono::duration<double>(seconds));
    Greeting last = Greeting::Unknown;
    // Of several addresses the first that can be used is used.
    std::string_view rest = address;
    while (!rest.empty()) {
        const std::string_view one = rest.substr(0, rest.find(';'));
        rest.remove_prefix(std::min(one.size() + 1, rest.size()));
        const auto place = socketOf(one);
        if (!place) {
            return Greeting::Unknown;
        }
        last = greetSocket(place->first, place->second, deadline);
        if (last != Greeting::Refused) {
            return last;
        }
    }
    return last;
}

std::vector<std::string> Buses::switchOffSilent() {
    auto session = std::async(std::launch::async, [address = sessionAddress()] { return greet(address); });
    const Greeting system = greet(systemAddress());
    std::vector<std::string> lines;
    if (session.get() == Greeting::Silent) {
        ::setenv(kSessionVariable, kNoBus, 1);
        lines.emplace_back("the session's message bus does not answer; going on without it");
    }
    if (system == Greeting::Silent) {
        ::setenv(kSystemVariable, kNoBus, 1);
        lines.emplace_back("the system's message bus does not answer; going on without it");
    }
    return lines;
}

}  // namespace ktr::linux_
