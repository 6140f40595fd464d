#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace ktr::server {

/// The clock on the wall where somebody lives. A value; any thread.
class WallClock {
  public:
    /// `zone`: a name such as "Europe/Berlin"; empty, or unknown to this machine: the machine's own.
    explicit WallClock(std::string zone);

    static bool isZone(const std::string& name);
    /// The name of the machine's zone.
    static std::string machineZone();

    /// When it next shows this time, after `now`; 24:00 is the end of the day. Seconds since 1970. None when there is
    /// no such time.
    std::optional<std::int64_t> next(int hour, int minute, std::int64_t now) const;
    /// "2026-05-16 17:42".
    std::string face(std::int64_t time) const;
    /// When a grant ends, in words: "midnight", "18:30" (the next one), or an ISO time. None for anything else and for
    /// what is over.
    std::optional<std::int64_t> endingOf(const std::string& words, std::int64_t now) const;

    const std::string& zone() const { return zone_; }

  private:
    std::string zone_;
};

}  // namespace ktr::server
