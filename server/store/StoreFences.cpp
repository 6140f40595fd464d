// The part of the store that watches fences. A fence is looked at in the commit of the fix that crosses it.
#include <algorithm>
#include <future>

#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// As many fixes, at most, tell on which side somebody is when a fence is set.
constexpr std::int64_t kEnoughFixes = 100;

/// What decides whether a fence may stand: of somebody who does not hide, to a viewer.
struct Leave {
    Grant grant;
    std::int64_t since = 0;  ///< fixes from before count for nothing
};

/// Eleven columns of a fence, beginning with its id.
constexpr const char* kFencesOfSubject =
    "SELECT fence.id, fence.watcher, fence.subject, fence.name, fence.label, fence.latitude, fence.longitude, "
    "fence.radius, fence.arrives, fence.once, fence.made, side, candidate, candidate_since, last, doubtful "
    "FROM fence WHERE subject = $1 ORDER BY made, id";

Fence fenceOf(const Database::Run& row) {
    Fence fence;
    fence.id = row.integer(0);
    fence.watcher = row.integer(1);
    fence.subject = row.integer(2);
    fence.name = row.text(3);
    fence.label = row.text(4);
    fence.circle = {row.real(5), row.real(6), row.real(7)};
    fence.arrives = row.integer(8) != 0;
    fence.once = row.integer(9) != 0;
    fence.made = row.integer(10);
    return fence;
}

Fix fixOf(const Database::Run& row) {
    return {row.integer(0), row.integer(1), row.real(2), row.real(3), row.maybeReal(4)};
}

/// A fence with what it remembers: times, of which the fixes are read when they are needed.
struct Watched {
    Fence fence;
    FenceState state;
    std::optional<std::int64_t> last;
    std::optional<std::int64_t> doubtful;
};

std::vector<Watched> watchedOf(Database& database, std::int64_t subject) {
    std::vector<Watched> all;
    auto row = database.statement(kFencesOfSubject);
    row.bind(subject);
    while (row.next()) {
        Watched one{fenceOf(row), {}, row.maybeInteger(14), row.maybeInteger(15)};
        one.state.side = static_cast<FenceSide>(row.integer(11));
        one.state.candidate = static_cast<FenceSide>(row.integer(12));
        one.state.candidateSince = row.integer(13);
        all.push_back(std::move(one));
    }
    return all;
}

std::optional<Fix> fixAt(Database& database, std::int64_t person, const std::optional<std::int64_t>& time) {
    if (!time) {
        return std::nullopt;
    }
    auto row = database.statement(
        "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 AND time = $2");
    return row.bind(person).bind(*time).next() ? std::optional(fixOf(row)) : std::nullopt;
}

/// Those after a moment, of what may count, by ascending time.
std::vector<Fix> fixesAfter(Database& database, std::int64_t person, std::int64_t time, std::int64_t since) {
    std::vector<Fix> fixes;
    auto row = database.statement(
        "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 AND time > $2 AND time >= $3 "
        "AND heard >= $3 ORDER BY time DESC LIMIT $4");
    row.bind(person).bind(time).bind(since).bind(kEnoughFixes);
    while (row.next()) {
        fixes.push_back(fixOf(row));
    }
    std::reverse(fixes.begin(), fixes.end());
    return fixes;
}

void writeState(Database& database, std::int64_t fence, const FenceState& state) {
    const auto timeOf = [](const std::optional<Fix>& fix) { return fix ? std::optional(fix->time) : std::nullopt; };
    database
        .statement(
            "UPDATE fence SET side = $2, candidate = $3, candidate_since = $4, last = $5, doubtful = $6 WHERE id = $1")
        .bind(fence)
        .bind(static_cast<std::int64_t>(state.side))
        .bind(static_cast<std::int64_t>(state.candidate))
        .bind(state.candidateSince)
        .bind(timeOf(state.last))
        .bind(timeOf(state.doubtful))
        .run();
}

bool isCalled(const NamedPlace& place, const std::string& name) {
    return place.said && (place.name == name || (!place.label.empty() && place.label == name));
}

void use(const NamedPlace& place, Fence& fence) {
    fence.name = place.name;
    fence.label = place.label;
    fence.circle = {place.latitude, place.longitude, place.radius};
}

/// Where a fence lies. False: there is no such place, or nobody knows where the subject is.
bool placeFence(const FencePlace& wish, const std::vector<NamedPlace>& places, const std::vector<Fix>& fixes,
                Fence& fence) {
    if (!wish.name.empty()) {
        const auto place =
            std::find_if(places.begin(), places.end(), [&](const NamedPlace& one) { return isCalled(one, wish.name); });
        if (place != places.end()) {
            use(*place, fence);
        }
        return place != places.end();
    }
    if (wish.circle) {
        fence.circle = *wish.circle;
        return true;
    }
    if (fixes.empty()) {
        return false;
    }
    fence.circle = {fixes.back().latitude, fixes.back().longitude};
    if (const NamedPlace* place = NamedPlace::saidAt(places, fixes.back())) {
        use(*place, fence);
    }
    return true;
}

