// A friend's page that is dragged and zoomed: how long each frame takes, from the hand's movement to the painted
// window.
//   ktr-friend-map-bench SCENARIO HANDLE [WIDTH HEIGHT]
// Prints for each way of moving how many of its frames took less than 16 ms, and the 50th, 95th and 99th percentile.
#include <QApplication>
#include <QElapsedTimer>
#include <QMouseEvent>
#include <QWheelEvent>
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <vector>

#include "app/window/ConversationWindow.h"
#include "app/window/friend/FriendPage.h"
#include "bench/ThreadTime.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/paint/FontSetup.h"

namespace {

using namespace ktr;

constexpr int kFrames = 300;
constexpr double kFrame = 16.0;  // milliseconds

/// Counts paintings of the map.
class Paintings : public QObject {
  public:
    bool eventFilter(QObject* /*object*/, QEvent* event) override {
        count += event->type() == QEvent::Paint ? 1 : 0;
        return false;
    }
    int count = 0;
};

void rest(int milliseconds) {
    QElapsedTimer timer;
    timer.start();
    while (timer.elapsed() < milliseconds) {
        QApplication::processEvents(QEventLoop::AllEvents, 5);
    }
}

void reportOne(const char* what, const char* kind, std::vector<double> times) {
    std::sort(times.begin(), times.end());
    const auto at = [&](double share) {
        return times[static_cast<std::size_t>(share * static_cast<double>(times.size() - 1))];
    };
    const auto good = std::lower_bound(times.begin(), times.end(), kFrame) - times.begin();
    std::printf("%s, %s: %.1f %% of %zu frames under %.0f ms; p50 %.1f ms, p95 %.1f ms, p99 %.1f ms\n", what, kind,
                100.0 * static_cast<double>(good) / static_cast<double>(times.size()), times.size(), kFrame, at(0.5),
                at(0.95), at(0.99));
}

/// By the clock, and of the window's own thread alone: on a busy machine the first says little.
struct Times {
    std::vector<double> clock, thread;
};

Times measure(app::FriendMap& map, const std::function<void(int)>& move) {
    Paintings paintings;
    map.installEventFilter(&paintings);
    Times times;
    for (int frame = 0; frame < kFrames; ++frame) {
        QElapsedTimer timer;
        timer.start();
        const double work = bench::computed();
        const int before = paintings.count;
        move(frame);
        while (paintings.count == before && timer.elapsed() < 1000) {
            QApplication::processEvents(QEventLoop::AllEvents, 1);
        }
        times.clock.push_back(static_cast<double>(timer.nsecsElapsed()) * 1e-6);
        times.thread.push_back(bench::computed() - work);
        // A hand moves sixty times a second; in between the workers' pictures come.
        const int left = static_cast<int>(kFrame - times.clock.back());
        rest(std::max(left, 0));
    }
    map.removeEventFilter(&paintings);
    return times;
}

void report(const char* what, const Times& times) {
    reportOne(what, "by the clock", times.clock);
    reportOne(what, "of the thread", times.thread);
}

void mouse(QWidget& map, QEvent::Type type, QPointF at) {
    const bool isMove = type == QEvent::MouseMove;
    QMouseEvent event(type, at, map.mapToGlobal(at), isMove ? Qt::NoButton : Qt::LeftButton,
                      type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(&map, &event);
}

int run(const std::string& file, const std::string& handle, int width, int height) {
    auto read = host::ScenarioReader({0.0}).readFile(file);
    if (!std::holds_alternative<host::Scenario>(read)) {
        std::fprintf(stderr, "%s cannot be read\n", file.c_str());
        return 1;
    }
    const std::vector<host::Scenario> scenarios = {std::get<host::Scenario>(read)};
    const auto settings = host::HostSettings::decide({}, scenarios, {});
    auto made = host::Host::make(std::get<host::HostSettings>(settings), host::Host::Time::Running, "");
    if (const auto* failure = std::get_if<host::Failure>(&made)) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return 1;
    }
    auto& host = *std::get<std::unique_ptr<host::Host>>(made);
    host.addTurn(scenarios.front());
    linux_::DesktopOpener desktop(QString(), [](const std::string&) { return false; });
    app::ConversationWindow window(host);
    window.openLinks(desktop);
    window.resize(width, height);
    window.show();
    rest(500);
    host.delegate().open(platform::Url("wayloc://friend/" + handle));
    auto* page = dynamic_cast<app::FriendPage*>(window.pages().current());
    if (page == nullptr) {
        std::fprintf(stderr, "there is no friend %s in it\n", handle.c_str());
        return 1;
    }
    rest(2000);
    app::FriendMap& map = page->map();
    QPointF hand(width * 0.6, height * 0.3);
    mouse(map, QEvent::MouseButtonPress, hand);
    report("dragged", measure(map, [&](int frame) {
               // To and fro, as far as a hand goes.
               const double way = frame % 100 < 50 ? 7.0 : -7.0;
               hand += QPointF(way, frame % 60 < 30 ? 4.0 : -4.0);
               mouse(map, QEvent::MouseMove, hand);
           }));
    mouse(map, QEvent::MouseButtonRelease, hand);
    rest(1000);
    report("zoomed", measure(map, [&](int frame) {
               const QPointF at(width * 0.55, height * 0.35);
               QWheelEvent wheel(at, map.mapToGlobal(at), {}, {0, frame % 60 < 30 ? 20 : -20}, Qt::NoButton,
                                 Qt::NoModifier, Qt::NoScrollPhase, false);
               QApplication::sendEvent(&map, &wheel);
           }));
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3 && argc != 5) {
        std::fprintf(stderr, "usage: ktr-friend-map-bench SCENARIO HANDLE [WIDTH HEIGHT]\n");
        return 2;
    }
    std::string error;
    linux_::FontSetup::prepare(linux_::FontSetup::Mode::Pinned, &error);
    QApplication application(argc, argv);
    linux_::FontSetup::load(linux_::FontSetup::Mode::Pinned);
    return argc == 5 ? run(argv[1], argv[2], std::atoi(argv[3]), std::atoi(argv[4])) : run(argv[1], argv[2], 400, 800);
}
