#include "server/service/HeldAnswers.h"

#include <utility>

namespace ktr::server {

namespace {

using Seconds = std::chrono::duration<double>;
/// A timer may run a little early.
constexpr double kEarly = 0.9;

}  // namespace

struct HeldAnswers::Held {
    std::string said;
    std::set<std::int64_t> people;
    Maker make;
    HttpReply reply;
    std::mutex looking;  ///< one look at a time
    bool isOver = false;
};

HeldAnswers::~HeldAnswers() {
    {
        const std::lock_guard<std::mutex> lock(alive_->mutex);
        alive_->answers = nullptr;
    }
    release();
}

void HeldAnswers::schedule(double seconds, std::function<void(HeldAnswers&)> what) {
    later_(seconds, [alive = alive_, what = std::move(what)] {
        const std::lock_guard<std::mutex> lock(alive->mutex);
        if (alive->answers != nullptr) {
            what(*alive->answers);
        }
    });
}

bool HeldAnswers::isInTurn(const std::string& client, const std::string& said, Clock::time_point now) const {
    const auto last = last_.find(client);
    if (last == last_.end() || last->second.said != said || held_.count(client) != 0 || held_.size() >= kMostHeld) {
        return false;
    }
    const double age = Seconds(now - last->second.time).count();
    return age >= kAskAgain * kEarly && age <= kAskAgain + kGrace;
}

void HeldAnswers::give(const std::string& client, const Maker& make, const HttpReply& reply) {
    const Answer first = make();
    std::shared_ptr<Held> held;
    if (!first.people.empty()) {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (isInTurn(client, first.said, Clock::now())) {
            held.reset(new Held{first.said, first.people, make, reply, {}, false});
            held_[client] = held;
            for (const std::int64_t person : first.people) {
                clients_.emplace(person, client);
            }
        }
    }
    if (!held) {
        return answer(client, first, reply);
    }
    schedule(kMost, [client, weak = std::weak_ptr(held)](HeldAnswers& self) {
        if (const auto one = weak.lock()) {
            self.look(client, one, true);
        }
    });
    // What changed before it was held told nobody.
    look(client, held, false);
}

void HeldAnswers::answer(const std::string& client, const Answer& answer, const HttpReply& reply) {
    if (!answer.people.empty()) {
        const auto now = Clock::now();
        const std::lock_guard<std::mutex> lock(mutex_);
        if (now - forgotten_ > Seconds(1.0)) {
            forgotten_ = now;
            std::erase_if(last_,
                          [&](const auto& one) { return Seconds(now - one.second.time).count() > kAskAgain + kGrace; });
        }
        last_[client] = {answer.said, now};
    }
    answer.give(reply);
}

void HeldAnswers::look(const std::string& client, const std::shared_ptr<Held>& held, bool isOver) {
    const std::lock_guard<std::mutex> looking(held->looking);
    if (held->isOver) {
        return;
    }
    const Answer now = held->make();
    if (!isOver && now.said == held->said && now.people == held->people) {
        return;
    }
    held->isOver = true;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (const auto place = held_.find(client); place != held_.end() && place->second == held) {
            held_.erase(place);
            for (const std::int64_t person : held->people) {
                const auto [begin, end] = clients_.equal_range(person);
                for (auto one = begin; one != end; ++one) {
                    if (one->second == client) {
                        clients_.erase(one);
                        break;
                    }
                }
            }
        }
    }
    answer(client, now, held->reply);
}

void HeldAnswers::concerns(const Change& change) {
    std::map<std::string, std::shared_ptr<Held>> concerned;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (change.everything) {
            concerned = held_;
        }
        for (const std::int64_t person : change.people) {
            const auto [begin, end] = clients_.equal_range(person);
            for (auto one = begin; one != end; ++one) {
                if (const auto held = held_.find(one->second); held != held_.end()) {
                    concerned.insert(*held);
                }
            }
        }
    }
    for (const auto& [client, held] : concerned) {
        schedule(0.0, [name = client, one = held](HeldAnswers& self) { self.look(name, one, false); });
    }
}

void HeldAnswers::release() {
    std::map<std::string, std::shared_ptr<Held>> all;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        all = held_;
    }
    for (const auto& [client, held] : all) {
        look(client, held, true);
    }
}

std::size_t HeldAnswers::size() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return held_.size();
}

}  // namespace ktr::server
