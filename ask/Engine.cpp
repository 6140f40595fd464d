#include "ask/Engine.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "ask/Sight.h"
#include "ask/WishAnswers.h"

namespace ktr::ask {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr const char* kClient = "ktr-ask";

Dictionary memberOf(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value == nullptr || value->dictionary() == nullptr ? Dictionary() : *value->dictionary();
}

std::vector<WhereAnswers::Place> placesIn(const Dictionary& answer) {
    std::vector<WhereAnswers::Place> places;
    const Value* given = answer.find("places");
    if (given == nullptr || given->array() == nullptr) {
        return places;
    }
    for (const Value& one : *given->array()) {
        const Dictionary* place = one.dictionary();
        const Value* name = place == nullptr ? nullptr : place->find("name");
        const Value* latitude = place == nullptr ? nullptr : place->find("latitude");
        const Value* longitude = place == nullptr ? nullptr : place->find("longitude");
        if (name != nullptr && name->string() != nullptr && latitude != nullptr && latitude->number() &&
            longitude != nullptr && longitude->number()) {
            places.push_back({*name->string(), *latitude->number(), *longitude->number()});
        }
    }
    return places;
}

/// Whether the answer depends on a place that the user may have named.
bool needsPlaces(const Understood& understood) {
    const Wish wish = understood.meaning.wish;
    return (wish == Wish::NearPlace || wish == Wish::Closest || wish == Wish::IsAt) &&
           !(understood.meaning.place.empty() && understood.placeWord.empty()) && understood.placeWord != "me" &&
           understood.placePerson == nullptr;
}

}  // namespace

Engine::Engine(std::shared_ptr<Languages> languages, ServicePort& service, World world)
    : languages_(std::move(languages)), service_(service), world_(std::move(world)) {
    setPeople({});
}

std::shared_ptr<const People> Engine::Crowd::people() {
    std::call_once(once_, [this] { people_ = std::make_shared<const People>(std::exchange(listed_, {})); });
    return people_;
}

Engine::Begun Engine::begun(const Question& question, Languages& languages, Crowd& crowd, const World& world,
                            bool isLocked) {
    const auto asking = std::make_shared<Asking>();
    asking->question = question;
    asking->people = crowd.people();
    asking->world = world;
    asking->language = languages.language(question.language);
    const auto english = languages.language("en");
    if (!asking->language || !english) {
        // Without its texts the program has no words of its own.
        Answer answer;
        answer.outcome = Outcome::Unreachable;
        answer.sentence = languages.problem();
        return answer;
    }
    if (isLocked) {
        return asking->locked();
    }
    const auto result = Understanding(*asking->language, *english, *asking->people).understand(question);
    if (const auto* unknown = std::get_if<Understanding::UnknownPerson>(&result)) {
        return asking->unknownPerson(*unknown);
    }
    if (const auto* several = std::get_if<Understanding::Ambiguous>(&result)) {
        return asking->ambiguous(*several);
    }
    if (std::holds_alternative<Understanding::UnknownMoment>(result)) {
        return asking->notUnderstood("unknownMoment");
    }
    if (!std::holds_alternative<Understood>(result)) {
        return asking->notUnderstood("notUnderstood");
    }
    asking->understood = std::get<Understood>(result);
    if (isPersonal(asking->understood.meaning.wish) && !question.mayChange) {
        return asking->refused();
    }
    return Shared(asking);
}

std::optional<Answer> Engine::answerHere(const Question& question) {
    auto begin = begun(question, *languages_, *crowd_, world_, isLocked());
    auto* answer = std::get_if<Answer>(&begin);
    return answer == nullptr ? std::nullopt : std::optional(std::move(*answer));
}

std::variant<Answer, Understood> Engine::readHere(const Question& question) {
    auto begin = begun(question, *languages_, *crowd_, world_, isLocked());
    if (auto* answer = std::get_if<Answer>(&begin)) {
        return std::move(*answer);
    }
    return std::get<Shared>(begin)->understood;
}

std::string Engine::whereIs(const std::string& name, const std::string& language) const {
    constexpr std::string_view kName = "{name}";
    const auto known = languages_->language(language);
    // The first suggestion with a name asks where somebody is.
    for (const std::string& suggestion : known ? known->suggestions() : std::vector<std::string>()) {
        if (const auto at = suggestion.find(kName); at != std::string::npos) {
            return std::string(suggestion).replace(at, kName.size(), name);
        }
    }
    return "";
}

