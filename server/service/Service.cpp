#include "server/service/Service.h"

#include <algorithm>
#include <charconv>
#include <utility>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "server/answers/CommandRequest.h"
#include "server/answers/LocationAnswers.h"
#include "server/answers/PhoneAnswer.h"
#include "server/http/BasicCredentials.h"
#include "server/ingest/Face.h"
#include "server/ingest/FixRules.h"
#include "server/ingest/PhoneMessages.h"
#include "server/service/PhoneFriends.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr const char* kCommands = "/qloxservice/friends/va/";
/// Between two steps of deleting what is too old, seconds.
constexpr double kSweepPause = 1.0;

/// The host of a Host header, without its port.
std::string hostOf(const std::string& header) {
    const std::size_t colon = header.rfind(':');
    const bool hasPort = colon != std::string::npos && colon + 1 < header.size() &&
                         header.find_first_not_of("0123456789", colon + 1) == std::string::npos;
    return hasPort ? header.substr(0, colon) : header;
}

}  // namespace

Service::Service(Setup setup)
    : hosts_(std::move(setup.hosts)),
      now_(std::move(setup.now)),
      alive_(std::move(setup.alive)),
      log_(std::move(setup.log)),
      traffic_(log_),
      store_(std::move(setup.store)),
      http_(httpSetup(setup)),
      page_(std::make_unique<PeoplesPage>(PeoplesPage::Setup{
          *store_, now_, delays_,
          [this](double seconds, std::function<void()> work) { http_.later(seconds, std::move(work)); }})),
      fences_(std::make_unique<FenceCommands>(
          FenceCommands::Setup{*store_, now_,
                               [this](const Device& device, const Dictionary& body, const HttpReply& reply) {
                                   answerNow(device, body, reply);
                               }})),
      asks_(std::make_unique<AskCommands>(AskCommands::Setup{*store_, now_})),
      held_(setup.holdsAnswers ? std::make_unique<HeldAnswers>([this](double seconds, std::function<void()> work) {
          http_.later(seconds, std::move(work));
      })
                               : nullptr),
      names_(std::make_unique<NameDesk>(std::move(setup.names))) {
    if (held_) {
        listening_ = store_->listen([this](const Change& change) { held_->concerns(change); });
    }
}

Service::~Service() {
    stop();
}

HttpServer::Setup Service::httpSetup(Setup& setup) {
    HttpServer::Setup http = std::move(setup.http);
    http.handler = [this](const HttpRequest& request, const HttpReply& reply) {
        route(request, traffic_.watched(request, reply));
    };
    http.tooLong = [this](const HttpRequest& request, const HttpReply& reply) {
        takeTooLong(request, traffic_.watched(request, reply));
    };
    if (setup.around) {
        http.handler = [around = std::move(setup.around), service = std::move(http.handler)](HttpRequest request,
                                                                                             HttpReply reply) {
            around(std::move(request), std::move(reply), service);
        };
    }
    return http;
}

std::string Service::start() {
    std::string failure = http_.start();
    if (failure.empty()) {
        http_.later(0.0, [this] { sweep(); });
        events_ = std::make_unique<EventStreams>(EventStreams::Setup{
            *store_, now_,
            [this](double seconds, std::function<void()> work) { http_.later(seconds, std::move(work)); }});
    }
    return failure;
}

void Service::stop(std::chrono::milliseconds grace) {
    listening_.reset();
    if (held_ && store_) {
        held_->release();
    }
    http_.stop(grace);
    names_.reset();
    events_.reset();
    fences_.reset();
    asks_.reset();
    page_.reset();
    // Its last commits still answer through the edge; and the store may be somebody else's, too.
    if (store_) {
        store_->finish();
        store_.reset();
    }
}

