#include "serve/DevelopmentServer.h"

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "server/answers/CommandRequest.h"
#include "server/http/BasicCredentials.h"
#include "server/http/TlsContext.h"
#include "server/service/Service.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;
using server::HttpHandler;
using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;

namespace {

constexpr const char* kCommands = "/qloxservice/friends/va/";
/// All clients share one address.
constexpr std::size_t kMostClients = 1000;
/// How long answers under way keep the service from ending.
constexpr std::chrono::milliseconds kGrace{200};
/// Seconds between two posts of a phone that is watched.
constexpr double kPostsEach = 5.0;
constexpr std::size_t kDeepBrackets = 1000000;

constexpr const char* kGetLocations = "getlocations";
constexpr const char* kShowHide = "showHideLocation";
constexpr const char* kSharing = "sharing";
constexpr const char* kSetFence = "setFence";

/// A JSON object as a body, or none.
std::optional<Dictionary> objectOf(const std::string& body) {
    const auto document = documents::JsonReader::read(body);
    const auto* value = std::get_if<Value>(&document);
    return value == nullptr || value->dictionary() == nullptr ? std::nullopt : std::optional(*value->dictionary());
}

std::int64_t presentTime() {
    return std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

std::string replaced(std::string text, const std::string& what, const std::string& with) {
    for (std::size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + with.size())) {
        text.replace(at, what.size(), with);
    }
    return text;
}

std::string bodyOf(const Fault& fault, std::string ordinary) {
    switch (fault.body) {
        case Fault::Body::Ordinary:
        case Fault::Body::Endless:
            return ordinary;
        case Fault::Body::NotJson:
            return "<!doctype html><title>Sign in</title><p>Please sign in to this network.</p>";
        case Fault::Body::Array:
            return "[" + ordinary + "]";
        case Fault::Body::Deep:
            return std::string(kDeepBrackets, '[');
        case Fault::Body::Empty:
            return "";
        case Fault::Body::Truncated:
            return ordinary.substr(0, ordinary.size() / 2);
        case Fault::Body::Text:
            return fault.text;
    }
    return ordinary;
}

}  // namespace

class DevelopmentServer::Server {
  public:
    explicit Server(Setup setup)
        : setup_(std::move(setup)),
          made_(setup_.friends, setup_.personId, setup_.token, presentTime()),
          authorization_(server::BasicCredentials{setup_.personId, setup_.token}.header()),
          tls_(server::TlsContext::make(setup_.certificate.certificate.get(), setup_.certificate.key.get())) {}

    std::string start() {
        if (!tls_ || !made_.people().complaint().empty()) {
            return tls_ ? made_.people().complaint() : "the service's certificate cannot be used";
        }
        service_ = std::make_unique<server::Service>(serviceSetup());
        return service_->start();
    }
    void stop() {
        if (service_) {
            service_->stop(kGrace);
        }
    }
    int port() const { return service_ ? service_->port() : 0; }

  private:
    server::Service::Setup serviceSetup() {
        server::Service::Setup service;
        service.http.port = setup_.port;
        service.http.tls = tls_;
        service.http.limits.connections = kMostClients;
        service.http.limits.connectionsPerAddress = kMostClients;
        service.store = made_.people().store();
        service.now = presentTime;
        service.names.maps = setup_.maps;
        service.around = [this](HttpRequest request, HttpReply reply, const HttpHandler& inner) {
            route(std::move(request), std::move(reply), inner);
        };
        return service;
    }

    /// The phones of those about whom the user wants to be told post where they are, every few seconds, as phones do.
    void postBySelf() {
        for (const HttpRequest& post : made_.watchedPosts(now())) {
            phones_(post, HttpReply([](const std::optional<HttpResponse>&) {}));
        }
        service_->later(kPostsEach, [this] { postBySelf(); });
    }