void insert(Database& database, const Fence& fence) {
    database
        .statement(
            "INSERT INTO fence (id, watcher, subject, name, label, latitude, longitude, radius, arrives, once, made) "
            "VALUES ($1, $2, $3, $4, $5, $6, $7, $8, $9, $10, $11)")
        .bind(fence.id)
        .bind(fence.watcher)
        .bind(fence.subject)
        .bind(fence.name)
        .bind(fence.label)
        .bind(fence.circle.latitude)
        .bind(fence.circle.longitude)
        .bind(fence.circle.radius)
        .bind(std::int64_t{fence.arrives})
        .bind(std::int64_t{fence.once})
        .bind(fence.made)
        .run();
}

}  // namespace

void Store::setFence(const FenceWish& wish, std::int64_t now, FenceDone done) {
    const auto outcome = std::make_shared<FenceOutcome>(FenceOutcome::Failed);
    const auto fence = std::make_shared<Fence>();
    write([=, this](Database& database) { *outcome = setFenceIn(database, wish, now, *fence); },
          [=, done = std::move(done)](bool good) { done(good ? *outcome : FenceOutcome::Failed, *fence); });
}

FenceOutcome Store::setFenceIn(Database& database, const FenceWish& wish, std::int64_t now, Fence& fence) {
    const std::int64_t latest = present(now);
    // Whoever ends the grant at this moment waits, or has ended it.
    database.statement("UPDATE share SET fences = fences WHERE owner = $1 AND viewer = $2")
        .bind(wish.subject)
        .bind(wish.watcher)
        .run();
    const auto grant = readGrant(database, wish.subject, wish.watcher);
    std::int64_t since = 0;
    {
        auto row = database.statement("SELECT shown_since FROM person WHERE id = $1 AND hidden = 0");
        if (!row.bind(wish.subject).next() || !grant || !grant->tells(latest) || wish.subject == wish.watcher) {
            return FenceOutcome::Refused;
        }
        since = std::max(row.integer(0), grant->from);
    }
    fence = {0, wish.watcher, wish.subject, "", "", {}, wish.arrives, wish.once, latest};
    const auto places = readPlaces(database, wish.subject);
    const auto fixes = fixesAfter(database, wish.subject, 0, since);
    if (!placeFence(wish.place, places, fixes, fence)) {
        return FenceOutcome::NoPlace;
    }
    fence.circle.radius = std::clamp(fence.circle.radius, FenceCircle::kLeastRadius, FenceCircle::kMostRadius);
    int count = 0;
    for (const Watched& other : watchedOf(database, wish.subject)) {
        if (other.fence.watcher != wish.watcher) {
            continue;
        }
        ++count;
        Fence same = fence;
        same.id = other.fence.id;
        same.made = other.fence.made;
        if (same == other.fence) {
            fence = same;
            return FenceOutcome::Set;
        }
    }
    if (count >= kMostFences) {
        return FenceOutcome::TooMany;
    }
    fence.id = Secret::number();
    insert(database, fence);
    // It begins on the side where the subject is: what it says first is a crossing, not where somebody has been.
    FenceState state;
    for (const Fix& fix : fixes) {
        FenceRules::take(fence.circle, state, fix);
    }
    writeState(database, fence.id, state);
    return FenceOutcome::Set;
}