void Service::sweep() {
    // Through the edge's threads and the store's: whichever stands still, nobody hears of life.
    store_->deleteOld(now_(), [this](bool isWell) {
        const std::int64_t failures = counters_.storeFailures;
        noteStore(isWell && failures == failuresBefore_);
        failuresBefore_ = failures;
        if (alive_) {
            alive_();
        }
    });
    http_.later(kSweepPause, [this] { sweep(); });
}

bool Service::isForUs(const HttpRequest& request) const {
    return hosts_.empty() || std::any_of(hosts_.begin(), hosts_.end(), [&](const std::string& host) {
               return equalIgnoringCase(host, hostOf(request.headerText("Host")));
           });
}

void Service::route(const HttpRequest& request, const HttpReply& reply) {
    const bool reads = request.method == "GET";
    const bool posts = request.method == "POST";
    if (reads && request.isLocal && (request.path == "/health" || request.path == "/metrics")) {
        return answerOperator(request, reply);
    }
    if (!isForUs(request)) {
        return reply.send(refusal(421, "this service has another name"));
    }
    if (PageRequest::isFor(request)) {
        return page_->answer(request, reply);
    }
    if (posts && request.path == "/pub") {
        return takeOwnTracks(request, reply);
    }
    if ((posts || reads) && request.path == "/") {
        return takeParameters(request, reply);
    }
    if (reads && request.path == std::string(kCommands) + "events") {
        return openEvents(request, reply);
    }
    if (posts && request.path.rfind(kCommands, 0) == 0) {
        return answerCommand(request, reply);
    }
    reply.send(refusal(404, "there is no such path"));
}

void Service::answerOperator(const HttpRequest& request, const HttpReply& reply) {
    const bool isWell = storeIsWell_ && counters_.storeFailures == failuresBefore_;
    if (request.path == "/health") {
        return reply.send(
            HttpResponse::json(isWell ? 200 : 503, isWell ? R"({"store":"ok"})" : R"({"store":"failing"})"));
    }
    HttpResponse response;
    response.headers.emplace_back("Content-Type", "text/plain; version=0.0.4");
    const auto number = [](const char* name, const char* type, std::uint64_t value) {
        const std::string whole = std::string("ktr_service_") + name;
        return "# TYPE " + whole + " " + type + "\n" + whole + " " + std::to_string(value) + "\n";
    };
    response.body = counters_.text() + traffic_.text() + http_.numbers() +
                    number("dropped_events_total", "counter", store_->droppedEvents()) +
                    number("slow_readers_total", "counter", events_->slowReaders()) +
                    number("event_streams", "gauge", events_->size()) +
                    number("held_answers", "gauge", held_ ? held_->size() : 0) +
                    number("fixes_read_total", "counter", store_->fixesRead()) +
                    "# TYPE ktr_service_store_ok gauge\nktr_service_store_ok " + (isWell ? "1" : "0") + "\n";
    reply.send(response);
}

void Service::noteStore(bool isWell) {
    if (storeIsWell_.exchange(isWell) != isWell && log_) {
        log_->write(isWell ? ServiceLog::Level::Info : ServiceLog::Level::Error,
                    isWell ? ServiceLog::Word("store-mended") : ServiceLog::Word("store-failing"));
    }
}

void Service::refuseCredentials(const HttpRequest& request, const HttpReply& reply) {
    ++counters_.wrongCredentials;
    HttpResponse response = refusal(401, "the credentials are missing or wrong");
    response.headers.emplace_back("WWW-Authenticate", "Basic realm=\"ktr\"");
    http_.later(delays_.afterFailure(request.peer, FailureDelays::Clock::now()),
                [reply, response] { reply.send(response); });
}

std::optional<Device> Service::authenticated(const HttpRequest& request, const std::string& ownSecret, DeviceKind kind,
                                             const HttpReply& reply) {
    const auto basic = BasicCredentials::read(request.headerText("Authorization"));
    const std::string& secret = basic ? basic->password : ownSecret;
    bool failed = false;
    auto device = secret.empty() ? std::nullopt : store_->deviceOf(secret, failed);
    if (failed) {
        ++counters_.storeFailures;
        reply.send(refusal(503, "the store cannot be read"));
        return std::nullopt;
    }
    if (!device || device->kind != kind || (basic && !sameSecret(basic->user, device->name))) {
        refuseCredentials(request, reply);
        return std::nullopt;
    }
    return device;
}

