#include "server/service/AskCommands.h"

#include <algorithm>
#include <cmath>

#include "documents/FieldReader.h"
#include "platform/base/Json.h"
#include "server/answers/CommandRequest.h"
#include "server/answers/LocationAnswers.h"
#include "server/rules/Visibility.h"

namespace ktr::server {

using documents::Complaints;
using documents::FieldReader;
using platform::Dictionary;
using platform::Value;

namespace {

constexpr double kMillisecondsASecond = 1000.0;
/// Nobody names more people in one wish.
constexpr std::size_t kMostNamed = 50;
/// Bytes.
constexpr std::size_t kLongestHandle = 254;
/// Moments that whole seconds can tell.
constexpr double kLatest = 1e15;

HttpResponse notWritten() {
    return refusal(503, "the store cannot be written");
}

HttpResponse notRead() {
    return refusal(503, "the store cannot be read");
}

}  // namespace

std::optional<AskCommands::Wish> AskCommands::read(const Dictionary& body, std::string& complaint) {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    Wish wish;
    if (!fields.object("clientContext", [](FieldReader& context) { context.leaveOthers(); })) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    const std::string kind = fields.string("wish").value_or("");
    wish.kind = kind == "hide" ? Wish::Kind::Hide : kind == "share" ? Wish::Kind::Share : Wish::Kind::Read;
    if (!complaints && kind != "read" && wish.kind == Wish::Kind::Read) {
        fields.complain("wish", R"(expected "read", "hide" or "share")");
    }
    wish.with = fields.texts("with");
    if (wish.with.size() > kMostNamed) {
        fields.complain("with", "expected at most " + std::to_string(kMostNamed));
    }
    if (const auto until = fields.number("until", 0.0, kLatest)) {
        wish.until = static_cast<std::int64_t>(std::floor(*until / kMillisecondsASecond));
    }
    if (const auto word = fields.string("precision")) {
        wish.precision = precisionOf(*word);
        if (!wish.precision) {
            fields.complain("precision", R"(expected "exact", "1km", "town" or "places")");
        }
    }
    const bool isOfRule = wish.until || wish.precision;
    if (!complaints && isOfRule && (wish.kind != Wish::Kind::Share || wish.with.empty())) {
        fields.complain("with", "expected whom an end or a precision is for");
    }
    complaint = complaints ? complaints->path.text() + ": " + complaints->message : "";
    return complaint.empty() ? std::optional(std::move(wish)) : std::nullopt;
}

bool AskCommands::answer(const std::string& command, const Device& device, const Dictionary& body,
                         const HttpReply& reply) const {
    if (command == "places") {
        places(device, reply);
        return true;
    }
    if (command == "friends") {
        friends(device, reply);
        return true;
    }
    if (command == "askToShare") {
        askToShare(device, body, reply);
        return true;
    }
    if (command != "sharing") {
        return false;
    }
    std::string complaint;
    const auto wish = read(body, complaint);
    if (!wish) {
        reply.send(refusal(400, complaint));
        return true;
    }
    sharing(device, *wish, reply);
    return true;
}

void AskCommands::askToShare(const Device& device, const Dictionary& body, const HttpReply& reply) const {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    if (!fields.object("clientContext", [](FieldReader& context) { context.leaveOthers(); })) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    const auto handles = fields.texts("handles");
    const auto isNoHandle = [](const std::string& handle) {
        return handle.empty() || handle.size() > kLongestHandle || handle.find('\0') != std::string::npos;
    };
    if (handles.empty() || handles.size() > kMostNamed || std::any_of(handles.begin(), handles.end(), isNoHandle)) {
        fields.complain("handles", "expected 1 to " + std::to_string(kMostNamed) + " handles");
    }
    if (complaints) {
        return reply.send(refusal(400, complaints->path.text() + ": " + complaints->message));
    }
    switch (setup_.store.askToSee(device.person, handles, setup_.now())) {
        case AskOutcome::Failed:
            return reply.send(notWritten());
        case AskOutcome::TooMany:
            return reply.send(refusal(429, "so many were asked today already"));
        case AskOutcome::Asked:
            break;
    }
    reply.send(HttpResponse::json(200, platform::writeJson(Dictionary{{"statusCode", 200}})));
}

void AskCommands::sharing(const Device& device, const Wish& wish, const HttpReply& reply) const {
    if (wish.kind == Wish::Kind::Read) {
        return tell(device, reply);
    }
    if (!wish.with.empty()) {
        return changeRules(device, wish, reply);
    }
    // The answer follows the commit.
    const bool done = setup_.store.setHidden(device.person, wish.kind == Wish::Kind::Hide, setup_.now());
    done ? tell(device, reply) : reply.send(notWritten());
}

bool AskCommands::isTakenBack(std::int64_t owner, std::int64_t viewer) const {
    if (setup_.store.revokeGrant(owner, viewer)) {
        return true;
    }
    // There was none, or it could not be ended.
    const std::uint64_t failures = setup_.store.readFailures();
    const auto left = setup_.store.sharing(viewer, owner);
    return left && !left->grant && setup_.store.readFailures() == failures;
}

void AskCommands::changeRules(const Device& device, const Wish& wish, const HttpReply& reply) const {
    const std::uint64_t failures = setup_.store.readFailures();
    std::vector<std::int64_t> viewers;
    for (const std::string& handle : wish.with) {
        const auto viewer = setup_.store.personOf(handle);
        if (setup_.store.readFailures() != failures) {
            return reply.send(notRead());
        }
        if (!viewer || *viewer == device.person) {
            return reply.send(refusal(404, "the service has nobody else with this handle"));
        }
        viewers.push_back(*viewer);
    }
    const auto now = setup_.store.present(setup_.now());
    const auto rules = setup_.store.grantsOf(device.person);
    for (const std::int64_t viewer : viewers) {
        if (wish.kind == Wish::Kind::Hide) {
            if (!isTakenBack(device.person, viewer)) {
                return reply.send(notWritten());
            }
            continue;
        }
        const auto person = setup_.store.person(viewer);
        const auto before = std::find_if(rules.begin(), rules.end(),
                                         [&](const auto& rule) { return person && rule.first == person->name; });
        // What was agreed with this viewer before stays, but for what the wish names.
        Grant rule;
        rule.from = now;
        if (before != rules.end() && before->second.end() > now) {
            rule = before->second;
        } else if (before != rules.end()) {
            // Of what is over no leave comes back by itself, and nothing from before is seen.
            rule.precision = before->second.precision;
        }
        rule.precision = wish.precision.value_or(rule.precision);
        rule.until = wish.until;
        rule.arrival = 0;
        rule.confirmed = now;
        if (!person || !setup_.store.grant(device.person, viewer, rule)) {
            return reply.send(notWritten());
        }
    }
    tell(device, reply);
}

void AskCommands::tell(const Device& device, const HttpReply& reply) const {
    const std::uint64_t failures = setup_.store.readFailures();
    const auto person = setup_.store.person(device.person);
    const auto rules = setup_.store.grantsOf(device.person);
    if (!person || setup_.store.readFailures() != failures) {
        return reply.send(notRead());
    }
    const auto handle = std::find_if(person->handles.begin(), person->handles.end(),
                                     [](const std::string& one) { return one.find('@') != std::string::npos; });
    Dictionary answer =
        LocationAnswers::sharing(person->hidden, handle == person->handles.end() ? "" : *handle, std::nullopt, {}, 0);
    answer.set("hidden", person->hidden);
    Value::Array viewers;
    for (const auto& [name, rule] : rules) {
        if (rule.end() <= setup_.now()) {
            continue;
        }
        Dictionary viewer{{"name", name}, {"precision", wordOf(rule.precision)}};
        if (rule.until) {
            viewer.set("until", *rule.until * 1000);
        }
        viewers.emplace_back(std::move(viewer));
    }
    answer.set("viewers", std::move(viewers));
    reply.send(HttpResponse::json(200, platform::writeJson(answer)));
}

void AskCommands::places(const Device& device, const HttpReply& reply) const {
    const std::uint64_t failures = setup_.store.readFailures();
    Value::Array places;
    for (const NamedPlace& place : setup_.store.placesOf(device.person)) {
        const bool isSort = !place.label.empty() && place.label != "other";
        for (const std::string& name : {place.name, isSort ? "_$!<" + place.label + ">!$_" : std::string()}) {
            if (!name.empty()) {
                places.emplace_back(
                    Dictionary{{"name", name}, {"latitude", place.latitude}, {"longitude", place.longitude}});
            }
        }
    }
    if (setup_.store.readFailures() != failures) {
        return reply.send(notRead());
    }
    reply.send(
        HttpResponse::json(200, platform::writeJson(Dictionary{{"statusCode", 200}, {"places", std::move(places)}})));
}

void AskCommands::friends(const Device& device, const HttpReply& reply) const {
    const std::uint64_t failures = setup_.store.readFailures();
    const std::int64_t now = setup_.now();
    Value::Array friends;
    for (const Friend& one : setup_.store.friendsOf(device.person, now)) {
        const auto person =
            Visibility::visible(one.sharing, now) ? setup_.store.person(one.person) : std::optional<Person>();
        if (person && !person->handles.empty()) {
            friends.emplace_back(Dictionary{{"name", person->name}, {"handle", person->handles.front()}});
        }
    }
    if (setup_.store.readFailures() != failures) {
        return reply.send(notRead());
    }
    reply.send(
        HttpResponse::json(200, platform::writeJson(Dictionary{{"statusCode", 200}, {"friends", std::move(friends)}})));
}

}  // namespace ktr::server