    void route(HttpRequest request, HttpReply reply, const HttpHandler& inner) {
        // Nobody can be watched before somebody has asked for it.
        std::call_once(begun_, [&] {
            phones_ = inner;
            postBySelf();
        });
        if (!isForUs(request)) {
            return reply.send(server::refusal(421, "this service is for localhost alone"));
        }
        for (const char* command : {kGetLocations, kShowHide}) {
            if (request.method == "POST" && request.path == std::string(kCommands) + command) {
                return run({command, std::move(request), std::move(reply), inner});
            }
        }
        if (request.path == std::string(kCommands) + kSharing) {
            return wish(std::move(request), reply, inner);
        }
        if (request.path == std::string(kCommands) + kSetFence) {
            // A fence may lie where they are now.
            const auto body = objectOf(request.body);
            const Value* handle = body ? body->find("handle") : nullptr;
            const auto handles = handle == nullptr || handle->string() == nullptr
                                     ? std::vector<std::string>()
                                     : std::vector<std::string>{*handle->string()};
            return afterPosts(handles, inner, [request, reply, inner] { inner(request, reply); });
        }
        inner(std::move(request), std::move(reply));
    }

    /// What the user asks of their own sharing goes before what an older answer still says of it.
    void wish(HttpRequest request, const HttpReply& reply, const HttpHandler& inner) {
        const auto body = objectOf(request.body);
        inner(std::move(request), HttpReply([this, reply, body](std::optional<HttpResponse> given) {
                  if (!given) {
                      return;
                  }
                  auto answer = objectOf(given->body);
                  if (given->status == 200 && answer && body) {
                      made_.completeWish(*answer, *body);
                      given = HttpResponse::json(200, platform::writeJson(*answer));
                  }
                  reply.send(std::move(*given));
              }));
    }

    /// A web page that resolves its own name to loopback must not read the answers.
    bool isForUs(const HttpRequest& request) const {
        const std::string ourPort = ":" + std::to_string(port());
        const std::string host = request.headerText("Host");
        for (const char* own : {"localhost", "127.0.0.1", "[::1]", "elsewhere.localhost"}) {
            if (host == own + ourPort || host == own) {
                return true;
            }
        }
        return false;
    }

    ServiceMoment now() const {
        const std::chrono::duration<double> since = std::chrono::steady_clock::now() - start_;
        const std::chrono::duration<double, std::milli> epoch = std::chrono::system_clock::now().time_since_epoch();
        return {since.count(), epoch.count()};
    }

    void report(int number, const std::string& what) {
        const std::lock_guard<std::mutex> lock(reportMutex_);
        if (setup_.report) {
            setup_.report("request " + std::to_string(number) + ": " + what);
        }
    }

    std::optional<HttpResponse> refusalOfCredentials(const HttpRequest& request) const {
        if (server::sameSecret(request.headerText("Authorization"), authorization_)) {
            return std::nullopt;
        }
        HttpResponse response = server::refusal(401, "the credentials are missing or wrong");
        response.headers.emplace_back("WWW-Authenticate", "Basic realm=\"ktr serve\"");
        return response;
    }

    /// What is wrong with a command's request around its body.
    std::optional<HttpResponse> refusal(const HttpRequest& request) const {
        const auto refused = refusalOfCredentials(request);
        return refused ? refused : server::refusalOfCommand(request);
    }

    /// A command under way.
    struct Call {
        std::string command;
        HttpRequest request;
        HttpReply reply;
        HttpHandler inner;  ///< the service that answers it
        int number = 0;
        Fault fault = {};
    };

    void run(Call call) {
        call.number = ++requests_;
        call.fault = setup_.faults.faultFor(call.number);
        if (call.fault.delaySeconds <= 0.0) {
            return answer(call);
        }
        service_->later(call.fault.delaySeconds, [this, call] { answer(call); });
    }