std::vector<Fix> Service::admitted(const Device& device, const Report& report) {
    ++counters_.posts;
    counters_.junk += report.kind == Report::Kind::Junk ? 1 : 0;
    std::vector<Fix> fixes;
    for (const RawFix& raw : report.fixes) {
        const auto [fix, loss] = FixRules::admit(raw, now_(), device.retention);
        counters_.droppedNoPlace += loss == FixRules::Loss::NoPlace ? 1 : 0;
        counters_.droppedNoTime += loss == FixRules::Loss::NoTime ? 1 : 0;
        counters_.droppedTooOld += loss == FixRules::Loss::TooOld ? 1 : 0;
        if (fix) {
            ++counters_.fixes;
            fixes.push_back(*fix);
        }
    }
    return fixes;
}

void Service::takeOwnTracks(const HttpRequest& request, const HttpReply& reply) {
    const auto device = authenticated(request, "", DeviceKind::Phone, reply);
    if (!device) {
        return;
    }
    const Report report = PhoneMessages::ownTracks(request.body, device->key);
    if (const bool holds = PhoneAnswer::showsTransitions(request.headerText("User-Agent"));
        holds != device->holdsEvents) {
        store_->noteHoldsEvents(device->id, holds);
    }
    // Written before the rest of the post, so that its fate is known when the rest is on the disk.
    const auto faceKept = std::make_shared<bool>(true);
    const auto placesKept = std::make_shared<bool>(true);
    if (const auto face = cleanedFace(report)) {
        store_->keepFace(device->person, *face, [faceKept](bool good) { *faceKept = good; });
    }
    if (auto places = namedPlaces(report); !places.empty()) {
        store_->keepPlaces(device->person, std::move(places), [placesKept](bool good) { *placesKept = good; });
    }
    auto fixes = admitted(*device, report);
    const auto reports = std::make_shared<bool>(false);
    if (PhoneAnswer::reportsWhenTold(request.headerText("User-Agent"))) {
        store_->takeWishes(device->person, fixes.empty() ? 0 : fixes.back().time, store_->present(now_()),
                           [reports](bool isWanted) { *reports = isWanted; });
    }
    store_->keep(device->id, device->person, std::move(fixes), store_->present(now_()),
                 [this, device = *device, report, faceKept, placesKept, reports, reply](bool good) {
                     if (!good || !*faceKept || !*placesKept) {
                         // A phone keeps what got a 5xx and sends it again.
                         ++counters_.storeFailures;
                         return reply.send(refusal(503, "the store cannot be written"));
                     }
                     http_.later(0.0, [this, device, report, isToReport = *reports, reply] {
                         const std::uint64_t failures = store_->readFailures();
                         const std::string friends = PhoneFriends(*store_).answer(device, report, now_(), isToReport);
                         if (store_->readFailures() != failures) {
                             ++counters_.storeFailures;
                             return reply.send(refusal(503, "the store cannot be read"));
                         }
                         reply.send(HttpResponse::json(200, friends));
                     });
                 });
}

std::vector<NamedPlace> Service::namedPlaces(const Report& report) {
    std::vector<NamedPlace> places;
    for (const RawPlace& raw : report.places) {
        auto place = places.size() < NamedPlace::kMost ? NamedPlace::of(raw) : std::nullopt;
        if (place) {
            places.push_back(std::move(*place));
        }
    }
    return places;
}

