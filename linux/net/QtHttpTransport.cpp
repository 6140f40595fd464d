#include "linux/net/QtHttpTransport.h"

#include <QUrl>
#include <utility>
#include <variant>

#include "documents/JsonReader.h"

namespace ktr::linux_ {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

constexpr int kFirstSuccess = 200;
constexpr int kFirstRedirect = 300;

bool isSuccess(int status) {
    return status >= kFirstSuccess && status < kFirstRedirect;
}

/// Invalid for a path that cannot stand in an address.
QUrl urlOf(const Origin& origin, const std::string& path) {
    QUrl url(QStringLiteral("https://") + QString::fromStdString(origin.text()) + QString::fromStdString(path),
             QUrl::StrictMode);
    const bool isWhole = path.starts_with('/') && url.isValid() && Origin::fromUrl(url) == origin;
    return isWhole ? url : QUrl();
}

HttpsRequest exchangeFor(const platform::HttpRequest& request, const ServicePolicy& policy) {
    HttpsRequest made;
    made.method = "POST";
    made.fields = request.headers;
    made.fields.set("Accept-Language", "*");
    made.fields.set("User-Agent", "ktr");
    made.body = request.body;
    made.deadline = request.deadline;
    made.inactivityLimit = request.inactivityLimit;
    made.maximumBytes = request.maximumBytes;
    made.mayFollow = [policy](const Origin& origin) { return policy.allows(origin); };
    const auto allowed = [&policy](const std::string& host) {
        auto origin = Origin::fromText(host);
        return origin && policy.allows(*origin) ? origin : std::nullopt;
    };
    if (request.scheme != "https") {
        return made;
    }
    made.fallback = allowed(request.fallbackHost);
    if (const auto origin = allowed(request.host)) {
        made.url = urlOf(*origin, request.path);
    } else if (made.fallback) {
        made.url = urlOf(*made.fallback, request.path);
    }
    return made;
}

/// What is wrong with an answer, in words for a log line; empty when nothing is.
std::string complaintAbout(const HttpAnswer& answer) {
    if (answer.failure != HttpFailure::None) {
        return answer.failure == HttpFailure::Cancelled ? "" : answer.reason;
    }
    if (!isSuccess(answer.status)) {
        return "the answer has the status " + std::to_string(answer.status);
    }
    const bool isObject = answer.json && answer.json->dictionary() != nullptr;
    return isObject ? "" : "the answer is no JSON object, its status " + std::to_string(answer.status);
}

}  // namespace

QtHttpTransport::QtHttpTransport(std::function<Settings()> settings, std::shared_ptr<NetworkThread> thread)
    : settings_(std::move(settings)), client_(std::move(thread)) {}

QtHttpTransport::~QtHttpTransport() = default;

void QtHttpTransport::prepare() {
    Settings settings = settings_();
    if (current_ == settings) {
        return;
    }
    policy_ = ServicePolicy(settings.serviceHost.value_or(""), settings.domains);
    current_ = std::move(settings);
}

void QtHttpTransport::send(const platform::HttpRequest& request, Completion completion) {
    prepare();
    HttpsRequest exchange = exchangeFor(request, policy_);
    const auto asked = Origin::fromText(request.host);
    const bool isElsewhere = !asked || Origin::fromUrl(exchange.url) != asked;
    const auto ended = [this, request, asked, isElsewhere, completion = std::move(completion)](HttpsAnswer heard) {
        HttpAnswer answer;
        answer.failure = heard.failure;
        answer.reason = std::move(heard.reason);
        answer.status = heard.failure == HttpFailure::None ? heard.status : 0;
        answer.fromFallback = heard.fromFallback || (isElsewhere && !heard.origin.host.empty());
        const auto first = answer.fromFallback ? Origin::fromText(request.fallbackHost) : asked;
        if (!heard.origin.host.empty() && heard.origin != first) {
            answer.redirectedHost = heard.origin.text();
        }
        if (answer.failure == HttpFailure::None && isSuccess(answer.status)) {
            auto read = documents::JsonReader::read(heard.body);
            if (auto* value = std::get_if<platform::Value>(&read)) {
                answer.json = std::move(*value);
            }
        }
        const std::string host = heard.origin.host.empty() ? request.host : heard.origin.text();
        if (const std::string complaint = complaintAbout(answer); !complaint.empty()) {
            trouble_.say(host, complaint);
        } else if (answer.failure == HttpFailure::None) {
            trouble_.clear(host);
        }
        completion(std::move(answer));
    };
    client_.send(std::move(exchange), current_->certificateFiles, ended);
}

}  // namespace ktr::linux_
