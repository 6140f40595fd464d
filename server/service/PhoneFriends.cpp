#include "server/service/PhoneFriends.h"

#include <cmath>
#include <map>
#include <vector>

#include "platform/base/Json.h"
#include "server/answers/PhoneAnswer.h"
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

std::string PhoneFriends::answer(const Device& device, const Report& report, std::int64_t now) {
    std::vector<PhoneFriend> friends;
    std::vector<std::int64_t> seen;
    std::map<std::int64_t, SentCard> told;
    std::size_t faces = 0;
    const auto cards = store_.cards(device.id, device.person);
    for (const Friend& one : store_.friendsOf(device.person)) {
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
    std::string body = platform::writeJson(PhoneAnswer::messages(friends));
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
