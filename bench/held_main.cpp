// How long after a fix those hear of it who wait: 1,000 held answers and 1,000 event streams at once, of a service in
// this process, on a store on the disk. Prints milliseconds from before the post to the last byte.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <future>
#include <iostream>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "server/http/BasicCredentials.h"
#include "server/service/Service.h"

namespace {

using namespace ktr::server;
using Clock = std::chrono::steady_clock;

constexpr int kOwners = 100;
constexpr int kViewersEach = 10;
constexpr int kViewers = kOwners * kViewersEach;
constexpr double kDegree = 111230.0;

std::int64_t present() {
    return std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

double memory() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("VmRSS:", 0) == 0) {
            return std::atof(line.c_str() + 6) / 1024.0;
        }
    }
    return 0.0;
}

class Client {
  public:
    explicit Client(int port) : descriptor_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_port = htons(static_cast<std::uint16_t>(port));
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        const int yes = 1;
        ::setsockopt(descriptor_, IPPROTO_TCP, TCP_NODELAY, &yes, sizeof yes);
        if (::connect(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
            std::perror("connect");
            std::exit(EXIT_FAILURE);
        }
    }
    ~Client() { ::close(descriptor_); }
    Client(const Client&) = delete;
    Client& operator=(const Client&) = delete;
    int descriptor() const { return descriptor_; }
    void send(const std::string& bytes) const { ::send(descriptor_, bytes.data(), bytes.size(), MSG_NOSIGNAL); }
    /// Takes what has come; true when `end` is in it, which is then forgotten.
    bool takes(const char* end) {
        char block[8192];
        const ssize_t count = ::recv(descriptor_, block, sizeof block, MSG_DONTWAIT);
        text_.append(block, count > 0 ? static_cast<std::size_t>(count) : 0);
        const std::size_t at = text_.find(end);
        if (at == std::string::npos) {
            return false;
        }
        text_.erase(0, at + std::string(end).size());
        return true;
    }
    void wait(const char* end) {
        while (!takes(end)) {
            pollfd one{descriptor_, POLLIN, 0};
            ::poll(&one, 1, 1000);
        }
    }

  private:
    int descriptor_;
    std::string text_;
};

std::string owner(int number) {
    return "owner" + std::to_string(number);
}
std::string viewer(int number) {
    return "viewer" + std::to_string(number);
}

void post(int port, int number, double metres, std::int64_t time) {
    const std::string body = R"({"_type":"location","tid":"an","acc":10,"lat":)" +
                             std::to_string(50.2 + metres / kDegree) + R"(,"lon":-3.1,"tst":)" + std::to_string(time) +
                             "}";
    Client client(port);
    client.send(
        "POST /pub HTTP/1.1\r\nHost: a\r\nAuthorization: " + BasicCredentials{owner(number), owner(number)}.header() +
        "\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body);
    client.wait("]");
}

std::string question(int number) {
    const std::string body = R"({"clientContext":{},"handles":[")" + owner(number / kViewersEach) + R"(@x.example"]})";
    return "POST /qloxservice/friends/va/getlocations HTTP/1.1\r\nHost: a\r\nAuthorization: " +
           BasicCredentials{viewer(number), viewer(number)}.header() +
           "\r\nX-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\nContent-Type: application/json\r\n"
           "Content-Length: " +
           std::to_string(body.size()) + "\r\n\r\n" + body;
}

bool people(Store& store, std::int64_t now) {
    for (int i = 0; i < kOwners; ++i) {
        const bool good = store.addPerson(owner(i), {owner(i) + "@x.example"}, now) &&
                          store.addDevice(store.personNamed(owner(i))->id, DeviceKind::Phone, owner(i), "", now);
        if (!good) {
            return false;
        }
    }
    for (int i = 0; i < kViewers; ++i) {
        Grant grant{Precision::Exact, now - 3600, std::nullopt};
        grant.fences = true;
        if (!store.addPerson(viewer(i), {}, now)) {
            return false;
        }
        const std::int64_t id = store.personNamed(viewer(i))->id;
        const std::int64_t watched = store.personNamed(owner(i / kViewersEach))->id;
        if (!store.addDevice(id, DeviceKind::Reader, viewer(i), "", now) || !store.grant(watched, id, grant)) {
            return false;
        }
    }
    // Grants begin no earlier than what the store has seen: fences after all of them.
    for (int i = 0; i < kViewers; ++i) {
        const FenceWish wish{store.personNamed(viewer(i))->id,
                             store.personNamed(owner(i / kViewersEach))->id,
                             {"", FenceCircle{50.2, -3.1, 150.0}},
                             true,
                             false};
        std::promise<bool> set;
        store.setFence(wish, now,
                       [&](FenceOutcome outcome, const Fence&) { set.set_value(outcome == FenceOutcome::Set); });
        if (!set.get_future().get()) {
            return false;
        }
    }
    return true;
}

void print(const char* name, std::vector<double>& times) {
    std::sort(times.begin(), times.end());
    const auto at = [&](double share) {
        return times.empty() ? 0.0
                             : times[std::min(times.size() - 1,
                                              static_cast<std::size_t>(share * static_cast<double>(times.size())))];
    };
    std::printf("%-14s %5zu of %d heard; p50 %6.1f  p99 %6.1f  max %6.1f ms\n", name, times.size(), kViewers, at(0.5),
                at(0.99), times.empty() ? 0.0 : times.back());
}

}  // namespace

