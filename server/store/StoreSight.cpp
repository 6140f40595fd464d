// The part of the store that reads by what people are seen: for many of them in a few ways to the database and back.
#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Of so many people it is known where they rested; some MB at most.
constexpr std::size_t kMostRests = 50000;

/// Five columns: time, heard, latitude, longitude, accuracy.
Fix fixOf(const Database::Run& row) {
    return {row.integer(0), row.integer(1), row.real(2), row.real(3), row.maybeReal(4)};
}

void ask(std::deque<Database::Run>& runs, Database& database, std::int64_t owner, const FixWalk::Question& question) {
    runs.emplace_back(question.edge == FixEdge::Last
                          ? "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 AND "
                            "time >= $2 AND time < $3 AND heard >= $4 AND heard < $5 ORDER BY time DESC LIMIT 1"
                          : "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 AND "
                            "time >= $2 AND time < $3 AND heard >= $4 AND heard < $5 ORDER BY time LIMIT 1",
                      database)
        .bind(owner)
        .bind(question.range.from)
        .bind(question.range.end)
        .bind(question.range.heardFrom)
        .bind(question.range.heardEnd);
}

}  // namespace

LastRest Store::knownRest(const Sight& sight) {
    const std::lock_guard<std::mutex> lock(restMutex_);
    const auto known =
        sight.sharing->grant ? rests_.find({sight.owner, sight.sharing->grant->precision}) : rests_.end();
    return known == rests_.end() ? LastRest{} : known->second;
}

void Store::keepRest(const Sight& sight, const LastRest& rest) {
    const std::lock_guard<std::mutex> lock(restMutex_);
    if (rests_.size() >= kMostRests) {
        rests_.clear();
    }
    rests_[{sight.owner, sight.sharing->grant->precision}] = rest;
}

void Store::forgetRests() {
    const std::lock_guard<std::mutex> lock(restMutex_);
    rests_.clear();
}

void Store::readSights(Database& database, const std::vector<Sight>& sights, std::int64_t now) {
    std::deque<FixWalk> walks;
    for (const Sight& sight : sights) {
        walks.emplace_back(*sight.sharing, now, knownRest(sight), sight.heardLate);
    }
    bool isFirst = true;
    for (bool isOver = false; !isOver; isFirst = false) {
        // Of an ended grant nothing is read: it takes no longer than that of a stranger.
        const auto readsPlaces = [&](const Sight& sight) {
            return isFirst && Visibility::isOpen(*sight.sharing, now) &&
                   Visibility::cellSide(sight.sharing->grant->precision) == 0.0;
        };
        std::deque<Database::Run> runs;
        std::vector<std::size_t> questions;
        for (std::size_t i = 0; i < sights.size(); ++i) {
            if (readsPlaces(sights[i])) {
                askPlaces(runs, database, sights[i].owner);
            }
            const auto all = walks[i].questions();
            questions.push_back(all.size());
            for (const FixWalk::Question& question : all) {
                ask(runs, database, sights[i].owner, question);
            }
        }
        isOver = runs.empty();
        database.fetch(runs);
        for (std::size_t i = 0; i < sights.size(); ++i) {
            if (readsPlaces(sights[i])) {
                sights[i].sharing->places = placesIn(runs.front());
                runs.pop_front();
            }
            std::vector<std::optional<Fix>> answers;
            for (; answers.size() < questions[i]; runs.pop_front()) {
                answers.push_back(runs.front().next() ? std::optional(fixOf(runs.front())) : std::nullopt);
                fixesRead_ += answers.back() ? 1 : 0;
            }
            if (!answers.empty()) {
                walks[i].take(answers);
            }
        }
    }
    for (std::size_t i = 0; i < sights.size() && !database.failed(); ++i) {
        sights[i].sharing->fixes = walks[i].fixes();
        if (const auto rest = walks[i].found()) {
            keepRest(sights[i], *rest);
        }
    }
}

}  // namespace ktr::server
