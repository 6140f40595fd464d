#include "host/asking/ServiceRequests.h"

#include <utility>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/DeviceInformation.h"
#include "platform/base/Json.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Region.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/HttpTransport.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::host {

using ask::ServiceReply;
using platform::Dictionary;

namespace {

constexpr const char* kCommands = "/qloxservice/friends/va/";
constexpr int kPartial = 416;
/// Somebody waits for the answer.
constexpr double kDeadline = 20.0;

ServiceReply replyOf(const platform::HttpAnswer& answer) {
    using Failure = ServiceReply::Failure;
    if (answer.failure != platform::HttpFailure::None) {
        return {Failure::Unreachable};
    }
    if (answer.status == 401) {
        return {Failure::NotSignedIn};
    }
    // What the service does not have, or does not do: said, and nothing else is wrong.
    if (answer.status == 403 || answer.status == 404 || answer.status == 409 || answer.status == 429) {
        return {Failure::Refused};
    }
    const Dictionary* body = answer.json ? answer.json->dictionary() : nullptr;
    const auto* code = body == nullptr ? nullptr : body->find("statusCode");
    const auto status = code == nullptr ? std::nullopt : code->number();
    if (answer.status < 200 || answer.status > 299 || !status || (*status != 200 && *status != kPartial)) {
        return {Failure::Unreachable};
    }
    return {Failure::None, *body};
}

/// What the labels of an answer are worded by, as in the plugin's own requests: sentence and row say the same.
Dictionary contextOf(const platform::Platform& platform, const std::string& language) {
    Dictionary context;
    const auto assistants = platform.assistant ? platform.assistant->languageCode() : std::nullopt;
    if (!language.empty() || assistants) {
        context.set("locale", language.empty() ? *assistants : language);
    }
    if (const auto country = platform.region ? platform.region->countryCode() : std::nullopt) {
        context.set("regionCode", *country);
    }
    return context;
}

}  // namespace

void ServiceRequests::send(ask::ServiceRequest wanted, Completion completion) {
    const auto platform = platform_();
    const auto account = platform->accounts ? platform->accounts->deviceOwnerAccount() : nullptr;
    const auto host = account ? account->hostNameOfType(platform::kFriendLocationService) : std::nullopt;
    const auto token = account ? account->tokenOfType(platform::kFriendLocationService) : std::nullopt;
    const auto authorization =
        token ? platform::basicAuthorization(account->personIdentifier().value_or(""), *token) : std::nullopt;
    if (!host || !authorization || !platform->httpTransport) {
        return completion({ServiceReply::Failure::NotSignedIn});
    }
    Dictionary body{{"clientContext", contextOf(*platform, wanted.language)}};
    for (const auto& [name, value] : wanted.members) {
        body.set(name, value);
    }
    platform::HttpRequest request;
    request.scheme = "https";
    request.host = *host;
    request.path = kCommands + wanted.command;
    request.headers = {{"Content-Type", "application/json"},
                       {"Authorization", *authorization},
                       {"X-Orcha-Seek-API-Ver", "4.0"},
                       {"X-Orcha-AuthScheme", "Forever"}};
    request.body = platform::writeJson(body);
    request.deadline = kDeadline;
    const auto loop = platform->mainLoop;
    platform->httpTransport->send(request,
                                  [loop, completion = std::move(completion)](const platform::HttpAnswer& answer) {
                                      loop->post([reply = replyOf(answer), completion] { completion(reply); });
                                  });
}

}  // namespace ktr::host
