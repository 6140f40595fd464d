// A service of one's own under load: `ktr-service` itself, in a process of its own, over TLS and over its socket, with
// every answer behind its commit. Prints a table. An optional argument: how many people it knows (10,000).
#include <fcntl.h>
#include <openssl/ssl.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "bench/ServiceClient.h"
#include "server/admin/Administration.h"
#include "server/http/BasicCredentials.h"
#include "server/store/Store.h"

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;
using ktr::bench::postOf;
using ktr::bench::ServiceClient;
using std::chrono::duration;

constexpr int kFriends = 100;
constexpr double kSeconds = 8.0;
const std::string kPath = "/qloxservice/friends/va/getlocations";

std::int64_t present() {
    return std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

/// Milliseconds.
struct Times {
    std::vector<double> all;
    int failures = 0;

    double at(double share) {
        std::sort(all.begin(), all.end());
        return all.empty()
                   ? 0.0
                   : all[std::min(all.size() - 1, static_cast<std::size_t>(share * static_cast<double>(all.size())))];
    }
    void add(const Times& other) {
        all.insert(all.end(), other.all.begin(), other.all.end());
        failures += other.failures;
    }
};

struct World {
    fs::path folder;
    std::string socket;
    int port = 0;
    pid_t process = -1;
    std::vector<std::string> phones;  ///< credentials
    std::string reader;
    std::atomic<std::int64_t> step = 0;

    /// A fix that nobody sent before.
    std::string post() {
        const std::int64_t number = step++;
        const auto count = static_cast<std::int64_t>(phones.size());
        const std::int64_t time = present() - 86400 + number / count;
        return postOf("/pub", phones[static_cast<std::size_t>(number % count)],
                      R"({"_type":"location","tid":"an","acc":12,"lat":50.)" + std::to_string(1000 + number % 1000) +
                          R"(,"lon":-3.12,"tst":)" + std::to_string(time) +
                          R"(,"batt":80,"conn":"m","t":"u","vel":0})");
    }
    std::string ask() const {
        std::string handles;
        for (int i = 0; i < kFriends; ++i) {
            handles += (i == 0 ? "\"" : ",\"") + std::string("p") + std::to_string(i) + "@x.example\"";
        }
        return postOf(kPath, reader, R"({"clientContext":{},"handles":[)" + handles + "]}",
                      "X-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\n");
    }
};

/// People with a phone each; the first hundred are seen by the last one, who asks.
bool populate(World& world, int people) {
    using namespace ktr::server;
    std::ostringstream out;
    Administration administration((world.folder / "data").string(), present() - 90000, out);
    if (const std::string complaint = administration.init("localhost", world.port, ""); !complaint.empty()) {
        std::cerr << complaint << "\n";
        return false;
    }
    std::string complaint;
    const auto store = Store::open({(world.folder / "data").string()}, false, complaint);
    std::vector<std::int64_t> ids;
    for (int i = 0; store && i < people; ++i) {
        const std::string name = "p" + std::to_string(i);
        const std::string secret = "bench-secret-" + std::to_string(i);
        if (!store->addPerson(name, {name + "@x.example"}, present() - 90000)) {
            return false;
        }
        ids.push_back(store->personNamed(name)->id);
        store->addDevice(ids.back(), DeviceKind::Phone, secret, "", present());
        world.phones.push_back(BasicCredentials{name, secret}.header());
    }
    if (ids.size() < kFriends + 1) {
        return false;
    }
    for (int i = 0; i < kFriends; ++i) {
        Grant grant;
        grant.from = present() - 90000;
        store->grant(ids[static_cast<std::size_t>(i)], ids.back(), grant);
    }
    store->addDevice(ids.back(), DeviceKind::Reader, "bench-reader", "", present());
    world.reader = BasicCredentials{"p" + std::to_string(people - 1), "bench-reader"}.header();
    return true;
}

bool start(World& world, const std::string& program) {
    int out[2];
    if (::pipe2(out, O_CLOEXEC) != 0) {
        return false;
    }
    world.process = ::fork();
    if (world.process == 0) {
        ::dup2(out[1], STDOUT_FILENO);
        ::execl(program.c_str(), program.c_str(), "--data", (world.folder / "data").c_str(), "serve", "--address",
                "127.0.0.1", "--socket", world.socket.c_str(), nullptr);
        ::_exit(127);
    }
    ::close(out[1]);
    char line[200];
    const bool ready = ::read(out[0], line, sizeof line) > 0;
    ::close(out[0]);
    return ready;
}

std::unique_ptr<ServiceClient> client(const World& world, bool tls) {
    return tls ? std::make_unique<ServiceClient>(world.port, "127.0.0.1")
               : std::make_unique<ServiceClient>(world.socket);
}

/// So many clients, each with a thread, for a while. With a rate the requests of all follow a timetable, and a time
/// counts from when its request was due; without one each client sends when it has its answer.
Times load(const std::function<std::unique_ptr<ServiceClient>()>& make, const std::function<std::string()>& request,
           int clients, double rate, double& achieved) {
    std::vector<Times> parts(static_cast<std::size_t>(clients));
    std::vector<std::thread> threads;
    std::vector<std::unique_ptr<ServiceClient>> connections;
    for (int i = 0; i < clients; ++i) {
        connections.push_back(make());
    }
    const auto begin = Clock::now();
    const auto end = begin + std::chrono::duration_cast<Clock::duration>(duration<double>(kSeconds));
    for (int i = 0; i < clients; ++i) {
        threads.emplace_back([&, i] {
            Times& times = parts[static_cast<std::size_t>(i)];
            ServiceClient& connection = *connections[static_cast<std::size_t>(i)];
            for (int n = 0;; ++n) {
                const auto due = begin + std::chrono::duration_cast<Clock::duration>(duration<double>(
                                             rate > 0.0 ? (static_cast<double>(n) * clients + i) / rate : 0.0));
                if (rate > 0.0) {
                    std::this_thread::sleep_until(due);
                }
                const auto from = rate > 0.0 ? due : Clock::now();
                if (from >= end) {
                    return;
                }
                if (connection.ask(request()) != 200) {
                    ++times.failures;
                    return;
                }
                times.all.push_back(duration<double, std::milli>(Clock::now() - from).count());
            }
        });
    }
    Times all;
    for (std::size_t i = 0; i < threads.size(); ++i) {
        threads[i].join();
        all.add(parts[i]);
    }
    achieved = static_cast<double>(all.all.size()) / duration<double>(Clock::now() - begin).count();
    return all;
}

long residentOf(pid_t process) {
    std::ifstream status("/proc/" + std::to_string(process) + "/status");
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("VmRSS:", 0) == 0) {
            return std::strtol(line.c_str() + 6, nullptr, 10);
        }
    }
    return 0;
}

