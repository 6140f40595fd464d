#pragma once

#include <optional>

#include "host/conversation/Motion.h"
#include "platform/map/MapViewport.h"

namespace ktr::app {

/// What part of the world a map shows that is moved by hand, and its way there. Points in the map's rectangle; seconds,
/// told from outside. A value.
class MapCamera {
  public:
    /// The coarsest shows a continent, the finest a house.
    static constexpr double kCoarsest = 3.0;
    static constexpr double kFinest = 19.0;

    void setSize(const platform::Size& size) { shown_.size = size; }
    const platform::MapViewport& shown() const { return shown_; }
    bool isMoving(double now) const { return flight_ && !flight_->share.isOver(now); }
    /// Of what is shown once it has arrived.
    double zoomAtRest() const { return target().zoom; }
    bool isCoarsest() const { return target().zoom <= kCoarsest; }
    bool isFinest() const { return target().zoom >= kFinest; }

    /// A coordinate at a point, at once.
    void put(const platform::Coordinate& coordinate, const platform::Point& at, double zoom);
    /// The same, on the way for `seconds`.
    void flyTo(const platform::Coordinate& coordinate, const platform::Point& at, double zoom, double now,
               double seconds);
    /// The ground follows the hand.
    void panBy(double dx, double dy);
    /// What is at the point stays there; by so many doublings.
    void zoomBy(double steps, const platform::Point& at);
    /// The same on the way for `seconds`; steps that come while one is under way add up.
    void zoomOn(double steps, const platform::Point& at, double now, double seconds);
    /// Brings `shown` to where it is now; true while there is more to come.
    bool advance(double now);
    void stop() { flight_.reset(); }

    /// At which a point of the screen is so many metres wide there.
    static double zoomFor(const platform::Coordinate& coordinate, double metresPerPoint);

  private:
    struct Flight {
        platform::MapViewport from, to;
        std::optional<platform::Point> fixed;  ///< stays where it is on screen
        host::Motion share;
    };
    const platform::MapViewport& target() const { return flight_ ? flight_->to : shown_; }
    static platform::MapViewport viewport(const platform::Coordinate& coordinate, const platform::Point& at,
                                          double zoom, const platform::Size& size);

    platform::MapViewport shown_;
    std::optional<Flight> flight_;
};

}  // namespace ktr::app
