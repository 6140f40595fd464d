#include "linux/device/TimeJumps.h"

#include <sys/timerfd.h>
#include <unistd.h>

#include <QFileInfo>
#include <cstdint>
#include <limits>

namespace ktr::linux_ {

namespace {

constexpr int kSoon = 200;  // milliseconds

}  // namespace

TimeJumps::TimeJumps(QDBusConnection bus, const QString& zone) : bus_(std::move(bus)) {
    soon_.setSingleShot(true);
    soon_.setInterval(kSoon);
    connect(&soon_, &QTimer::timeout, this, [this] {
        if (jumped_) {
            jumped_();
        }
    });
    if (bus_.isConnected()) {
        bus_.connect(QStringLiteral("org.freedesktop.login1"), QStringLiteral("/org/freedesktop/login1"),
                     QStringLiteral("org.freedesktop.login1.Manager"), QStringLiteral("PrepareForSleep"), this,
                     SLOT(prepareForSleep(bool)));
    }
    watchClock();
    watchZone(zone);
}

TimeJumps::~TimeJumps() {
    clockSet_.reset();
    if (clock_ >= 0) {
        ::close(clock_);
    }
}

void TimeJumps::prepareForSleep(bool goes) {
    if (!goes) {
        soon_.start();
    }
}

void TimeJumps::armClock() const {
    // A moment that never comes: what ends the waiting is the clock (timerfd_create(2), TFD_TIMER_CANCEL_ON_SET).
    itimerspec never{};
    never.it_value.tv_sec = std::numeric_limits<time_t>::max();
    ::timerfd_settime(clock_, TFD_TIMER_ABSTIME | TFD_TIMER_CANCEL_ON_SET, &never, nullptr);
}

void TimeJumps::watchClock() {
    clock_ = ::timerfd_create(CLOCK_REALTIME, TFD_NONBLOCK | TFD_CLOEXEC);
    if (clock_ < 0) {
        return;
    }
    armClock();
    clockSet_ = std::make_unique<QSocketNotifier>(clock_, QSocketNotifier::Read);
    connect(clockSet_.get(), &QSocketNotifier::activated, this, [this] {
        std::uint64_t times = 0;
        [[maybe_unused]] const auto ended = ::read(clock_, &times, sizeof(times));
        armClock();
        soon_.start();
    });
}

void TimeJumps::watchZone(const QString& zone) {
    // Who changes it puts another link in its place: the folder tells.
    zone_.addPath(QFileInfo(zone).path());
    connect(&zone_, &QFileSystemWatcher::directoryChanged, this,
            [this, zone, before = QFileInfo(zone).canonicalFilePath()]() mutable {
                if (const QString now = QFileInfo(zone).canonicalFilePath(); now != before) {
                    before = now;
                    soon_.start();
                }
            });
}

}  // namespace ktr::linux_
