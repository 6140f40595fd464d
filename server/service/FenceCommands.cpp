#include "server/service/FenceCommands.h"

#include "platform/base/Json.h"
#include "server/answers/FenceRequest.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

HttpResponse done() {
    return HttpResponse::json(200, platform::writeJson(Dictionary{{"statusCode", 200}}));
}

HttpResponse notWritten() {
    return refusal(503, "the store cannot be written");
}

}  // namespace

bool FenceCommands::answer(const std::string& command, const Device& device, const Dictionary& body,
                           const HttpReply& reply) const {
    if (command == "setFence") {
        set(device, body, reply);
    } else if (command == "fences") {
        list(device, reply);
    } else if (command == "endFence") {
        end(device, body, reply);
    } else if (command == "events") {
        acknowledge(device, body, reply);
    } else {
        return false;
    }
    return true;
}

void FenceCommands::set(const Device& device, const Dictionary& body, const HttpReply& reply) const {
    std::string complaint;
    const auto request = FenceRequest::read(body, complaint);
    if (!request) {
        return reply.send(refusal(400, complaint));
    }
    if (request->isImmediate) {
        // To be told where somebody is now is to look.
        Dictionary asks = body;
        asks.set("handles", Value::Array{request->handle});
        return setup_.locations(device, asks, reply);
    }
    const std::uint64_t failures = setup_.store.readFailures();
    const FenceWish wish{device.person, setup_.store.personOf(request->handle).value_or(0), request->place,
                         request->arrives, request->once};
    if (setup_.store.readFailures() != failures) {
        return reply.send(refusal(503, "the store cannot be read"));
    }
    setup_.store.setFence(wish, setup_.now(), [reply, asked = *request](FenceOutcome outcome, const Fence& fence) {
        reply.send(FenceAnswers::outcome(outcome, fence, asked));
    });
}

void FenceCommands::list(const Device& device, const HttpReply& reply) const {
    const auto own = setup_.store.fencesBy(device.person);
    const auto aboutMe = setup_.store.fencesAbout(device.person);
    reply.send(own && aboutMe ? HttpResponse::json(200, platform::writeJson(FenceAnswers::list(*own, *aboutMe)))
                              : refusal(503, "the store cannot be read"));
}

void FenceCommands::end(const Device& device, const Dictionary& body, const HttpReply& reply) const {
    std::string complaint;
    const auto id = NumberRequest::read(body, "id", complaint);
    if (!id) {
        return reply.send(refusal(400, complaint));
    }
    setup_.store.endFence(device.person, *id, [reply](FenceOutcome outcome) {
        // One that has ended already is what was wanted.
        reply.send(outcome == FenceOutcome::Failed ? notWritten() : done());
    });
}

void FenceCommands::acknowledge(const Device& device, const Dictionary& body, const HttpReply& reply) const {
    std::string complaint;
    const auto number = NumberRequest::read(body, "heard", complaint);
    if (!number) {
        return reply.send(refusal(400, complaint));
    }
    setup_.store.acknowledgeEvents(device.id, *number,
                                   [reply](bool good) { reply.send(good ? done() : notWritten()); });
}

}  // namespace ktr::server
