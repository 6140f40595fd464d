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

bool isNoHandle(const std::string& handle) {
    return handle.empty() || handle.size() > kLongestHandle || handle.find('\0') != std::string::npos;
}

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
    if (wish.with.size() > kMostNamed || std::any_of(wish.with.begin(), wish.with.end(), isNoHandle)) {
        fields.complain("with", "expected at most " + std::to_string(kMostNamed) + " handles");
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
        return tell(device, true, reply);
    }
    // The answer follows the commit.
    const bool hides = wish.kind == Wish::Kind::Hide;
    const bool done = wish.with.empty() ? setup_.store.setHidden(device.person, hides, setup_.now())
                                        : setup_.store.changeRules(device.person, wish.with,
                                                                   {hides, wish.until, wish.precision}, setup_.now());
    // Who sees the person is told to who asks that alone: else a wish for a handle would tell who is at this service.
    done ? tell(device, wish.with.empty(), reply) : reply.send(notWritten());
}

void AskCommands::tell(const Device& device, bool tellsViewers, const HttpReply& reply) const {
    const std::uint64_t failures = setup_.store.readFailures();
    const auto person = setup_.store.person(device.person);
    const auto rules =
        tellsViewers ? setup_.store.grantsOf(device.person) : std::vector<std::pair<std::string, Grant>>();
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
    if (tellsViewers) {
        answer.set("viewers", std::move(viewers));
    }
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
