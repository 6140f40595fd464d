#include "platform/client/KTJSONCommand.h"

#include <algorithm>
#include <utility>

#include "platform/base/Json.h"

namespace ktr::platform {

namespace {

constexpr int kFirstSuccess = 200;
constexpr int kFirstRedirect = 300;

/// Base 64 with padding (RFC 4648, section 4).
std::string base64(const std::string& bytes) {
    static constexpr std::string_view kAlphabet = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string out;
    out.reserve((bytes.size() + 2) / 3 * 4);
    for (std::size_t at = 0; at < bytes.size(); at += 3) {
        const std::size_t count = std::min<std::size_t>(3, bytes.size() - at);
        unsigned group = 0;
        for (std::size_t i = 0; i < 3; ++i) {
            group = group << 8 | (i < count ? static_cast<unsigned char>(bytes[at + i]) : 0U);
        }
        for (std::size_t i = 0; i < 4; ++i) {
            out.push_back(i <= count ? kAlphabet[group >> (18 - 6 * i) & 0x3F] : '=');
        }
    }
    return out;
}

bool hasControlCharacter(const std::string& text) {
    return std::any_of(text.begin(), text.end(),
                       [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
}

}  // namespace

std::optional<std::string> basicAuthorization(const std::string& userName, const std::string& password) {
    if (userName.empty() || password.empty() || userName.find(':') != std::string::npos ||
        hasControlCharacter(userName) || hasControlCharacter(password)) {
        return std::nullopt;
    }
    return "Basic " + base64(userName + ":" + password);
}

bool KTJSONCommand::init() {
    return true;
}

std::string KTJSONCommand::path() const {
    return {};
}

HttpHeaders KTJSONCommand::headers() const {
    return {{"Content-Type", "application/json"}, {"Accept", "application/json"}};
}

Dictionary KTJSONCommand::jsonBodyDictionary() {
    return {};
}

std::optional<Dictionary> KTJSONCommand::jsonResponseDictionary() {
    return response_;
}

HttpRequest KTJSONCommand::makeRequest() {
    HttpRequest request;
    request.scheme = scheme_;
    request.host = host_;
    request.path = path();
    request.headers = headers();
    if (const auto authorization = basicAuthorization(userName_, password_)) {
        request.headers.set("Authorization", *authorization);
    }
    request.body = writeJson(jsonBodyDictionary());
    originalHost_ = host_;
    return request;
}

void KTJSONCommand::finish(HttpAnswer answer) {
    if (answer.failure != HttpFailure::None) {
        return;
    }
    if (answer.json && answer.json->dictionary() != nullptr) {
        response_ = *answer.json->dictionary();
    }
    successful_ = response_ && answer.status >= kFirstSuccess && answer.status < kFirstRedirect;
    // A host that could not serve the command is not one to remember.
    if (successful_) {
        redirectedHost_ = std::move(answer.redirectedHost);
    }
}

bool KTJSONCommand::hasLargeAnswer() const {
    constexpr std::size_t kMany = 100;
    return response_ && std::any_of(response_->begin(), response_->end(), [](const auto& entry) {
               const Dictionary* members = entry.second.dictionary();
               return members != nullptr && members->size() >= kMany;
           });
}

std::optional<Dictionary> KTJSONCommand::takeAnswer() {
    return std::exchange(response_, std::nullopt);
}

KTJSONCommand::CompletionBlock KTJSONCommand::takeCompletionBlock() {
    return std::exchange(completionBlock_, nullptr);
}

}  // namespace ktr::platform
