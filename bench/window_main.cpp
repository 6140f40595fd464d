// A scenario in the program's window, on whatever display there is: how soon it is on the screen, how long each frame
// takes while it is scrolled, with the pointer over it, and what it keeps in memory.
#include <QApplication>
#include <QMouseEvent>
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

#include "app/window/ConversationWindow.h"
#include "bench/ScenarioHost.h"
#include "bench/ThreadTime.h"
#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/paint/FontSetup.h"

namespace {

using namespace ktr;
using bench::computed;
using Clock = std::chrono::steady_clock;

constexpr int kFrames = 600;
constexpr int kStep = 40;                 // points a frame: a fast hand
constexpr double kFrame = 1000.0 / 60.0;  // milliseconds

double since(Clock::time_point start) {
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

/// Resident memory, megabytes (Linux, /proc).
double residentMegabytes() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("VmRSS:", 0) == 0) {
            return std::atof(line.c_str() + 6) / 1024.0;
        }
    }
    return 0.0;
}

void print(const char* name, std::vector<double> times) {
    std::sort(times.begin(), times.end());
    const auto late = std::count_if(times.begin(), times.end(), [](double time) { return time > kFrame; });
    std::printf("  %-28s %6.2f ms (median), %6.2f of the slowest in 100, %6.2f at most; %ld of %zu over %.1f\n", name,
                times[times.size() / 2], times[times.size() * 99 / 100], times.back(), static_cast<long>(late),
                times.size(), kFrame);
}

/// Everything that is due is done, and the display has drawn it.
void show() {
    QCoreApplication::processEvents();
    QGuiApplication::sync();
}

/// Moves the conversation or the pointer before each frame.
void frames(const char* name, const std::function<void(int)>& change) {
    std::vector<double> times;
    std::vector<double> computing;
    for (int i = 0; i < kFrames; ++i) {
        const auto start = Clock::now();
        const double before = computed();
        change(i);
        show();
        computing.push_back(computed() - before);
        times.push_back(since(start));
    }
    std::printf("%s\n", name);
    print("frame", times);
    print("of it computed by ktr", computing);
}

/// What the main thread computes in each turn of its loop while what was deferred arrives: avatars, maps, and the
/// pictures of rows in very large text.
void settle() {
    constexpr std::chrono::seconds kLong{3};
    std::vector<double> computing;
    for (const auto start = Clock::now(); Clock::now() - start < kLong;) {
        const double before = computed();
        show();
        computing.push_back(computed() - before);
    }
    std::printf("while what was deferred arrives:\n");
    print("a turn of the main thread", computing);
}

void movePointer(QWidget& widget, QPointF at) {
    QMouseEvent event(QEvent::MouseMove, at, widget.mapToGlobal(at), Qt::NoButton, Qt::NoButton, Qt::NoModifier);
    QCoreApplication::sendEvent(&widget, &event);
}

int run(const char* file, Clock::time_point start) {
    const double residentBefore = residentMegabytes();
    auto read = host::ScenarioReader(platform::Date{}).readFile(file);
    const auto* scenario = std::get_if<host::Scenario>(&read);
    if (scenario == nullptr) {
        std::fprintf(stderr, "%s\n", std::get<documents::DocumentError>(read).text().c_str());
        return 1;
    }
    const double hasRead = since(start);
    const auto made = bench::hostFor(file, *scenario, host::Host::Time::Running);
    if (!made) {
        return 1;
    }
    host::Host& host = *made;
    if (const auto failure = host.addTurn(*scenario)) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return 1;
    }
    const double hasRows = since(start);
    app::ConversationWindow window(host);
    window.resize(400, 800);
    window.show();
    app::ConversationWidget& conversation = window.conversation();
    while (conversation.lastPainted().isEmpty()) {
        show();
    }
    const double isShown = since(start);
    std::printf(
        "open: %.0f ms from the program's start to the screen (read %.0f, rows %.0f, window %.0f), %.0f computed\n",
        isShown, hasRead, hasRows - hasRead, isShown - hasRows, computed());
    settle();
    frames("scrolled by a fast hand:", [&](int frame) { conversation.scrollTo(kStep * frame); });
    const double height = host.window()->bounds().height;
    frames("scrolled anywhere:", [&](int frame) { conversation.scrollTo(height / kFrames * (frame * 7 % kFrames)); });
    frames("under a moving pointer:", [&](int frame) { movePointer(conversation, {200.0, 20.0 + frame % 760}); });
    std::printf("memory: %.0f MB resident, %.0f before the scenario was read\n", residentMegabytes(), residentBefore);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    const auto start = Clock::now();
    if (argc != 2) {
        std::fprintf(stderr, "usage: %s SCENARIO      bench/window runs it on a display of its own\n", argv[0]);
        return 2;
    }
    linux_::FontSetup::prepare(linux_::FontSetup::Mode::System);
    const QApplication application(argc, argv);
    return run(argv[1], start);
}
