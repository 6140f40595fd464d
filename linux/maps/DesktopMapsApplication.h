#pragma once

#include <functional>
#include <string>
#include <utility>

#include "platform/map/MapsApplication.h"

namespace ktr::linux_ {

/// Hands a place on as a "geo:" address. Main thread.
class DesktopMapsApplication final : public platform::MapsApplication {
  public:
    /// Opens an address; false when no program does.
    using Opener = std::function<bool(const std::string& url)>;

    explicit DesktopMapsApplication(Opener opener) : opener_(std::move(opener)) {}
    bool open(const platform::MapItem& item) override;
    /// The place as a "geo:" address (RFC 5870), its name as the query that applications know:
    /// "q=latitude,longitude(name)".
    static std::string urlFor(const platform::MapItem& item);

  private:
    Opener opener_;
};

}  // namespace ktr::linux_
