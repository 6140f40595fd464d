#pragma once

#include <QHostAddress>
#include <string>
#include <utility>
#include <vector>

namespace ktr::app {

/// Which machines may connect: this one, and whatever is on the list. A value.
class PeerList {
  public:
    /// Adds an address or a network ("192.168.1.20", "192.168.1.0/24"). Empty, or what is wrong with it.
    std::string add(const std::string& text);
    bool allows(const QHostAddress& peer) const;
    bool isEmpty() const { return networks_.empty(); }

  private:
    std::vector<std::pair<QHostAddress, int>> networks_;
};

}  // namespace ktr::app
