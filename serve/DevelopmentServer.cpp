#include "serve/DevelopmentServer.h"

#include <httplib.h>
#include <sys/socket.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <optional>
#include <thread>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "serve/AssistantAnswers.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr const char* kAddress = "127.0.0.1";
constexpr const char* kJson = "application/json";
constexpr const char* kCommands = "/qloxservice/friends/va/";
constexpr std::size_t kLargestRequest = std::size_t{1} << 20;
constexpr std::size_t kDeepBrackets = 1000000;

/// One of the service's commands: the last part of its path, and who answers it.
struct Command {
    const char* name;
    std::optional<Dictionary> (LocationService::*answer)(const Dictionary&, const ServiceMoment&, const Fault&,
                                                         std::string&) const;
    std::string path() const { return std::string(kCommands) + name; }
};

std::string errorBody(int status, const std::string& message) {
    return platform::writeJson(Dictionary{{"statusCode", status}, {"message", message}});
}

/// Takes as long for every pair of texts of the same length.
bool sameText(const std::string& one, const std::string& other) {
    unsigned difference = one.size() == other.size() ? 0U : 1U;
    for (std::size_t i = 0; i < one.size() && i < other.size(); ++i) {
        difference |= static_cast<unsigned>(static_cast<unsigned char>(one[i]) ^ static_cast<unsigned char>(other[i]));
    }
    return difference == 0;
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
          service_(setup_.friends),
          assistant_(service_),
          authorization_(httplib::make_basic_authentication_header(setup_.personId, setup_.token).second),
          http_([this](SSL_CTX& context) { return prepareTls(context); }) {
        prepareHttp();
    }

    bool start() {
        if (!http_.is_valid()) {
            return false;
        }
        port_ = setup_.port == 0 ? http_.bind_to_any_port(kAddress)
                                 : (http_.bind_to_port(kAddress, setup_.port) ? setup_.port : -1);
        if (port_ <= 0) {
            return false;
        }
        thread_ = std::thread([this] { http_.listen_after_bind(); });
        // `stop` has no effect on a server that has not begun; what connects until then waits in the port's queue.
        while (!http_.is_running()) {
            std::this_thread::yield();
        }
        return true;
    }

    void stop() {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            stopping_ = true;
        }
        wake_.notify_all();
        if (thread_.joinable()) {
            http_.stop();
            thread_.join();
        }
    }

    int port() const { return port_; }

  private:
    bool prepareTls(SSL_CTX& context) {
        return SSL_CTX_set_min_proto_version(&context, TLS1_2_VERSION) == 1 &&
               SSL_CTX_use_certificate(&context, setup_.certificate.certificate.get()) == 1 &&
               SSL_CTX_use_PrivateKey(&context, setup_.certificate.key.get()) == 1;
    }

    void prepareHttp() {
        http_.set_tcp_nodelay(true);
        http_.set_keep_alive_max_count(1000);
        http_.set_read_timeout(2);
        http_.set_payload_max_length(kLargestRequest);
        http_.set_pre_routing_handler([this](const httplib::Request& request, httplib::Response& response) {
            return refuseOtherHosts(request, response);
        });
        for (const Command& command : {Command{"getlocations", &LocationService::getLocations},
                                       Command{"showHideLocation", &LocationService::showHideLocation}}) {
            http_.Post(command.path(), [this, command](const httplib::Request& request, httplib::Response& response) {
                run(command, request, response);
            });
        }
        http_.Get("/assistant",
                  [this](const httplib::Request& request, httplib::Response& response) { ask(request, response); });
        http_.set_error_handler([](const httplib::Request&, httplib::Response& response) {
            if (response.body.empty() && !response.has_header("Content-Length") && response.status == 404) {
                response.set_content(errorBody(404, "there is no such path"), kJson);
            }
        });
    }

    /// A web page that resolves its own name to loopback must not read the answers.
    httplib::Server::HandlerResponse refuseOtherHosts(const httplib::Request& request, httplib::Response& response) {
        const std::string port = ":" + std::to_string(port_);
        const std::string host = request.get_header_value("Host");
        for (const char* own : {"localhost", "127.0.0.1", "[::1]", "elsewhere.localhost"}) {
            if (host == own + port || host == own) {
                return httplib::Server::HandlerResponse::Unhandled;
            }
        }
        response.status = 421;
        response.set_content(errorBody(421, "this service is for localhost alone"), kJson);
        return httplib::Server::HandlerResponse::Handled;
    }

    ServiceMoment now() const {
        const std::chrono::duration<double> since = std::chrono::steady_clock::now() - start_;
        const std::chrono::duration<double, std::milli> epoch = std::chrono::system_clock::now().time_since_epoch();
        return {since.count(), epoch.count()};
    }

    /// False when the service stops before the time is over.
    bool wait(double seconds) {
        std::unique_lock<std::mutex> lock(mutex_);
        return !wake_.wait_for(lock, std::chrono::duration<double>(seconds), [this] { return stopping_; });
    }

    void report(int number, const std::string& what) {
        const std::lock_guard<std::mutex> lock(reportMutex_);
        if (setup_.report) {
            setup_.report("request " + std::to_string(number) + ": " + what);
        }
    }

    void ask(const httplib::Request& request, httplib::Response& response) {
        if (!request.has_param("q")) {
            response.status = 400;
            response.set_content(errorBody(400, "expected a question: /assistant?q=where%20is%20ann"), kJson);
            return;
        }
        response.set_content(platform::writeJson(assistant_.answer(request.get_param_value("q"), now())), kJson);
    }

    /// What is wrong with the request around its body: an HTTP status and a sentence.
    std::optional<std::pair<int, std::string>> refusal(const httplib::Request& request) const {
        if (!sameText(request.get_header_value("Authorization"), authorization_)) {
            return std::pair(401, std::string("the credentials are missing or wrong"));
        }
        if (request.get_header_value("X-Orcha-Seek-API-Ver") != "4.0") {
            return std::pair(400, std::string("expected the header X-Orcha-Seek-API-Ver: 4.0"));
        }
        if (request.get_header_value("X-Orcha-AuthScheme") != "Forever") {
            return std::pair(400, std::string("expected the header X-Orcha-AuthScheme: Forever"));
        }
        if (request.get_header_value("Content-Type").rfind(kJson, 0) != 0) {
            return std::pair(415, std::string("expected the header Content-Type: application/json"));
        }
        return std::nullopt;
    }

    void run(const Command& command, const httplib::Request& request, httplib::Response& response) {
        const int number = ++requests_;
        const std::string name = command.name;
        const Fault fault = setup_.faults.faultFor(number);
        if (fault.delaySeconds > 0.0 && !wait(fault.delaySeconds)) {
            return;
        }
        if (fault.cut == Fault::Cut::BeforeAnswer) {
            report(number, name + ", reset");
            reset(request);
            return;
        }
        if (!fault.redirect.empty()) {
            response.status = fault.redirectStatus;
            response.set_header("Location", locationOf(fault.redirect, command));
            report(number, name + ", " + std::to_string(response.status) + ", redirected");
            return;
        }
        if (const auto refused = refusal(request)) {
            response.status = refused->first;
            if (refused->first == 401) {
                response.set_header("WWW-Authenticate", "Basic realm=\"ktr serve\"");
            }
            response.set_content(errorBody(refused->first, refused->second), kJson);
            report(number, name + ", " + std::to_string(response.status));
            return;
        }
        std::string body = answer(command, request, fault, response);
        report(number, name + ", " + std::to_string(response.status));
        send(fault, bodyOf(fault, std::move(body)), response);
    }

    std::string answer(const Command& command, const httplib::Request& request, const Fault& fault,
                       httplib::Response& response) const {
        const auto document = documents::JsonReader::read(request.body);
        const auto* value = std::get_if<Value>(&document);
        std::string complaint = "expected a JSON object as the body";
        if (value != nullptr && value->dictionary() != nullptr) {
            if (auto given = (service_.*command.answer)(*value->dictionary(), now(), fault, complaint)) {
                response.status = fault.status == 0 ? 200 : fault.status;
                return response.status < 300 ? platform::writeJson(*given)
                                             : errorBody(response.status, "a fault that was asked for");
            }
        }
        response.status = 400;
        return errorBody(400, complaint);
    }

    std::string locationOf(const std::string& redirect, const Command& command) const {
        std::string location = replaced(redirect, "{origin}", "https://localhost:" + std::to_string(port_));
        location = replaced(std::move(location), "{port}", std::to_string(port_));
        return replaced(std::move(location), "{path}", command.path());
    }

    static void reset(const httplib::Request& request) {
        const int socket = SSL_get_fd(request.ssl);
        const linger atOnce{1, 0};
        ::setsockopt(socket, SOL_SOCKET, SO_LINGER, &atOnce, sizeof atOnce);
        ::shutdown(socket, SHUT_RDWR);
    }

    void send(const Fault& fault, std::string body, httplib::Response& response) {
        if (fault.body == Fault::Body::Endless) {
            response.set_chunked_content_provider(kJson, [this, fault](std::size_t, httplib::DataSink& sink) {
                const std::string block(fault.bytesPerSecond > 0.0 ? 1 : 65536, ' ');
                return pace(fault, block.size()) && sink.write(block.data(), block.size());
            });
            return;
        }
        if (fault.cut == Fault::Cut::None && fault.bytesPerSecond <= 0.0) {
            response.set_content(body, kJson);
            return;
        }
        const std::size_t end = fault.cut == Fault::Cut::AfterHeaders ? 0
                                : fault.cut == Fault::Cut::InBody     ? body.size() / 2
                                                                      : body.size();
        const std::size_t promised = body.size();
        response.set_content_provider(
            promised, kJson,
            [this, fault, end, text = std::move(body)](std::size_t offset, std::size_t, httplib::DataSink& sink) {
                const std::size_t step = fault.bytesPerSecond > 0.0 ? 1 : end;
                const std::size_t count = std::min(step, end - std::min(end, offset));
                return count > 0 && pace(fault, count) && sink.write(text.data() + offset, count);
            });
    }

    bool pace(const Fault& fault, std::size_t bytes) {
        return wait(fault.bytesPerSecond > 0.0 ? static_cast<double>(bytes) / fault.bytesPerSecond : 0.0);
    }

    Setup setup_;
    LocationService service_;
    AssistantAnswers assistant_;
    std::string authorization_;
    httplib::SSLServer http_;
    std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
    std::thread thread_;
    std::atomic<int> requests_ = 0;
    int port_ = 0;
    std::mutex reportMutex_;
    std::mutex mutex_;
    std::condition_variable wake_;
    bool stopping_ = false;
};

DevelopmentServer::DevelopmentServer(Setup setup) : server_(std::make_unique<Server>(std::move(setup))) {}

DevelopmentServer::~DevelopmentServer() {
    stop();
}

bool DevelopmentServer::start() {
    return server_->start();
}

void DevelopmentServer::stop() {
    server_->stop();
}

int DevelopmentServer::port() const {
    return server_->port();
}

}  // namespace ktr::serve
