#pragma once

#include <QPointF>
#include <deque>

namespace ktr::app {

/// Where a hand has been that drags something, and how fast it was when it let go. Points and seconds; the caller
/// passes the time. A value.
class DragTrail {
  public:
    /// Only the last moments of a drag tell how fast the hand was, seconds.
    static constexpr double kMemory = 0.1;

    bool isEmpty() const { return samples_.empty(); }
    /// The hand takes hold, or begins anew.
    void begin(QPointF at, double time) { samples_.assign(1, {at, time}); }
    /// How far the hand has moved since it was last heard of; nothing for one that takes hold only now.
    QPointF move(QPointF at, double time);
    /// Lets go; points a second, none of a hand that had come to rest.
    QPointF release(double time);

  private:
    struct Sample {
        QPointF at;
        double time;
    };
    std::deque<Sample> samples_;
};

}  // namespace ktr::app
