// One answer of the service in the whole program: what the network thread does with it, and what the main thread does,
// part by part, from the command that asks to the screenful that shows it.
#include <QApplication>
#include <QImage>
#include <QPainter>
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <functional>
#include <map>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "bench/ScenarioHost.h"
#include "bench/ThreadTime.h"
#include "documents/JsonReader.h"
#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/paint/QtCanvas.h"
#include "platform/assistant/VALocation.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Json.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/HttpTransport.h"

namespace {

using namespace ktr;
using bench::timed;
using namespace ktr::platform;

constexpr double kWidth = 400.0;   // points
constexpr double kScreen = 800.0;  // points
constexpr double kScale = 2.0;
constexpr double kInterval = 10.0;  // seconds between two answers
constexpr int kWarmUp = 3;
constexpr int kRounds = 41;

struct BenchAccount : DeviceOwnerAccount {
    std::optional<std::string> personIdentifier() const override { return "person"; }
    std::optional<std::string> userName() const override { return "user"; }
    std::optional<std::string> tokenOfType(int) const override { return "token"; }
    std::optional<std::string> hostNameOfType(int) const override { return "localhost"; }
};

struct BenchAccounts : AccountStore {
    std::shared_ptr<DeviceOwnerAccount> deviceOwnerAccount() const override { return account; }
    std::shared_ptr<DeviceOwnerAccount> account = std::make_shared<BenchAccount>();
};

/// Keeps what is to be answered.
struct BenchTransport : HttpTransport {
    void send(const HttpRequest& request, Completion completion) override {
        bytesSent = request.body.size();
        waiting.push_back(std::move(completion));
    }
    std::vector<Completion> waiting;
    std::size_t bytesSent = 0;
};

/// The virtual time with a worker: what is given to one is no part of what the main thread computes.
class BenchLoop : public MainLoop {
  public:
    explicit BenchLoop(std::shared_ptr<VirtualTime> time) : time_(std::move(time)) {}

    void post(Work work) override { time_->post(std::move(work)); }
    std::shared_ptr<Timer> schedule(double seconds, bool repeats, Work work) override {
        return time_->schedule(seconds, repeats, std::move(work));
    }
    void runInBackground(Work work) override { waiting_.push_back(std::move(work)); }
    bool isMainThread() const override { return time_->isMainThread(); }

    /// Does what waits for a worker, and what comes of it; until then this thread has the processor to itself.
    void work() {
        std::thread([waiting = std::exchange(waiting_, {})]() mutable {
            for (Work& one : waiting) {
                std::exchange(one, nullptr)();
            }
        }).join();
        time_->runPosted();
    }

  private:
    std::shared_ptr<VirtualTime> time_;
    std::vector<Work> waiting_;
};

/// Everybody has walked on since the round before: no place, distance or age needs to be the same.
std::string bodyOf(const LocationList& friends, int round, double milliseconds) {
    Dictionary entries;
    Value::Array handles;
    double turn = 0.0;
    for (const auto& one : friends) {
        const std::string handle = one->friend_ && one->friend_->data ? *one->friend_->data : "";
        turn += 1.0;
        const double walked = 0.00037 * round * std::fmod(turn, 7.0);
        entries.set(handle,
                    Dictionary{{"status", 200},
                               {"match", false},
                               {"location",
                                Dictionary{{"latitude", 50.2 + 0.0007 * turn + walked},
                                           {"longitude", -3.1 - walked},
                                           {"horizontalAccuracy", 20.0},
                                           {"timestamp", milliseconds - 7000.0 * std::fmod(turn, 500.0)},
                                           {"streetAddress", "1 Quay Street"},
                                           {"address", Dictionary{{"locality", "Harbour"}, {"stateCode", "HB"}}}}}});
        handles.push_back(handle);
    }
    return writeJson(Dictionary{{"statusCode", 200},
                                {"serverContext", Dictionary{{"minCallbackIntervalInMS", kInterval * 1000.0}}},
                                {"emails", std::move(handles)},
                                {"locations", std::move(entries)}});
}

/// The parts of a round, in milliseconds, in the order in which they happen.
class Parts {
  public:
    void add(const char* name, double milliseconds) {
        if (!times_.contains(name)) {
            names_.emplace_back(name);
        }
        times_[name].push_back(milliseconds);
    }
    double median(const std::string& name) {
        auto& all = times_[name];
        std::sort(all.begin(), all.end());
        return all[all.size() / 2];
    }
    void print() {
        for (const std::string& name : names_) {
            const double middle = median(name);
            std::printf("  %-34s %8.3f ms (median), %8.3f at most\n", name.c_str(), middle, times_[name].back());
        }
    }

