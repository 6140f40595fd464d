#include "server/answers/FenceRequest.h"

#include <cmath>

#include "documents/FieldReader.h"
#include "platform/base/Json.h"
#include "server/rules/NamedPlace.h"

namespace ktr::server {

using documents::Complaints;
using documents::FieldReader;
using platform::Dictionary;
using platform::Value;

namespace {

std::string sentenceOf(const Complaints& complaints) {
    return complaints ? complaints->path.text() + ": " + complaints->message : std::string();
}

void readContext(FieldReader& fields) {
    if (!fields.object("clientContext", [](FieldReader& context) { context.leaveOthers(); })) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
}

void readPlace(FieldReader& place, FencePlace& read) {
    place.leaveOthers();
    read.name = place.string("name").value_or("");
    const auto latitude = place.number("latitude");
    const auto longitude = place.number("longitude");
    const auto radius = place.number("radius");
    if (!latitude && !longitude && !read.name.empty()) {
        if (!NamedPlace::isName(read.name)) {
            place.complain("name", "expected 1 to 40 letters on one line");
        }
    } else if (!read.name.empty() || !latitude || !longitude || !(std::abs(*latitude) <= 90.0) ||
               !(std::abs(*longitude) <= 180.0) || !(radius.value_or(1.0) > 0.0)) {
        place.complain("", "expected a name alone, or a latitude and a longitude in degrees and a radius in metres");
    } else {
        read.circle = FenceCircle{*latitude, *longitude, radius.value_or(FenceCircle::kAdvisedRadius)};
    }
}

std::string metresOf(double radius) {
    return std::to_string(std::llround(radius)) + " m";
}

}  // namespace

std::optional<FenceRequest> FenceRequest::read(const Dictionary& body, std::string& complaint) {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    FenceRequest request;
    readContext(fields);
    request.handle = fields.string("handle").value_or("");
    const std::string trigger = fields.string("trigger").value_or("");
    request.once = fields.boolean("once").value_or(true);
    fields.object("place", [&](FieldReader& there) { readPlace(there, request.place); });
    if (!complaints && request.handle.empty()) {
        fields.complain("handle", "expected the handle of a friend");
    }
    request.isImmediate = trigger == "Immediate";
    request.arrives = trigger == "OnArrival";
    if (!complaints && !request.isImmediate && !request.arrives && trigger != "OnDeparture") {
        fields.complain("trigger", R"(expected "OnArrival", "OnDeparture" or "Immediate")");
    }
    complaint = sentenceOf(complaints);
    return complaint.empty() ? std::optional(std::move(request)) : std::nullopt;
}

std::optional<std::int64_t> NumberRequest::read(const Dictionary& body, const std::string& member,
                                                std::string& complaint) {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    readContext(fields);
    // As text: numbers of fences have more digits than every reader of JSON keeps.
    const std::string text = fields.string(member).value_or("");
    if (!complaints && (text.empty() || text.size() > 19 || text.find_first_not_of("0123456789") != std::string::npos ||
                        (text.size() == 19 && text > "9223372036854775807"))) {
        fields.complain(member, "expected digits");
    }
    complaint = sentenceOf(complaints);
    return complaint.empty() ? std::optional(std::stoll(text)) : std::nullopt;
}

Dictionary FenceAnswers::place(const std::string& name, const std::string& label, const FenceCircle& circle) {
    Dictionary place{{"latitude", circle.latitude}, {"longitude", circle.longitude}, {"radius", circle.radius}};
    if (!name.empty()) {
        place.set("name", name);
    }
    if (!label.empty()) {
        // As in the labels of a place: clients word the sorts that they know.
        place.set("label", "_$!<" + label + ">!$_");
    }
    return place;
}

Dictionary FenceAnswers::fence(const Fence& fence) {
    return {{"id", std::to_string(fence.id)},
            {"trigger", fence.arrives ? "OnArrival" : "OnDeparture"},
            {"once", fence.once},
            {"place", place(fence.name, fence.label, fence.circle)},
            {"since", fence.made * 1000}};
}

Dictionary FenceAnswers::facts(const FenceFacts& facts) {
    Dictionary all = fence(facts.fence);
    all.set("name", facts.other);
    if (!facts.handle.empty()) {
        all.set("handle", facts.handle);
    }
    return all;
}

Dictionary FenceAnswers::event(const FenceEvent& event) {
    Dictionary all{{"id", std::to_string(event.number)}, {"name", event.name}};
    if (!event.handle.empty()) {
        all.set("handle", event.handle);
    }
    all.set("trigger", event.arrives ? "OnArrival" : "OnDeparture");
    all.set("place", place(event.place, event.label, event.circle));
    all.set("timestamp", event.time * 1000);
    return all;
}

HttpResponse FenceAnswers::outcome(FenceOutcome outcome, const Fence& fence, const FenceRequest& request) {
    switch (outcome) {
        case FenceOutcome::Refused:
            return refusal(403, "nobody with this handle lets you be told when they come and go");
        case FenceOutcome::NoPlace:
            return refusal(404, request.place.name.empty() ? "nobody knows where that is now"
                                                           : "no place of that name has been told to you");
        case FenceOutcome::TooMany:
            return refusal(409, "there are ten already for this friend: end one first");
        case FenceOutcome::Failed:
            return refusal(503, "the store cannot be written");
        case FenceOutcome::Set:
            break;
    }
    Dictionary answer{{"statusCode", 200}, {"fence", FenceAnswers::fence(fence)}};
    if (request.place.circle && request.place.circle->radius != fence.circle.radius) {
        answer.set("message", fence.circle.radius > request.place.circle->radius
                                  ? "the circle is " + metresOf(fence.circle.radius) +
                                        " wide around that place: below that a phone cannot tell in from out"
                                  : "the circle is " + metresOf(fence.circle.radius) +
                                        " wide around that place: more is no place any more");
    }
    return HttpResponse::json(200, platform::writeJson(answer));
}

Dictionary FenceAnswers::list(const std::vector<FenceFacts>& own, const std::vector<FenceFacts>& aboutMe) {
    const auto all = [](const std::vector<FenceFacts>& fences) {
        Value::Array list;
        for (const FenceFacts& one : fences) {
            list.emplace_back(facts(one));
        }
        return list;
    };
    return {{"statusCode", 200}, {"fences", all(own)}, {"aboutMe", all(aboutMe)}};
}

}  // namespace ktr::server