int main() {
    rlimit limit{};
    ::getrlimit(RLIMIT_NOFILE, &limit);
    limit.rlim_cur = limit.rlim_max;
    ::setrlimit(RLIMIT_NOFILE, &limit);
    const auto folder = std::filesystem::temp_directory_path() / ("ktr-held-" + std::to_string(::getpid()));
    std::string complaint;
    const std::shared_ptr<Store> store = Store::open({(folder / "data").string()}, true, complaint);
    const std::int64_t now = present();
    if (!store || !people(*store, now)) {
        std::cerr << "the people cannot be made: " << complaint << std::endl;
        return EXIT_FAILURE;
    }
    Service::Setup setup;
    setup.http.limits.connections = setup.http.limits.connectionsPerAddress = 8000;
    setup.store = store;
    setup.now = present;
    setup.holdsAnswers = true;
    Service service(std::move(setup));
    if (complaint = service.start(); !complaint.empty()) {
        std::cerr << complaint << std::endl;
        return EXIT_FAILURE;
    }
    for (int i = 0; i < kOwners; ++i) {
        post(service.port(), i, 900.0, now - 200);
        post(service.port(), i, 900.0, now - 100);
    }
    const double before = memory();
    std::vector<std::unique_ptr<Client>> clients;
    for (int i = 0; i < kViewers; ++i) {
        clients.push_back(std::make_unique<Client>(service.port()));
        clients.back()->send("GET /qloxservice/friends/va/events HTTP/1.1\r\nHost: a\r\nAuthorization: " +
                             BasicCredentials{viewer(i), viewer(i)}.header() + "\r\n\r\n");
        clients.back()->wait("retry: 2000");
    }
    for (int i = 0; i < kViewers; ++i) {
        clients.push_back(std::make_unique<Client>(service.port()));
    }
    for (int i = 0; i < kViewers; ++i) {
        clients[static_cast<std::size_t>(kViewers + i)]->send(question(i));
    }
    for (int i = 0; i < kViewers; ++i) {
        clients[static_cast<std::size_t>(kViewers + i)]->wait("emails");
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(1100));
    for (int i = 0; i < kViewers; ++i) {
        clients[static_cast<std::size_t>(kViewers + i)]->send(question(i));
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(1500));
    std::printf("1,000 streams and 1,000 held answers: %.0f MB more, both ends\n", memory() - before);
    std::vector<std::atomic<Clock::rep>> posted(kOwners);
    std::thread phones([&] {
        for (int i = 0; i < kOwners; ++i) {
            posted[static_cast<std::size_t>(i)] = Clock::now().time_since_epoch().count();
            post(service.port(), i, 0.0, now);
            std::this_thread::sleep_for(std::chrono::milliseconds(40));
        }
    });
    std::vector<double> streams, answers;
    std::vector<pollfd> waiting;
    for (const auto& client : clients) {
        waiting.push_back({client->descriptor(), POLLIN, 0});
    }
    const auto end = Clock::now() + std::chrono::seconds(7);
    while (Clock::now() < end && streams.size() + answers.size() < 2 * kViewers) {
        ::poll(waiting.data(), waiting.size(), 100);
        const auto heard = Clock::now();
        for (std::size_t i = 0; i < waiting.size(); ++i) {
            const bool isStream = i < kViewers;
            if ((waiting[i].revents & POLLIN) != 0 && clients[i]->takes(isStream ? "crossing" : "emails")) {
                const auto sent = posted[i % kViewers / kViewersEach].load();
                const auto passed = heard - Clock::time_point(Clock::duration(sent));
                (isStream ? streams : answers)
                    .push_back(sent == 0 ? -1.0 : std::chrono::duration<double, std::milli>(passed).count());
                waiting[i].fd = -1;
            }
        }
    }
    phones.join();
    print("event streams", streams);
    print("held answers", answers);
    clients.clear();
    service.stop();
    std::filesystem::remove_all(folder);
    return EXIT_SUCCESS;
}
