#pragma once

namespace ktr::host {

/// What may move: nothing in a picture, fades alone where the user wants little motion, else everything.
enum class MotionStyle { None, Reduced, Full };

/// A number on its way from one value to another. Seconds; the caller passes the time. A value.
class Motion {
  public:
    /// At rest.
    explicit Motion(double value = 0.0) : from_(value), to_(value) {}
    /// With the easing of everything that comes, grows or shrinks: cubic (0.2, 0, 0, 1).
    Motion(double from, double to, double start, double duration)
        : from_(from), to_(to), start_(start), duration_(duration) {}

    static Motion linear(double from, double to, double start, double duration) {
        Motion motion(from, to, start, duration);
        motion.eased_ = false;
        return motion;
    }

    double target() const { return to_; }
    bool isOver(double now) const { return now >= start_ + duration_; }
    double at(double now) const;

  private:
    double from_, to_;
    double start_ = 0.0;
    double duration_ = 0.0;
    bool eased_ = true;
};

/// How long what takes, seconds, and how far.
namespace motions {

inline constexpr double kArrival = 0.24;
inline constexpr double kRise = 12.0;  ///< points
inline constexpr double kFade = 0.12;  ///< an arrival with little motion
inline constexpr double kGrowth = 0.2;
inline constexpr double kReady = 0.12;  ///< the send button's colour

}  // namespace motions

}  // namespace ktr::host
