#pragma once

#include <functional>
#include <string>

#include "platform/map/MapsApplication.h"

namespace ktr::linux_ {

/// Hands a place to whatever application the desktop has for "geo:" addresses. Main thread.
class DesktopMapsApplication final : public platform::MapsApplication {
  public:
    /// Opens an address; false when no program does.
    using Opener = std::function<bool(const std::string& url)>;

    /// Without an opener the desktop's.
    explicit DesktopMapsApplication(Opener opener = {});
    bool open(const platform::MapItem& item) override;
    /// The place as a "geo:" address (RFC 5870), its name as the query that applications know:
    /// "q=latitude,longitude(name)".
    static std::string urlFor(const platform::MapItem& item);

  private:
    Opener opener_;
};

}  // namespace ktr::linux_
