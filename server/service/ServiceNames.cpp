// The part of the service that answers once it is known what places are called.
#include <algorithm>
#include <utility>

#include "platform/base/Json.h"
#include "server/service/Service.h"

namespace ktr::server {

void Service::nameAndAnswer(LocationsRequest request, std::vector<AskedFriend> friends, const HttpReply& reply) {
    std::vector<PlaceNames::Place> places;
    std::vector<std::size_t> whose;
    for (std::size_t number = 0; number < friends.size(); ++number) {
        const auto& seen = friends[number].seen;
        if (seen && seen->place.empty()) {
            places.push_back({seen->latitude, seen->longitude, seen->isExact, seen->accuracy});
            whose.push_back(number);
        }
    }
    const ViewerLocale viewer = request.viewer;
    const double interval = held_ ? HeldAnswers::kAskAgain : LocationAnswers::kInterval;
    auto answer = [interval, request = std::move(request), friends = std::move(friends), whose = std::move(whose),
                   reply](const std::vector<PlaceName>& names) mutable {
        for (std::size_t number = 0; number < whose.size(); ++number) {
            friends[whose[number]].name = names[number];
        }
        reply.send(HttpResponse::json(
            200, platform::writeJson(LocationAnswers::locations(request, std::move(friends), interval))));
    };
    if (places.empty()) {
        return answer({});
    }
    names_->ask(std::move(places), viewer, std::move(answer));
}

void Service::answerSharing(const Device& device, const SharingRequest& request, const HttpReply& reply) {
    const auto person = store_->person(device.person);
    if (!person) {
        ++counters_.storeFailures;
        return reply.send(refusal(503, "the store cannot be read"));
    }
    const bool hidden = request.hides || person->hidden;
    // What is said to be an e-mail address is one.
    const auto found = std::find_if(person->handles.begin(), person->handles.end(),
                                    [](const std::string& one) { return one.find('@') != std::string::npos; });
    const std::string handle = found == person->handles.end() ? "" : *found;
    const auto answer = [hidden, handle, place = request.place, now = now_(), reply](const PlaceName& name) {
        reply.send(
            HttpResponse::json(200, platform::writeJson(LocationAnswers::sharing(hidden, handle, place, name, now))));
    };
    if (hidden || !request.place) {
        return answer({});
    }
    names_->ask({{request.place->latitude, request.place->longitude, true, request.place->accuracy}}, request.viewer,
                [answer](const std::vector<PlaceName>& names) { answer(names.front()); });
}

}  // namespace ktr::server
