#include "server/service/PhoneFriends.h"

#include <cmath>

#include "platform/base/Json.h"
#include "server/ingest/FixRules.h"
#include "server/ingest/SealedText.h"

namespace ktr::server {

namespace {

constexpr double kLargestTime = 1.0e12;

/// By which a post is known when it comes again: the time of its fix; 0 without one.
std::int64_t postOf(const Report& report) {
    const auto time = report.fixes.empty() ? std::nullopt : report.fixes.back().time;
    return time && *time > 0.0 && *time < kLargestTime ? static_cast<std::int64_t>(std::floor(*time)) : 0;
}

}  // namespace

std::string PhoneFriends::titleOf(const Person& person, std::int64_t now) {
    Sharing sharing;
    sharing.hidden = person.hidden;
    sharing.latest = store_.present(now);
    std::string viewers;
    for (const auto& [viewer, grant] : store_.grantsOf(person.id)) {
        sharing.grant = grant;
        if (Visibility::isOpen(sharing, now)) {
            viewers += (viewers.empty() ? "" : ", ") + viewer;
        }
    }
    return person.name + ", seen by " + (viewers.empty() ? "nobody" : viewers);
}

void PhoneFriends::addOwn(const Device& device, const Report& report, std::int64_t now,
                          std::vector<PhoneFriend>& friends, std::map<std::int64_t, SentCard>& told) {
    const auto person = store_.person(device.person);
    if (!person) {
        return;
    }
    PhoneFriend own{person->name, std::nullopt};
    // Apps show a friend who has a place: where it just said that it is. While hidden nothing goes back and forth.
    if (!report.fixes.empty() && !person->hidden) {
        if (const auto fix = FixRules::admit(report.fixes.back(), now).fix) {
            own.seen = Seen{fix->latitude, fix->longitude, fix->accuracy, fix->time};
        }
    }
    own.title = titleOf(*person, now);
    const std::string hash = PhoneAnswer::cardHash(own.title, "");
    own.withCard = PhoneAnswer::isCardDue(store_.sentCard(device.id, person->id), hash, now, postOf(report));
    if (own.withCard) {
        told[person->id] = {hash, now, postOf(report)};
    }
    friends.push_back(std::move(own));
}

std::vector<FenceEvent> PhoneFriends::eventsFor(const Device& device, const Report& report, std::int64_t now) {
    const std::int64_t post = postOf(report);
    // A post by which nobody knows it again would be told twice, or never.
    if (!device.holdsEvents || post == 0) {
        return {};
    }
    auto events = store_.eventsFor(device.id, 0, now, kMostEvents).value_or(std::vector<FenceEvent>());
    const std::int64_t last = events.empty() ? 0 : events.back().number;
    std::erase_if(events, [post](const FenceEvent& event) { return event.post != 0 && event.post != post; });
    if (last > 0) {
        store_.noteEvents(device.id, last, post);
    }
    return events;
}

std::string PhoneFriends::answer(const Device& device, const Report& report, std::int64_t now, bool isToReport) {
    std::vector<PhoneFriend> friends;
    std::vector<std::int64_t> seen;
    std::map<std::int64_t, SentCard> told;
    std::size_t faces = 0;
    const auto cards = store_.cards(device.id, device.person);
    for (const Friend& one : store_.friendsOf(device.person, now)) {
        const auto what = Visibility::visible(one.sharing, now);
        if (!what) {
            continue;
        }
        seen.push_back(one.person);
        friends.push_back({one.name, *what});
        const auto state = cards.find(one.person);
        if (state == cards.end()) {
            continue;  // the grant ended in this moment
        }
        const std::string hash = PhoneAnswer::cardHash(one.name, state->second.faceHash);
        if (faces >= kMostFaces || !PhoneAnswer::isCardDue(state->second.sent, hash, now, postOf(report))) {
            continue;
        }
        PhoneFriend& friend_ = friends.back();
        friend_.withCard = true;
        friend_.face = state->second.faceHash.empty() ? "" : store_.face(one.person).value_or("");
        faces += friend_.face.size();
        told[one.person] = {hash, now, postOf(report)};
    }
    if (device.shared) {
        addOwn(device, report, now, friends, told);
    }
    auto messages = PhoneAnswer::messages(friends);
    for (platform::Value& transition : PhoneAnswer::transitions(eventsFor(device, report, now))) {
        messages.push_back(std::move(transition));
    }
    if (isToReport) {
        messages.emplace_back(PhoneAnswer::reportNow());
    }
    std::string body = platform::writeJson(messages);
    if (report.sealed) {
        const auto box = SealedText::seal(body, device.key);
        // Nothing in the clear to a phone that seals.
        body = box ? platform::writeJson(platform::Dictionary{{"_type", "encrypted"}, {"data", *box}}) : "[]";
    }
    if (!told.empty()) {
        store_.noteCards(device.id, std::move(told), nullptr);
    }
    if (!seen.empty()) {
        store_.noteLooks(device.person, std::move(seen), false, now, nullptr);
    }
    return body;
}

}  // namespace ktr::server