void Store::watchFences(Database& database, std::int64_t subject, const std::vector<Fix>& fixes, std::int64_t now) {
    auto all = watchedOf(database, subject);
    if (all.empty()) {
        return;
    }
    const std::int64_t latest = present(now);
    std::int64_t shownSince = 0;
    {
        auto row = database.statement("SELECT shown_since, hidden FROM person WHERE id = $1");
        if (!row.bind(subject).next() || row.integer(1) != 0) {
            return;
        }
        shownSince = row.integer(0);
    }
    const auto first = std::min_element(fixes.begin(), fixes.end(),
                                        [](const Fix& one, const Fix& other) { return one.time < other.time; });
    for (Watched& one : all) {
        const auto grant = readGrant(database, subject, one.fence.watcher);
        if (!grant || !grant->tells(latest)) {
            endFencesIn(database, subject, one.fence.watcher);
            continue;
        }
        const std::int64_t since = std::max(shownSince, grant->from);
        one.state.last = fixAt(database, subject, one.last);
        one.state.doubtful = fixAt(database, subject, one.doubtful);
        std::int64_t after = std::max(one.last.value_or(0), one.doubtful.value_or(0));
        if (after > fixes.back().heard + FenceRules::kMostAhead) {
            // The clock has been set back: what comes now is new.
            after = first->time - 1;
        }
        bool isOver = false;
        for (const Fix& fix : fixesAfter(database, subject, after, since)) {
            for (const FenceCrossing& crossing : FenceRules::take(one.fence.circle, one.state, fix)) {
                const bool isMeant = !isOver && crossing.arrives == one.fence.arrives;
                if (isMeant && crossing.time + FenceEvent::kLasts <= latest) {
                    ++droppedEvents_;
                } else if (isMeant) {
                    tellOf(database, one.fence, crossing);
                    isOver = one.fence.once;
                }
            }
        }
        if (isOver) {
            database.statement("DELETE FROM fence WHERE id = $1").bind(one.fence.id).run();
        } else {
            writeState(database, one.fence.id, one.state);
        }
    }
}

void Store::endFencesIn(Database& database, std::int64_t subject, std::optional<std::int64_t> watcher) {
    if (watcher) {
        database.statement("DELETE FROM fence WHERE subject = $1 AND watcher = $2").bind(subject).bind(*watcher).run();
        database.statement("DELETE FROM outbox WHERE subject = $1 AND watcher = $2").bind(subject).bind(*watcher).run();
        return;
    }
    database.statement("DELETE FROM fence WHERE subject = $1").bind(subject).run();
    database.statement("DELETE FROM outbox WHERE subject = $1").bind(subject).run();
}

void Store::endFence(std::int64_t person, std::int64_t id, std::function<void(FenceOutcome)> done) {
    const auto ended = std::make_shared<bool>(false);
    write(
        [=](Database& database) {
            database.statement("DELETE FROM fence WHERE id = $1 AND (watcher = $2 OR subject = $2)")
                .bind(id)
                .bind(person)
                .run();
            *ended = database.changes() > 0;
        },
        [=, done = std::move(done)](bool good) {
            done(!good ? FenceOutcome::Failed : *ended ? FenceOutcome::Set : FenceOutcome::Refused);
        });
}

FenceOutcome Store::endFence(std::int64_t person, std::int64_t id) {
    std::promise<FenceOutcome> ended;
    endFence(person, id, [&](FenceOutcome outcome) { ended.set_value(outcome); });
    return ended.get_future().get();
}

std::optional<std::vector<FenceFacts>> Store::fences(std::int64_t person, const char* sql) {
    const Reading reading(*this);
    std::vector<FenceFacts> all;
    auto row = reading->statement(sql);
    row.bind(person);
    while (row.next()) {
        FenceFacts facts{fenceOf(row), row.text(11), row.text(12)};
        const std::int64_t latest = present(row.integer(13));
        // A grant may have ended by the clock alone.
        if (grantOf(row, 14).tells(latest)) {
            all.push_back(std::move(facts));
        }
    }
    return reading->failed() ? std::nullopt : std::optional(std::move(all));
}

std::optional<std::vector<FenceFacts>> Store::fencesBy(std::int64_t watcher) {
    return fences(watcher,
                  "SELECT fence.id, fence.watcher, fence.subject, fence.name, label, latitude, longitude, radius, "
                  "arrives, once, fence.made, person.name, "
                  "coalesce((SELECT shown FROM handle WHERE handle.person = subject ORDER BY place LIMIT 1), ''), "
                  "(SELECT latest FROM clock), exactness, since, until, arrival, aloud, confirmed, fences "
                  "FROM fence JOIN person ON person.id = subject "
                  "JOIN share ON share.owner = subject AND share.viewer = watcher "
                  "WHERE watcher = $1 AND hidden = 0 ORDER BY fence.made, fence.id");
}

std::optional<std::vector<FenceFacts>> Store::fencesAbout(std::int64_t subject) {
    return fences(subject,
                  "SELECT fence.id, fence.watcher, fence.subject, fence.name, label, latitude, longitude, radius, "
                  "arrives, once, fence.made, person.name, "
                  "coalesce((SELECT shown FROM handle WHERE handle.person = watcher ORDER BY place LIMIT 1), ''), "
                  "(SELECT latest FROM clock), exactness, since, until, arrival, aloud, confirmed, fences "
                  "FROM fence JOIN person ON person.id = watcher "
                  "JOIN share ON share.owner = subject AND share.viewer = watcher "
                  "WHERE subject = $1 ORDER BY fence.made, fence.id");
}

}  // namespace ktr::server
