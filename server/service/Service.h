#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/answers/CommandRequest.h"
#include "server/answers/LocationAnswers.h"
#include "server/http/HttpServer.h"
#include "server/ingest/Report.h"
#include "server/names/NameDesk.h"
#include "server/outbox/EventStreams.h"
#include "server/page/PeoplesPage.h"
#include "server/service/AskCommands.h"
#include "server/service/FailureDelays.h"
#include "server/service/FenceCommands.h"
#include "server/service/HeldAnswers.h"
#include "server/service/ServiceCounters.h"
#include "server/service/ServiceLog.h"
#include "server/service/Traffic.h"
#include "server/store/Store.h"

namespace ktr::server {

/// The service as the network meets it: phones post to "/pub" (OwnTracks) and "/" (OsmAnd, Traccar Client, GPSLogger),
/// readers send the protocol's commands (docs/service-protocol.md), browsers show people their own page ("/me"). What
/// is public belongs to the thread that made it.
class Service {
  public:
    struct Setup {
        HttpServer::Setup http;  ///< its handler is not used
        std::shared_ptr<Store> store;
        /// The host names of its address, without a port; empty: any.
        std::vector<std::string> hosts;
        std::function<std::int64_t()> now;  ///< seconds since 1970
        /// Called about once a second, for as long as requests can be answered and the store answers; may be empty.
        std::function<void()> alive = {};
        std::shared_ptr<ServiceLog> log = {};  ///< none: nothing is written
        /// A client that asks the same again waits until it would hear something else; else it asks every five seconds.
        bool holdsAnswers = false;
        /// Sees each request before the service does, and answers it or hands it on: for a service whose answers go
        /// wrong on purpose. On the edge's threads; none: nobody does.
        std::function<void(HttpRequest, HttpReply, const HttpHandler& service)> around = {};
        PlaceNames::Setup names = {};  ///< by which places are called something
    };

    explicit Service(Setup setup);
    /// Stops, and writes what waits.
    ~Service();
    Service(const Service&) = delete;
    Service& operator=(const Service&) = delete;

    /// Empty when it answers, else what failed.
    std::string start();
    void stop(std::chrono::milliseconds grace = std::chrono::milliseconds(2000));
    /// As the edge's.
    void later(double seconds, std::function<void()> what) { http_.later(seconds, std::move(what)); }
    int port() const { return http_.port(); }
    const ServiceCounters& counters() const { return counters_; }

  private:
    HttpServer::Setup httpSetup(Setup& setup);
    void route(const HttpRequest& request, const HttpReply& reply);
    /// For whoever runs the service: whether it is well, and numbers.
    void answerOperator(const HttpRequest& request, const HttpReply& reply);
    void noteStore(bool isWell);
    bool isForUs(const HttpRequest& request) const;
    /// The device behind the credentials, of this kind; else it has answered.
    std::optional<Device> authenticated(const HttpRequest& request, const std::string& ownSecret, DeviceKind kind,
                                        const HttpReply& reply);
    void refuseCredentials(const HttpRequest& request, const HttpReply& reply);
    void takeOwnTracks(const HttpRequest& request, const HttpReply& reply);
    void takeParameters(const HttpRequest& request, const HttpReply& reply);
    /// A request whose body is too long to be read.
    void takeTooLong(const HttpRequest& request, const HttpReply& reply);
    /// What of a report is kept; counts the rest.
    std::vector<Fix> admitted(const Device& device, const Report& report);
    /// The places that a report names, as many as are kept.
    static std::vector<NamedPlace> namedPlaces(const Report& report);
    /// The face that a report brings, if it is one; counts what is none.
    std::optional<std::string> cleanedFace(const Report& report);
    void answerCommand(const HttpRequest& request, const HttpReply& reply);
    void answerLocations(const Device& device, const platform::Dictionary& body, const HttpReply& reply);
    void openEvents(const HttpRequest& request, const HttpReply& reply);
    /// The same, without holding it.
    void answerNow(const Device& device, const platform::Dictionary& body, const HttpReply& reply);
    /// The same with the wish for newer fixes, which is on the disk before it is answered.
    void wishAndAnswer(const Device& device, const LocationsRequest& request, const HttpReply& reply);
    /// `askedSince`: by handle, as `AskedFriend` has it; empty: nothing newer was asked for.
    HeldAnswers::Answer locationsNow(const Device& device, const LocationsRequest& request,
                                     const std::vector<std::int64_t>& askedSince = {});
    /// Looks up what the places are called, and answers then.
    void nameAndAnswer(LocationsRequest request, std::vector<AskedFriend> friends, const HttpReply& reply);
    void answerSharing(const Device& device, const SharingRequest& request, const HttpReply& reply);
    void changeSharing(const Device& device, const platform::Dictionary& body, const HttpReply& reply);
    void sweep();

    const std::vector<std::string> hosts_;
    const std::function<std::int64_t()> now_;
    const std::function<void()> alive_;
    const std::shared_ptr<ServiceLog> log_;
    Traffic traffic_;
    std::atomic<bool> storeIsWell_ = true;          ///< as the last sweep found it, and whoever asked before it
    std::atomic<std::int64_t> failuresBefore_ = 0;  ///< answers that could not be given until then
    ServiceCounters counters_;
    FailureDelays delays_;
    std::shared_ptr<Store> store_;
    HttpServer http_;
    std::unique_ptr<PeoplesPage> page_;
    std::unique_ptr<FenceCommands> fences_;
    std::unique_ptr<AskCommands> asks_;
    std::unique_ptr<EventStreams> events_;
    std::unique_ptr<HeldAnswers> held_;  ///< none: no answer is held
    std::shared_ptr<void> listening_;
    std::unique_ptr<NameDesk> names_;
};

}  // namespace ktr::server