void row(const std::string& what, const std::string& figures, const std::string& aim, bool met) {
    std::cout << "| " << what << " | " << figures << " | " << aim << " | " << (met ? "met" : "missed") << " |"
              << std::endl;
}

std::string wordsOf(Times& times, double rate) {
    char text[200];
    std::snprintf(text, sizeof text, "%.0f/s; %.1f / %.1f / %.1f ms; %d failed", rate, times.at(0.5), times.at(0.99),
                  times.at(1.0), times.failures);
    return text;
}

void posts(World& world, bool tls) {
    const std::string by = tls ? "HTTPS" : "its socket";
    double rate = 0.0;
    Times timed = load([&] { return client(world, tls); }, [&] { return world.post(); }, 64, 2100.0, rate);
    row("posts as 2,100/s are due, 64 phones, " + by, wordsOf(timed, rate), "2,000/s, p99 50 ms",
        rate >= 2000.0 && timed.at(0.99) <= 50.0 && timed.failures == 0);
    Times most = load([&] { return client(world, tls); }, [&] { return world.post(); }, 64, 0.0, rate);
    row("posts, as many as go, " + by, wordsOf(most, rate), "", rate >= 2000.0 && most.failures == 0);
}

void asks(World& world) {
    double rate = 0.0;
    Times alone = load([&] { return client(world, true); }, [&] { return world.ask(); }, 2, 0.0, rate);
    row("getlocations of 100 friends, 2 readers", wordsOf(alone, rate), "p99 10 ms",
        alone.at(0.99) <= 10.0 && alone.failures == 0);
}

