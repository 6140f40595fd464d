#include "linux/configuration/SignInLink.h"

#include <algorithm>
#include <cctype>
#include <string_view>
#include <utility>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"

namespace ktr::linux_ {

namespace {

constexpr std::string_view kScheme = "https://";
constexpr std::string_view kPath = "/me/in";
constexpr std::string_view kQuery = "?link=";
constexpr std::size_t kLongestSecret = 100;

bool isBlank(unsigned char c) {
    return std::isspace(c) != 0;
}

std::string memberOf(const HttpsAnswer& answer, const char* name) {
    const auto read = documents::JsonReader::read(answer.body);
    const auto* value = std::get_if<platform::Value>(&read);
    const auto* members = value != nullptr ? value->dictionary() : nullptr;
    const auto* member = members != nullptr ? members->find(name) : nullptr;
    return member != nullptr && member->string() != nullptr ? *member->string() : std::string();
}

}  // namespace

std::optional<SignInLink> SignInLink::read(const std::string& typed) {
    std::string text = typed;
    text.erase(text.begin(), std::find_if_not(text.begin(), text.end(), isBlank));
    text.erase(std::find_if_not(text.rbegin(), text.rend(), isBlank).base(), text.end());
    const std::size_t query = text.find(kQuery);
    if (query == std::string::npos || query < kPath.size() ||
        text.compare(query - kPath.size(), kPath.size(), kPath) != 0) {
        return std::nullopt;
    }
    const std::string secret = text.substr(query + kQuery.size());
    const bool isSecret =
        !secret.empty() && secret.size() <= kLongestSecret &&
        std::all_of(secret.begin(), secret.end(), [](unsigned char c) { return std::isalnum(c) != 0; });
    const std::string address = text.substr(0, query - kPath.size());
    const auto host = address.size() > kScheme.size() ? ServiceCheck::hostOf(address) : std::nullopt;
    if (!isSecret || !host || address.find("://") == std::string::npos) {
        return std::nullopt;
    }
    return SignInLink(*host, secret);
}

void SignInLink::exchange(HttpsClient& client, const std::vector<std::string>& certificateFiles,
                          std::function<void(Exchanged)> done) const {
    HttpsRequest request;
    request.method = "POST";
    request.url = QUrl(QString::fromStdString(std::string(kScheme) + host_ + std::string(kPath)), QUrl::StrictMode);
    request.fields = {{"Content-Type", "application/json"}, {"Accept", "application/json"}};
    request.body = platform::writeJson(platform::Dictionary{{"link", secret_}});
    request.deadline = ServiceCheck::kDeadline;
    request.inactivityLimit = ServiceCheck::kDeadline;
    client.send(std::move(request), certificateFiles, [done = std::move(done)](const HttpsAnswer& answer) {
        const auto found = ServiceCheck::of(answer, 0.0, {});
        Exchanged exchanged{found.outcome, found.reason, memberOf(answer, "person"), memberOf(answer, "secret")};
        if (exchanged.outcome == ServiceCheck::Outcome::Fine &&
            (exchanged.person.empty() || exchanged.secret.empty())) {
            exchanged.outcome = ServiceCheck::Outcome::NoService;
            exchanged.reason = "its answer says neither person nor secret";
        }
        done(std::move(exchanged));
    });
}

}  // namespace ktr::linux_