void Service::takeTooLong(const HttpRequest& request, const HttpReply& reply) {
    const bool isPub = request.path == "/pub";
    if (!isForUs(request) || request.method != "POST" || !(isPub || request.path == "/")) {
        return reply.send(refusal(413, "the body is too long"));
    }
    const std::string secret = isPub ? "" : PhoneMessages::parameters(request.query).device;
    // Whose it is stands in what nobody reads; nothing of it is kept, and nothing is told.
    const bool isSaidInTheBody = !isPub && request.header("Authorization") == nullptr && secret.empty();
    if (isSaidInTheBody || authenticated(request, secret, DeviceKind::Phone, reply)) {
        // Else a phone would drop it with an alarm, or send it for ever before anything else.
        ++counters_.posts;
        ++counters_.junk;
        reply.send(isPub ? HttpResponse::json(200, "[]") : HttpResponse());
    }
}

std::optional<std::string> Service::cleanedFace(const Report& report) {
    std::string complaint;
    auto face = report.face ? Face::cleaned(*report.face, complaint) : std::nullopt;
    counters_.droppedFaces += report.face && !face ? 1 : 0;
    return face;
}

void Service::takeParameters(const HttpRequest& request, const HttpReply& reply) {
    const bool isJson = request.headerText("Content-Type").rfind("application/json", 0) == 0;
    const Report report =
        isJson ? PhoneMessages::traccar(request.body) : PhoneMessages::parameters(request.query + "&" + request.body);
    const auto device = authenticated(request, report.device, DeviceKind::Phone, reply);
    if (!device) {
        return;
    }
    store_->keep(device->id, device->person, admitted(*device, report), store_->present(now_()),
                 [this, reply](bool good) {
                     counters_.storeFailures += good ? 0 : 1;
                     reply.send(good ? HttpResponse() : refusal(503, "the store cannot be written"));
                 });
}

void Service::answerCommand(const HttpRequest& request, const HttpReply& reply) {
    const auto device = authenticated(request, "", DeviceKind::Reader, reply);
    if (!device) {
        return;
    }
    ++counters_.commands;
    if (const auto refused = refusalOfCommand(request)) {
        return reply.send(*refused);
    }
    const auto document = documents::JsonReader::read(request.body);
    const auto* value = std::get_if<Value>(&document);
    if (value == nullptr || value->dictionary() == nullptr) {
        return reply.send(refusal(400, "expected a JSON object as the body"));
    }
    const std::string command = request.path.substr(std::string(kCommands).size());
    if (command == "getlocations") {
        answerLocations(*device, *value->dictionary(), reply);
    } else if (command == "showHideLocation") {
        changeSharing(*device, *value->dictionary(), reply);
    } else if (!fences_->answer(command, *device, *value->dictionary(), reply) &&
               !asks_->answer(command, *device, *value->dictionary(), reply)) {
        reply.send(refusal(404, "there is no such path"));
    }
}

void Service::openEvents(const HttpRequest& request, const HttpReply& reply) {
    const auto device = authenticated(request, "", DeviceKind::Reader, reply);
    if (!device) {
        return;
    }
    const std::string last = request.headerText("Last-Event-ID");
    std::int64_t number = 0;
    const auto [end, error] = std::from_chars(last.data(), last.data() + last.size(), number);
    if (!last.empty() && (error != std::errc() || end != last.data() + last.size() || number < 0)) {
        return reply.send(refusal(400, "expected digits as the Last-Event-ID"));
    }
    reply.send(events_->open(*device, number));
}

void Service::answerLocations(const Device& device, const Dictionary& body, const HttpReply& reply) {
    std::string complaint;
    const auto request = LocationsRequest::read(body, complaint);
    if (!request) {
        return reply.send(refusal(400, complaint));
    }
    if (request->wantsNewer) {
        return wishAndAnswer(device, *request, reply);
    }
    if (!held_) {
        return locationsNow(device, *request).give(reply);
    }
    std::string client = std::to_string(device.id) + '\n' + request->clientId.value_or("");
    for (const std::string& handle : request->handles) {
        client += '\n' + handle;
    }
    const auto now = [this, device = device, asked = *request, wasHeld = false]() mutable -> HeldAnswers::Answer {
        // While it was held its secret may have ended; before that it was just looked at.
        if (std::exchange(wasHeld, true) && !store_->isInUse(device.id).value_or(true)) {
            return {
                "", {}, [](const HttpReply& late) { late.send(refusal(401, "the credentials are missing or wrong")); }};
        }
        return locationsNow(device, asked);
    };
    held_->give(client, now, reply);
}