/// 1,000 phones that posted once and keep their connection, 200 clients that send a byte a second.
void crowd(World& world) {
    std::vector<std::unique_ptr<ServiceClient>> idle;
    int answered = 0;
    for (int i = 0; i < 1000; ++i) {
        idle.push_back(std::make_unique<ServiceClient>(world.port, "127.0.1." + std::to_string(1 + i % 10)));
        answered += idle.back()->ask(world.post()) == 200 ? 1 : 0;
    }
    std::atomic<bool> over = false;
    std::thread dripping([&] {
        std::vector<std::unique_ptr<ServiceClient>> slow;
        for (int i = 0; i < 200; ++i) {
            slow.push_back(std::make_unique<ServiceClient>(world.port, "127.0.2." + std::to_string(1 + i % 4)));
        }
        while (!over) {
            for (const auto& one : slow) {
                one->send("G");
            }
            std::this_thread::sleep_for(std::chrono::seconds(1));
        }
    });
    double rate = 0.0;
    Times times = load([&] { return client(world, true); }, [&] { return world.post(); }, 16, 0.0, rate);
    const long resident = residentOf(world.process);
    int still = 0;
    for (const auto& one : idle) {
        still += one->ask(world.post()) == 200 ? 1 : 0;
    }
    over = true;
    dripping.join();
    row("posts beside 1,000 idle phones and 200 that drip, 16 phones", wordsOf(times, rate), "it answers",
        times.failures == 0);
    row("of the 1,000 idle ones, answered before and after", std::to_string(answered) + ", " + std::to_string(still),
        "all", answered == 1000 && still == 1000);
    row("memory with all of them and all people", std::to_string(resident / 1024) + " MB", "60 MB",
        resident <= 60 * 1024);
}

}  // namespace

int main(int count, char** words) {
    const int people = count > 1 ? std::atoi(words[1]) : 10000;
    ::signal(SIGPIPE, SIG_IGN);
    rlimit limit{};
    ::getrlimit(RLIMIT_NOFILE, &limit);
    limit.rlim_cur = limit.rlim_max;
    ::setrlimit(RLIMIT_NOFILE, &limit);
    // Not in memory: what is measured is a disk.
    std::string name = (fs::current_path() / "ktr-service-bench-XXXXXX").string();
    World world;
    world.folder = ::mkdtemp(name.data()) == nullptr ? "" : name;
    world.socket = (fs::temp_directory_path() / ("ktr-bench-" + std::to_string(::getpid()) + ".sock")).string();
    world.port = 20000 + ::getpid() % 20000;
    const auto program = fs::read_symlink("/proc/self/exe").parent_path() / "ktr-service";
    if (world.folder.empty() || !populate(world, people) || !start(world, program.string())) {
        std::cerr << "the service cannot be made or started" << std::endl;
        return 1;
    }
    std::cout << "| " << people << " people | rate; p50 / p99 / longest | aim | |\n|---|---|---|---|" << std::endl;
    posts(world, true);
    posts(world, false);
    asks(world);
    crowd(world);
    ::kill(world.process, SIGTERM);
    int status = 0;
    ::waitpid(world.process, &status, 0);
    fs::remove_all(world.folder);
    return WIFEXITED(status) && WEXITSTATUS(status) == 0 ? 0 : 1;
}
