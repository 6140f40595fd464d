#pragma once

#include <string>

namespace ktr::linux_ {

/// The computer's clock, set from the network (org.freedesktop.timedate1). Any thread but the main thread.
class NetworkTime {
  public:
    /// Has the system follow the network's time; it may ask its user for a password meanwhile. `bus`: the address of
    /// the system's bus. Empty when done, else one line.
    static std::string turnOn(const std::string& bus);
};

}  // namespace ktr::linux_
