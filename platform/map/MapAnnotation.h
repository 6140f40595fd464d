#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Object.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// Something that stands at a place on a map. Main thread.
class KTR_API MapAnnotation : public Object {
  public:
    ~MapAnnotation() override;
    /// In the datum of the map.
    virtual Coordinate coordinate() const = 0;
    virtual std::optional<std::string> title() const { return std::nullopt; }
    virtual std::optional<std::string> subtitle() const { return std::nullopt; }
    /// False: its view draws nothing.
    virtual bool hasKnownLocation() const { return true; }

    /// Called whenever the coordinate has been set, until the token goes. It captures weakly.
    [[nodiscard]] std::shared_ptr<void> observeCoordinate(std::function<void()> changed);

  protected:
    /// To be called by a subclass that has set its coordinate.
    void coordinateChanged();

  private:
    std::vector<std::weak_ptr<std::function<void()>>> observers_;
};

/// The user, on a map that shows them. Its coordinate is 0, 0 while the position is unknown.
class KTR_API UserLocation : public MapAnnotation {
  public:
    Coordinate coordinate() const override { return coordinate_; }
    bool hasKnownLocation() const override { return location_ != nullptr; }
    /// As it was measured, in WGS84; none while unknown.
    const std::shared_ptr<PlatformLocation>& location() const { return location_; }
    /// `onMap` is the location's coordinate in the map's datum.
    void setLocation(std::shared_ptr<PlatformLocation> location, const Coordinate& onMap);

  private:
    std::shared_ptr<PlatformLocation> location_;
    Coordinate coordinate_;
};

}  // namespace ktr::platform
