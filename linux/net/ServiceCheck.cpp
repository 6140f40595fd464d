#include "linux/net/ServiceCheck.h"

#include <algorithm>
#include <cctype>
#include <chrono>
#include <memory>

#include "documents/HttpTime.h"
#include "documents/JsonReader.h"
#include "linux/device/SystemClock.h"
#include "linux/net/ServicePolicy.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::linux_ {

namespace {

using Outcome = ServiceCheck::Outcome;
using platform::HttpFailure;

constexpr const char* kPath = "/qloxservice/friends/va/getlocations";

Outcome outcomeOf(HttpFailure failure) {
    switch (failure) {
        case HttpFailure::BadRequest:
            return Outcome::BadAddress;
        case HttpFailure::Tls:
            return Outcome::NotTrusted;
        case HttpFailure::BadAnswer:
        case HttpFailure::TooLarge:
        case HttpFailure::RedirectRefused:
            return Outcome::NoService;
        default:
            return Outcome::NothingAnswers;
    }
}

/// Whether it is what a service says: an object, whatever is in it.
bool isAnswer(const std::string& body) {
    const auto read = documents::JsonReader::read(body);
    return std::holds_alternative<platform::Value>(read) && std::get<platform::Value>(read).dictionary() != nullptr;
}

}  // namespace

std::optional<std::string> ServiceCheck::hostOf(const std::string& typed) {
    std::string text = typed;
    const auto isSpace = [](unsigned char c) { return std::isspace(c) != 0; };
    text.erase(text.begin(), std::find_if_not(text.begin(), text.end(), isSpace));
    text.erase(std::find_if_not(text.rbegin(), text.rend(), isSpace).base(), text.end());
    constexpr std::string_view kScheme = "https://";
    std::string start = text.substr(0, kScheme.size());
    std::transform(start.begin(), start.end(), start.begin(), [](unsigned char c) { return std::tolower(c); });
    if (start == kScheme) {
        text.erase(0, kScheme.size());
    }
    if (text.ends_with('/')) {
        text.pop_back();
    }
    const auto origin = Origin::fromText(text);
    return origin ? std::optional(origin->text()) : std::nullopt;
}

ServiceCheck::Result ServiceCheck::of(const HttpsAnswer& answer, double seconds, platform::Date now) {
    Result result;
    result.seconds = seconds;
    result.reason = answer.reason;
    if (answer.failure != HttpFailure::None) {
        result.outcome = outcomeOf(answer.failure);
        return result;
    }
    if (const auto told = documents::parseHttpTime(answer.field("Date"))) {
        // The answer was on its way for half the time, and a whole second is told as its beginning.
        result.ahead = now.secondsSinceReferenceDate - seconds / 2.0 - told->secondsSinceReferenceDate - 0.5;
    }
    const bool isService = isAnswer(answer.body);
    if (answer.status == 200 && isService) {
        result.outcome = Outcome::Fine;
    } else if (answer.status == 401 || answer.status == 403) {
        result.outcome = isService ? Outcome::Unknown : Outcome::NoService;
    } else if (answer.status >= 500 || answer.status == 429) {
        result.outcome = Outcome::Failing;
    } else {
        result.outcome = Outcome::NoService;
    }
    if (result.outcome != Outcome::Fine) {
        result.reason = "its answer has the status " + std::to_string(answer.status);
    }
    return result;
}

void ServiceCheck::run(HttpsClient& client, const Account& account, std::function<void(Result)> done) {
    const auto header = platform::basicAuthorization(account.person, account.secret);
    HttpsRequest request;
    request.method = "POST";
    request.url = QUrl(QStringLiteral("https://") + QString::fromStdString(account.host) + QLatin1String(kPath),
                       QUrl::StrictMode);
    if (!header || !Origin::fromText(account.host)) {
        // Fails without a byte sent, and as everything else does: not inside the call.
        request.url.clear();
    }
    request.fields = {{"Content-Type", "application/json"},
                      {"Accept", "application/json"},
                      {"X-Orcha-Seek-API-Ver", "4.0"},
                      {"X-Orcha-AuthScheme", "Forever"},
                      {"Authorization", header.value_or("")}};
    request.body = R"({"clientContext":{},"handles":[]})";
    request.mayFollow = [policy = ServicePolicy(account.host, account.domains)](const Origin& origin) {
        return policy.allows(origin);
    };
    request.deadline = kDeadline;
    request.inactivityLimit = kDeadline;
    const auto began = std::chrono::steady_clock::now();
    client.send(
        std::move(request), account.certificateFiles, [began, done = std::move(done)](const HttpsAnswer& answer) {
            const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - began).count();
            done(of(answer, seconds, SystemClock().now()));
        });
}

}  // namespace ktr::linux_
