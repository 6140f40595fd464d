#include "server/http/ClientAddress.h"

#include <arpa/inet.h>
#include <netinet/in.h>

#include <array>
#include <cstring>
#include <optional>
#include <string_view>

namespace ktr::server {

namespace {

constexpr const char* kList = "X-Forwarded-For";
constexpr const char* kStandard = "Forwarded";

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(" \t");
    const std::size_t last = text.find_last_not_of(" \t");
    return first == std::string_view::npos ? std::string_view() : text.substr(first, last - first + 1);
}

std::string_view behindLast(std::string_view text, char mark) {
    const std::size_t at = text.rfind(mark);
    return at == std::string_view::npos ? text : text.substr(at + 1);
}

/// The last header of this name: each proxy writes behind what was there.
std::optional<std::string_view> lastOf(const HttpRequest& request, std::string_view name) {
    std::optional<std::string_view> last;
    for (const auto& [key, value] : request.headers) {
        if (equalIgnoringCase(key, name)) {
            last = value;
        }
    }
    return last;
}

/// "192.0.2.1", "192.0.2.1:80", "2001:db8::1" or "[2001:db8::1]:80".
std::string addressIn(std::string_view text) {
    const bool isBracketed = !text.empty() && text.front() == '[';
    if (isBracketed) {
        const std::size_t end = text.find(']');
        text = end == std::string_view::npos ? std::string_view() : text.substr(1, end - 1);
    } else if (text.find(':') == text.rfind(':')) {
        text = text.substr(0, text.find(':'));
    }
    const std::string plain(text);
    sockaddr_storage address{};
    if (!isBracketed && ::inet_pton(AF_INET, plain.c_str(), &reinterpret_cast<sockaddr_in*>(&address)->sin_addr) == 1) {
        address.ss_family = AF_INET;
    } else if (::inet_pton(AF_INET6, plain.c_str(), &reinterpret_cast<sockaddr_in6*>(&address)->sin6_addr) == 1) {
        address.ss_family = AF_INET6;
    } else {
        return ClientAddress::kUnclear;
    }
    return ClientAddress::of(address);
}

/// The "for" of the last element, `for="[2001:db8::1]:80";proto=https`.
std::string addressInStandard(std::string_view header) {
    std::string_view element = behindLast(header, ',');
    while (!element.empty()) {
        const std::size_t end = element.find(';');
        const std::string_view pair = trimmed(element.substr(0, end));
        element = end == std::string_view::npos ? std::string_view() : element.substr(end + 1);
        const std::size_t equals = pair.find('=');
        if (equals == std::string_view::npos || !equalIgnoringCase(trimmed(pair.substr(0, equals)), "for")) {
            continue;
        }
        std::string_view value = trimmed(pair.substr(equals + 1));
        if (value.size() >= 2 && value.front() == '"' && value.back() == '"') {
            value = value.substr(1, value.size() - 2);
        }
        return addressIn(value);
    }
    return ClientAddress::kUnclear;
}

}  // namespace

std::string ClientAddress::of(const sockaddr_storage& bytes) {
    std::array<char, INET6_ADDRSTRLEN> text{};
    if (bytes.ss_family == AF_INET) {
        ::inet_ntop(AF_INET, &reinterpret_cast<const sockaddr_in*>(&bytes)->sin_addr, text.data(), text.size());
    } else if (bytes.ss_family == AF_INET6) {
        in6_addr address = reinterpret_cast<const sockaddr_in6*>(&bytes)->sin6_addr;
        if (IN6_IS_ADDR_V4MAPPED(&address)) {
            ::inet_ntop(AF_INET, &address.s6_addr[12], text.data(), text.size());
            return text.data();
        }
        std::memset(&address.s6_addr[8], 0, 8);
        ::inet_ntop(AF_INET6, &address, text.data(), text.size());
    }
    return text.data();
}

bool ClientAddress::isLoopback(const sockaddr_storage& bytes) {
    if (bytes.ss_family == AF_INET6) {
        const in6_addr& address = reinterpret_cast<const sockaddr_in6*>(&bytes)->sin6_addr;
        return IN6_IS_ADDR_LOOPBACK(&address) || (IN6_IS_ADDR_V4MAPPED(&address) && address.s6_addr[12] == 127);
    }
    return bytes.ss_family == AF_INET &&
           (ntohl(reinterpret_cast<const sockaddr_in*>(&bytes)->sin_addr.s_addr) >> 24U) == 127;
}

bool ClientAddress::isForwarded(const HttpRequest& request) {
    return lastOf(request, kList).has_value() || lastOf(request, kStandard).has_value();
}

std::string ClientAddress::forwardedFor(const HttpRequest& request) {
    const auto list = lastOf(request, kList);
    const auto standard = lastOf(request, kStandard);
    const std::string one = list ? addressIn(trimmed(behindLast(*list, ','))) : std::string();
    const std::string other = standard ? addressInStandard(*standard) : std::string();
    if (list && standard) {
        return one == other ? one : kUnclear;
    }
    return list ? one : standard ? other : kUnclear;
}

}  // namespace ktr::server
