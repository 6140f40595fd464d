// A store under load, without the network in front of it: posts of many threads that each wait for their commit, and
// looks at a hundred friends, half of them seen exactly, half by town, who never rest. Prints a table. Arguments: the
// store's address (a new folder, or "postgresql://…"; a folder in /tmp), and how many stores stand for as many
// processes.
#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <future>
#include <iostream>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "server/store/Database.h"
#include "server/store/Store.h"
#include "server/store/StoreAddress.h"

namespace {

using Clock = std::chrono::steady_clock;
using ktr::server::Fix;
using ktr::server::Grant;
using ktr::server::Precision;
using ktr::server::Store;
using Stores = std::vector<std::unique_ptr<Store>>;

constexpr int kPeople = 200;
constexpr int kFriends = 100;
constexpr int kThreads = 64;
constexpr double kSeconds = 8.0;
constexpr std::int64_t kNow = 1763760300;

/// Milliseconds of each call, and how many there were a second.
void print(const char* what, std::vector<double> all, double seconds) {
    std::sort(all.begin(), all.end());
    const auto at = [&](double share) {
        return all[std::min(all.size() - 1, static_cast<std::size_t>(share * static_cast<double>(all.size())))];
    };
    if (!all.empty()) {
        std::printf("%-44s %9.0f/s  p50 %6.1f  p99 %6.1f  longest %6.1f ms\n", what,
                    static_cast<double>(all.size()) / seconds, at(0.5), at(0.99), all.back());
    }
}

/// Calls again and again on so many threads; `call` knows which thread it is on.
std::vector<double> times(int threads, const std::function<void(int)>& call) {
    std::vector<std::vector<double>> each(static_cast<std::size_t>(threads));
    std::vector<std::thread> running;
    const auto end = Clock::now() + std::chrono::duration<double>(kSeconds);
    for (int thread = 0; thread < threads; ++thread) {
        running.emplace_back([&, thread] {
            for (auto begin = Clock::now(); begin < end; begin = Clock::now()) {
                call(thread);
                each[static_cast<std::size_t>(thread)].push_back(
                    std::chrono::duration<double, std::milli>(Clock::now() - begin).count());
            }
        });
    }
    for (std::thread& one : running) {
        one.join();
    }
    std::vector<double> all;
    for (const auto& some : each) {
        all.insert(all.end(), some.begin(), some.end());
    }
    return all;
}

bool keep(Store& store, std::int64_t person, std::vector<Fix> fixes, std::int64_t now) {
    std::promise<bool> written;
    store.keep(0, person, std::move(fixes), now, [&](bool good) { written.set_value(good); });
    return written.get_future().get();
}

/// The people's numbers; the last one sees the first hundred.
std::vector<std::int64_t> populate(Store& store) {
    std::vector<std::int64_t> people;
    const std::int64_t begin = kNow - 2 * 86400;
    for (int i = 0; i < kPeople; ++i) {
        const std::string name = "p" + std::to_string(i);
        if (!store.addPerson(name, {name + "@x.example"}, begin)) {
            return {};
        }
        people.push_back(store.personNamed(name)->id);
    }
    for (int i = 0; i < kFriends; ++i) {
        const std::int64_t person = people[static_cast<std::size_t>(i)];
        store.grant(person, people.back(), {i % 2 == 0 ? Precision::Exact : Precision::Town, begin, std::nullopt});
        std::vector<Fix> fixes;
        for (std::int64_t time = begin + 3600; time < kNow - 1800; time += 300) {
            fixes.push_back({time, time, 50.0, -3.0 + 0.03 * static_cast<double>(fixes.size()), 12.0});
        }
        if (!keep(store, person, std::move(fixes), kNow - 1800)) {
            return {};
        }
        for (std::int64_t time = kNow - 1800; time < kNow; time += 300) {
            keep(store, person, {{time, time, 50.0, static_cast<double>(time % 100000) / 1000.0, 12.0}}, time);
        }
    }
    return people;
}

double milliseconds(const std::function<void()>& call) {
    const auto begin = Clock::now();
    call();
    return std::chrono::duration<double, std::milli>(Clock::now() - begin).count();
}

void lookBesideBare(const std::function<void()>& look, ktr::server::Database& database) {
    std::vector<double> looks;
    std::vector<double> bare;
    const auto end = Clock::now() + std::chrono::duration<double>(kSeconds);
    while (Clock::now() < end) {
        looks.push_back(milliseconds(look));
        bare.push_back(milliseconds([&] { database.statement("SELECT 1").next(); }));
    }
    print("looks at 100 friends, one after the other", looks, kSeconds);
    print("a bare question after each of them", bare, kSeconds);
}

}  // namespace

int main(int count, char** arguments) {
    std::string folder = (std::filesystem::temp_directory_path() / "ktr-bench-store").string();
    const std::string address = count > 1 ? arguments[1] : folder;
    const int processes = count > 2 ? std::atoi(arguments[2]) : 1;
    std::string complaint;
    Stores stores;
    for (int i = 0; i < processes; ++i) {
        stores.push_back(Store::open({address}, true, complaint));
        if (!stores.back()) {
            std::cerr << complaint << "\n";
            return 1;
        }
    }
    const auto people = populate(*stores.front());
    if (people.empty()) {
        std::cerr << address << ": is no new store\n";
        return 1;
    }
    const auto storeOf = [&](int thread) -> Store& { return *stores[static_cast<std::size_t>(thread % processes)]; };
    std::vector<std::string> handles;
    for (int i = 0; i < kFriends; ++i) {
        handles.push_back("p" + std::to_string(i) + "@x.example");
    }
    const auto look = [&](int thread) { storeOf(thread).asked(people.back(), handles, kNow); };
    for (int process = 0; process < processes; ++process) {
        print("the first look of a process", {milliseconds([&] { look(process); })}, 1);
    }
    lookBesideBare([&] { look(0); }, *ktr::server::StoreAddress{address}.connect(complaint));
    std::atomic<std::int64_t> step = 0;
    std::atomic<int> failures = 0;
    // Of those at whom nobody looks.
    const auto post = [&](int thread) {
        const std::int64_t number = step++;
        const auto person = static_cast<std::size_t>(kFriends + number % (kPeople - kFriends));
        const Fix fix{kNow + number / (kPeople - kFriends), kNow + number / (kPeople - kFriends), 50.0, -3.0, 12.0};
        failures += keep(storeOf(thread), people[person], {fix}, fix.heard) ? 0 : 1;
    };
    print("posts of 64 threads", times(kThreads, post), kSeconds);
    std::printf("%d posts failed\n", failures.load());
    stores.clear();
    if (count <= 1) {
        std::filesystem::remove_all(folder);
    }
    return failures == 0 ? 0 : 1;
}
