#include "app/voice/PeerList.h"

#include <algorithm>

namespace ktr::app {

namespace {

/// An IPv4 address that came over IPv6 is the IPv4 address.
QHostAddress plain(const QHostAddress& address) {
    bool isIpv4 = false;
    const quint32 number = address.toIPv4Address(&isIpv4);
    return isIpv4 ? QHostAddress(number) : address;
}

}  // namespace

std::string PeerList::add(const std::string& text) {
    const auto [address, bits] = QHostAddress::parseSubnet(QString::fromStdString(text));
    if (address.isNull() || bits < 0) {
        return "expected an address or a network, such as 192.168.1.20 or 192.168.1.0/24";
    }
    if (bits == 0) {
        return "that is everybody";
    }
    networks_.emplace_back(address, bits);
    return "";
}

bool PeerList::allows(const QHostAddress& peer) const {
    const QHostAddress address = plain(peer);
    return address.isLoopback() ||
           std::any_of(networks_.begin(), networks_.end(), [&](const auto& one) { return address.isInSubnet(one); });
}

}  // namespace ktr::app