void Engine::ask(const Question& question, const Completion& completion, const Meant& understood) {
    const auto begin = std::make_shared<std::optional<Begun>>();
    const auto work = [begin, question, languages = languages_, crowd = crowd_, world = world_, locked = isLocked()] {
        *begin = begun(question, *languages, *crowd, world, locked);
    };
    const auto then = [this, alive = std::weak_ptr<bool>(alive_), begin, completion, understood] {
        if (alive.lock()) {
            goOn(std::move(**begin), completion, understood);
        }
    };
    if (world_.elsewhere) {
        return world_.elsewhere(work, then);
    }
    work();
    then();
}

void Engine::goOn(Begun begun, const Completion& completion, const Meant& understood) {
    if (auto* answer = std::get_if<Answer>(&begun)) {
        return completion(std::move(*answer));
    }
    const auto& asking = std::get<Shared>(begun);
    if (understood) {
        understood(asking->understood.meaning);
    }
    // "Tell me where Ann is now" is one ordinary read.
    const Wish want = asking->understood.meaning.wish;
    isPersonal(want) && want != Wish::TellNow ? wish(asking, completion) : read(asking, completion);
}

void Engine::gather(const Shared& asking, const std::shared_ptr<const std::vector<std::string>>& handles,
                    std::size_t from, const Dictionary& gathered, const std::function<void(ServiceReply)>& then) {
    const std::size_t end = std::min(from + kMostHandles, handles->size());
    Dictionary members{{"handles", Value::Array(handles->begin() + static_cast<std::ptrdiff_t>(from),
                                                handles->begin() + static_cast<std::ptrdiff_t>(end))},
                       {"serverContext", Dictionary{{"clientId", kClient}}}};
    if (const auto& position = asking->question.position) {
        Dictionary mine{{"latitude", position->latitude}, {"longitude", position->longitude}, {"source", "assistant"}};
        if (position->accuracy) {
            mine.set("horizontalAccuracy", *position->accuracy);
        }
        members.set("myLocation", mine);
    }
    // It makes a friend's phone work: not for whoever only reads.
    if (asking->understood.meaning.thisMoment && asking->question.mayChange && !asking->understood.people.empty()) {
        members.set("fresh", true);
    }
    service_.send({"getlocations", members, asking->language->tag()},
                  [this, asking, handles, end, gathered, then](ServiceReply reply) {
                      if (reply.failure != ServiceReply::Failure::None) {
                          return then(std::move(reply));
                      }
                      Dictionary locations = memberOf(gathered, "locations");
                      for (const auto& [handle, entry] : memberOf(reply.body, "locations")) {
                          locations.set(handle, entry);
                      }
                      reply.body.set("locations", locations);
                      if (end == handles->size()) {
                          return then(std::move(reply));
                      }
                      gather(asking, handles, end, reply.body, then);
                  });
}

void Engine::read(const Shared& asking, const Completion& completion) {
    const auto people = WhereAnswers::asked(asking->understood, *asking->people);
    const auto handles = std::make_shared<std::vector<std::string>>();
    for (const Person* person : people) {
        handles->insert(handles->end(), person->emails.begin(), person->emails.end());
        handles->insert(handles->end(), person->phones.begin(), person->phones.end());
    }
    gather(asking, handles, 0, {}, [this, asking, people, completion](ServiceReply reply) {
        if (reply.failure != ServiceReply::Failure::None) {
            return completion(asking->failed(reply.failure));
        }
        auto sights = sightsIn(reply.body, people);
        if (needsPlaces(asking->understood)) {
            return readPlaces(asking, std::move(sights), std::move(reply.body), completion);
        }
        completion(WhereAnswers(*asking, std::move(sights), reply.body).answer({}));
    });
}

void Engine::readPlaces(const Shared& asking, std::vector<Sight> sights, Dictionary answer,
                        const Completion& completion) {
    service_.send(
        {"places", {}, asking->language->tag()},
        [asking, sights = std::move(sights), answer = std::move(answer), completion](const ServiceReply& reply) {
            // A service that knows no places still knows where friends are.
            if (reply.failure == ServiceReply::Failure::NotSignedIn ||
                reply.failure == ServiceReply::Failure::Unreachable) {
                return completion(asking->failed(reply.failure));
            }
            completion(WhereAnswers(*asking, sights, answer).answer(placesIn(reply.body)));
        });
}

void Engine::wish(const Shared& asking, const Completion& completion) {
    const WishAnswers wishes(*asking);
    if (const auto impossible = wishes.impossible()) {
        return completion(*impossible);
    }
    const auto [command, members] = wishes.request();
    service_.send({command, members, asking->language->tag()}, [asking, completion](const ServiceReply& reply) {
        switch (reply.failure) {
            case ServiceReply::Failure::None:
                return completion(WishAnswers(*asking).done(reply.body));
            case ServiceReply::Failure::Refused:
                return completion(WishAnswers(*asking).refused());
            default:
                return completion(asking->failed(reply.failure));
        }
    });
}

}  // namespace ktr::ask