void Service::answerNow(const Device& device, const Dictionary& body, const HttpReply& reply) {
    std::string complaint;
    const auto request = LocationsRequest::read(body, complaint);
    if (!request) {
        return reply.send(refusal(400, complaint));
    }
    locationsNow(device, *request).give(reply);
}

void Service::wishAndAnswer(const Device& device, const LocationsRequest& request, const HttpReply& reply) {
    std::vector<std::string> handles = request.handles;
    handles.resize(std::min(handles.size(), static_cast<std::size_t>(Store::kMostWishes)));
    store_->wishForFix(device.person, handles, store_->present(now_()),
                       [this, device, request, reply](const std::optional<std::vector<std::int64_t>>& since) {
                           if (!since) {
                               ++counters_.storeFailures;
                               return reply.send(refusal(503, "the store cannot be written"));
                           }
                           http_.later(0.0, [this, device, request, since = *since, reply] {
                               locationsNow(device, request, since).give(reply);
                           });
                       });
}

HeldAnswers::Answer Service::locationsNow(const Device& device, const LocationsRequest& request,
                                          const std::vector<std::int64_t>& askedSince) {
    const std::int64_t now = now_();
    store_->present(now);
    std::vector<std::string> lookedUp = request.handles;
    lookedUp.resize(std::min(lookedUp.size(), LocationAnswers::kMostHandles));
    const auto people = store_->asked(device.person, lookedUp, now);
    if (!people) {
        ++counters_.storeFailures;
        return {"", {}, [](const HttpReply& reply) { reply.send(refusal(503, "the store cannot be read")); }};
    }
    HeldAnswers::Answer answer{"", {device.person}, {}};
    std::vector<AskedFriend> asked;
    std::vector<std::int64_t> seen;
    for (const std::string& handle : request.handles) {
        asked.push_back({handle, 0, std::nullopt});
        asked.back().askedSince = asked.size() > askedSince.size() ? 0 : askedSince[asked.size() - 1];
        if (asked.size() > people->size()) {
            continue;
        }
        const Asked& one = (*people)[asked.size() - 1];
        asked.back().person = one.person;
        asked.back().seen = Visibility::visible(one.sharing, now);
        if (one.person != 0) {
            answer.people.insert(one.person);
        }
        if (asked.back().seen) {
            asked.back().aloud = one.sharing.grant->aloud;
            seen.push_back(one.person);
        }
        answer.said += LocationAnswers::said(asked.back()) + '\n';
    }
    answer.give = [this, device, request, now, asked = std::move(asked),
                   seen = std::move(seen)](const HttpReply& reply) {
        if (!seen.empty()) {
            store_->noteLooks(device.person, seen, true, now, nullptr);
        }
        nameAndAnswer(request, asked, reply);
    };
    return answer;
}

void Service::changeSharing(const Device& device, const Dictionary& body, const HttpReply& reply) {
    std::string complaint;
    const auto request = SharingRequest::read(body, complaint);
    if (!request) {
        return reply.send(refusal(400, complaint));
    }
    const auto written = [this, device, request = *request, reply](bool good) {
        if (!good) {
            ++counters_.storeFailures;
            return reply.send(refusal(503, "the store cannot be written"));
        }
        http_.later(0.0, [this, device, request, reply] { answerSharing(device, request, reply); });
    };
    if (request->hides) {
        store_->hide(device.person, now_(), written);
    } else {
        // "No" alone shows nobody: it may be an older answer that repeats itself.
        store_->shareAsAsked(device.id, now_(), written);
    }
}

}  // namespace ktr::server