    void answer(const Call& call) {
        const Fault& fault = call.fault;
        HttpResponse response;
        if (fault.cut == Fault::Cut::BeforeAnswer) {
            report(call.number, call.command + ", reset");
            response.delivery.reset = true;
            return call.reply.send(response);
        }
        if (!fault.redirect.empty()) {
            response.status = fault.redirectStatus;
            response.headers.emplace_back("Location", locationOf(fault.redirect, call.request.path));
            report(call.number, call.command + ", " + std::to_string(response.status) + ", redirected");
            return call.reply.send(response);
        }
        if (const auto refused = refusal(call.request)) {
            return finish(call, *refused);
        }
        if (fault.status >= 300) {
            response = server::refusal(fault.status, "a fault that was asked for");
            spoil(fault, response);
            return finish(call, response);
        }
        const auto body = objectOf(call.request.body);
        std::string complaint;
        const auto asks =
            body && call.command == kGetLocations ? server::LocationsRequest::read(*body, complaint) : std::nullopt;
        afterPosts(asks ? asks->handles : std::vector<std::string>(), call.inner, [this, call] {
            call.inner(call.request, HttpReply([this, call](std::optional<HttpResponse> given) {
                           if (given) {
                               finish(call, given->status == 200 ? completed(call, std::move(*given)) : *given);
                           }
                       }));
        });
    }

    /// The phones of those who are asked for send where they are; then goes on.
    void afterPosts(const std::vector<std::string>& handles, const HttpHandler& inner,
                    const std::function<void()>& then) {
        const auto posts = made_.posts(handles, now());
        if (posts.empty()) {
            return then();
        }
        const auto under = std::make_shared<std::atomic<std::size_t>>(posts.size());
        for (const HttpRequest& post : posts) {
            inner(post, HttpReply([under, then](const std::optional<HttpResponse>&) {
                      if (under->fetch_sub(1) == 1) {
                          then();
                      }
                  }));
        }
    }

    /// The service's answer, with what the friends file and the fault add to it.
    HttpResponse completed(const Call& call, HttpResponse response) const {
        auto answer = objectOf(response.body);
        const auto request = objectOf(call.request.body);
        if (answer && request) {
            if (call.command == kGetLocations) {
                made_.completeLocations(*answer, now(), call.fault);
            } else {
                made_.completeSharing(*answer, *request, now(), call.fault);
            }
            response =
                HttpResponse::json(call.fault.status == 0 ? 200 : call.fault.status, platform::writeJson(*answer));
        }
        spoil(call.fault, response);
        return response;
    }

    void finish(const Call& call, const HttpResponse& response) {
        report(call.number, call.command + ", " + std::to_string(response.status));
        call.reply.send(response);
    }

    std::string locationOf(const std::string& redirect, const std::string& path) const {
        std::string location = replaced(redirect, "{origin}", "https://localhost:" + std::to_string(port()));
        location = replaced(std::move(location), "{port}", std::to_string(port()));
        return replaced(std::move(location), "{path}", path);
    }

    /// Gives an answer the body, and has it go the way, that the fault asks for.
    static void spoil(const Fault& fault, HttpResponse& response) {
        response.body = bodyOf(fault, std::move(response.body));
        response.delivery.endless = fault.body == Fault::Body::Endless;
        response.delivery.bytesPerSecond = fault.bytesPerSecond;
        if (fault.cut == Fault::Cut::AfterHeaders) {
            response.delivery.cutAfter = 0;
        } else if (fault.cut == Fault::Cut::InBody) {
            response.delivery.cutAfter = response.body.size() / 2;
        }
    }

    Setup setup_;
    LocationService made_;
    std::string authorization_;
    std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
    std::atomic<int> requests_ = 0;
    std::mutex reportMutex_;
    server::TlsContext::Context tls_;
    std::once_flag begun_;
    HttpHandler phones_;                        ///< the service, as phones reach it; from the first request on
    std::unique_ptr<server::Service> service_;  ///< from the start on
};

DevelopmentServer::DevelopmentServer(Setup setup) : server_(std::make_unique<Server>(std::move(setup))) {}

DevelopmentServer::~DevelopmentServer() {
    stop();
}

std::string DevelopmentServer::start() {
    return server_->start();
}

void DevelopmentServer::stop() {
    server_->stop();
}

int DevelopmentServer::port() const {
    return server_->port();
}

}  // namespace ktr::serve