  private:
    std::vector<std::string> names_;
    std::map<std::string, std::vector<double>> times_;
};

void paint(host::Host& host, const linux_::Palette& palette, QImage& image) {
    image.fill(palette.window);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(kScale, kScale);
    linux_::QtCanvas canvas(painter, palette);
    host.window()->paint(canvas, {0.0, 0.0, kWidth, kScreen});
}

void measure(host::Host& host, const LocationList& friends, BenchTransport& transport) {
    const auto time = std::dynamic_pointer_cast<VirtualTime>(Platform::installed()->mainLoop);
    const auto loop = std::make_shared<BenchLoop>(time);
    Platform::installed()->mainLoop = loop;
    const linux_::Palette palette = linux_::Palette::of(linux_::ColorScheme::Light);
    QImage image(static_cast<int>(kWidth * kScale), static_cast<int>(kScreen * kScale),
                 QImage::Format_ARGB32_Premultiplied);
    constexpr double kReferenceDate = 978307200.0;  // seconds after 1970
    Parts parts;
    std::size_t bytes = 0;
    for (int round = 0; round < kWarmUp + kRounds; ++round) {
        const double ask = timed([&] { time->advance(kInterval); });
        if (transport.waiting.empty()) {
            std::fprintf(stderr, "nothing was asked\n");
            return;
        }
        const auto completion = std::move(transport.waiting.back());
        transport.waiting.clear();
        const double now = (time->now().secondsSinceReferenceDate + kReferenceDate) * 1000.0;
        const std::string body = bodyOf(friends, round, now);
        bytes = body.size();
        HttpAnswer answer;
        answer.status = 200;
        const double decoded = timed([&] { answer.json = std::get<Value>(documents::JsonReader::read(body)); });
        completion(std::move(answer));
        const double rebuilt = timed([&] { time->runPosted(); });
        const double laidOut = timed([&] { host.layOut(kWidth); });
        const double painted = timed([&] { paint(host, palette, image); });
        loop->work();
        if (round < kWarmUp) {
            continue;
        }
        parts.add("asking (main thread)", ask);
        parts.add("JSON (network thread)", decoded);
        parts.add("records and rows (main thread)", rebuilt);
        parts.add("layout (main thread)", laidOut);
        parts.add("painting a screenful (main thread)", painted);
        parts.add("main thread, answer to screen", rebuilt + laidOut + painted);
    }
    std::printf("%zu friends: %zu bytes asked, %zu answered\n", friends.size(), transport.bytesSent, bytes);
    parts.print();
}

int run(const char* file) {
    auto read = host::ScenarioReader(Date{}).readFile(file);
    auto* scenario = std::get_if<host::Scenario>(&read);
    if (scenario == nullptr) {
        std::fprintf(stderr, "%s\n", std::get<documents::DocumentError>(read).text().c_str());
        return 1;
    }
    const auto snippet = std::dynamic_pointer_cast<VAKtrLocationSnippet>(scenario->snippet);
    if (!snippet || !snippet->locations || snippet->locations->empty()) {
        std::fprintf(stderr, "%s: no friends\n", file);
        return 1;
    }
    snippet->searchContext =
        Url("ktrServerContext://serverContext?clientId=bench&minCallbackIntervalInMS=10000&"
            "callbackTimeoutIntervalInMS=100000000&");
    const auto made = bench::hostFor(file, *scenario, host::Host::Time::Virtual);
    if (!made) {
        return 1;
    }
    host::Host& host = *made;
    // The platform is used from the first turn on.
    const auto transport = std::make_shared<BenchTransport>();
    Platform::installed()->httpTransport = transport;
    Platform::installed()->accounts = std::make_shared<BenchAccounts>();
    if (const auto failure = host.addTurn(*scenario)) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return 1;
    }
    host.layOut(kWidth);
    measure(host, *snippet->locations, *transport);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    return bench::runScenario(argc, argv, run);
}
