#include "serve/DevelopmentServer.h"

#include <atomic>
#include <chrono>
#include <mutex>
#include <optional>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "serve/AssistantAnswers.h"
#include "server/answers/CommandRequest.h"
#include "server/http/BasicCredentials.h"
#include "server/http/HttpServer.h"
#include "server/http/TlsContext.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;
using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;

namespace {

constexpr const char* kCommands = "/qloxservice/friends/va/";
/// All clients share one address.
constexpr std::size_t kMostClients = 1000;
/// How long answers under way keep the service from ending.
constexpr std::chrono::milliseconds kGrace{200};
constexpr std::size_t kDeepBrackets = 1000000;

/// One of the service's commands: the last part of its path, and who answers it.
struct Command {
    const char* name;
    std::optional<Dictionary> (LocationService::*answer)(const Dictionary&, const ServiceMoment&, const Fault&,
                                                         std::string&) const;
    std::string path() const { return std::string(kCommands) + name; }
};

constexpr Command kAllCommands[] = {{"getlocations", &LocationService::getLocations},
                                    {"showHideLocation", &LocationService::showHideLocation}};

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
          service_(setup_.friends),
          assistant_(service_),
          authorization_(server::BasicCredentials{setup_.personId, setup_.token}.header()),
          tls_(server::TlsContext::make(setup_.certificate.certificate.get(), setup_.certificate.key.get())),
          http_(httpSetup()) {}

    std::string start() { return tls_ ? http_.start() : "the service's certificate cannot be used"; }
    void stop() { http_.stop(kGrace); }
    int port() const { return http_.port(); }

  private:
    server::HttpServer::Setup httpSetup() {
        server::HttpServer::Setup http;
        http.port = setup_.port;
        http.tls = tls_;
        http.limits.connections = kMostClients;
        http.limits.connectionsPerAddress = kMostClients;
        http.handler = [this](HttpRequest request, const HttpReply& reply) { route(std::move(request), reply); };
        return http;
    }

    void route(HttpRequest request, const HttpReply& reply) {
        if (!isForUs(request)) {
            return reply.send(server::refusal(421, "this service is for localhost alone"));
        }
        if (request.path == "/assistant") {
            return reply.send(ask(request));
        }
        for (const Command& command : kAllCommands) {
            if (request.method == "POST" && request.path == command.path()) {
                return run(command, std::move(request), reply);
            }
        }
        reply.send(server::refusal(404, "there is no such path"));
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

    HttpResponse ask(const HttpRequest& request) const {
        if (request.method != "POST") {
            // A question may be a wish, and a page of another site, a link or a look ahead can make a GET.
            HttpResponse response = server::refusal(405, "a question is a POST");
            response.headers.emplace_back("Allow", "POST");
            return response;
        }
        if (const auto refused = refusalOfCredentials(request)) {
            return *refused;
        }
        // Nor can it send this type without asking whether it may.
        if (const auto refused = server::refusalOfType(request)) {
            return *refused;
        }
        const auto document = documents::JsonReader::read(request.body);
        const auto* value = std::get_if<Value>(&document);
        const auto* members = value != nullptr ? value->dictionary() : nullptr;
        const auto* question = members != nullptr ? members->find("question") : nullptr;
        if (question == nullptr || question->string() == nullptr) {
            return server::refusal(400, "expected a question: {\"question\": \"Where is Ann?\"}");
        }
        return HttpResponse::json(200, platform::writeJson(assistant_.answer(*question->string(), now())));
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

    void run(const Command& command, HttpRequest request, const HttpReply& reply) {
        const int number = ++requests_;
        const Fault fault = setup_.faults.faultFor(number);
        if (fault.delaySeconds <= 0.0) {
            return reply.send(answer(command, request, fault, number));
        }
        http_.later(fault.delaySeconds, [this, command, fault, number, reply, late = std::move(request)] {
            reply.send(answer(command, late, fault, number));
        });
    }

    HttpResponse answer(const Command& command, const HttpRequest& request, const Fault& fault, int number) {
        const std::string name = command.name;
        HttpResponse response;
        if (fault.cut == Fault::Cut::BeforeAnswer) {
            report(number, name + ", reset");
            response.delivery.reset = true;
            return response;
        }
        if (!fault.redirect.empty()) {
            response.status = fault.redirectStatus;
            response.headers.emplace_back("Location", locationOf(fault.redirect, command));
            report(number, name + ", " + std::to_string(response.status) + ", redirected");
            return response;
        }
        const auto refused = refusal(request);
        response = refused ? *refused : ordinaryAnswer(command, request, fault);
        report(number, name + ", " + std::to_string(response.status));
        if (!refused) {
            spoil(fault, response);
        }
        return response;
    }

    HttpResponse ordinaryAnswer(const Command& command, const HttpRequest& request, const Fault& fault) const {
        const auto document = documents::JsonReader::read(request.body);
        const auto* value = std::get_if<Value>(&document);
        std::string complaint = "expected a JSON object as the body";
        if (value != nullptr && value->dictionary() != nullptr) {
            if (auto given = (service_.*command.answer)(*value->dictionary(), now(), fault, complaint)) {
                const int status = fault.status == 0 ? 200 : fault.status;
                return status < 300 ? HttpResponse::json(status, platform::writeJson(*given))
                                    : server::refusal(status, "a fault that was asked for");
            }
        }
        return server::refusal(400, complaint);
    }

    std::string locationOf(const std::string& redirect, const Command& command) const {
        std::string location = replaced(redirect, "{origin}", "https://localhost:" + std::to_string(port()));
        location = replaced(std::move(location), "{port}", std::to_string(port()));
        return replaced(std::move(location), "{path}", command.path());
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
    LocationService service_;
    AssistantAnswers assistant_;
    std::string authorization_;
    std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
    std::atomic<int> requests_ = 0;
    std::mutex reportMutex_;
    server::TlsContext::Context tls_;
    server::HttpServer http_;
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
