#include "linux/net/AssistantClient.h"

#include <QUrl>
#include <utility>

#include "platform/base/Json.h"

namespace ktr::linux_ {

using platform::HttpFailure;

namespace {

HttpsRequest exchangeFor(const AssistantClient::Settings& settings, const std::string& question) {
    HttpsRequest made;
    const auto origin = Origin::fromText(settings.host.value_or(""));
    if (origin && settings.authorization) {
        made.url =
            QUrl(QStringLiteral("https://") + QString::fromStdString(origin->text()) + QStringLiteral("/assistant"),
                 QUrl::StrictMode);
    }
    made.method = "POST";
    made.fields = {{"Content-Type", "application/json"},
                   {"Accept", "application/json"},
                   {"Accept-Language", settings.language.empty() ? "*" : settings.language},
                   {"User-Agent", "ktr"},
                   {"Authorization", settings.authorization.value_or("")}};
    made.body = platform::writeJson(platform::Dictionary{{"question", question}});
    made.deadline = AssistantClient::kDeadline;
    made.inactivityLimit = AssistantClient::kDeadline;
    made.maximumBytes = AssistantClient::kMaximumBytes;
    return made;
}

}  // namespace

AssistantClient::AssistantClient(std::function<Settings()> settings, std::shared_ptr<NetworkThread> thread)
    : settings_(std::move(settings)), client_(std::move(thread)) {}

AssistantClient::~AssistantClient() = default;

void AssistantClient::ask(const std::string& question, Completion completion) {
    const Settings settings = settings_();
    const auto ended = [this, host = settings.host.value_or(""), isSignedIn = settings.authorization.has_value(),
                        completion = std::move(completion)](HttpsAnswer heard) {
        Answer answer{heard.failure, heard.status, {}, std::move(heard.reason)};
        if (!isSignedIn) {
            answer.reason = "there is no account with a token";
        } else if (answer.hasBody()) {
            answer.body = std::move(heard.body);
        } else if (answer.failure == HttpFailure::None) {
            answer.reason = "its answer has the status " + std::to_string(answer.status);
        }
        if (answer.hasBody()) {
            trouble_.clear(host);
        } else if (answer.failure != HttpFailure::Cancelled && isSignedIn) {
            trouble_.say(host, answer.reason);
        }
        completion(std::move(answer));
    };
    client_.send(exchangeFor(settings, question), settings.certificateFiles, ended);
}

}  // namespace ktr::linux_
