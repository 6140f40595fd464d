#include "service/KTRBaseCmd.h"

#include "model/LogCategory.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/DeviceInformation.h"
#include "platform/base/Platform.h"
#include "platform/base/Region.h"
#include "service/Common.h"
#include "service/ContextValues.h"
#include "service/JsonInteger.h"

namespace ktr {

using platform::Dictionary;
using platform::Platform;

namespace {

constexpr double kMillisecondsASecond = 1000.0;

class StaticClientContext {
  public:
    static std::shared_ptr<StaticClientContext> makeShared();
    std::shared_ptr<const Dictionary> members;
};

std::shared_ptr<StaticClientContext> StaticClientContext::makeShared() {
    Dictionary members;
    const auto add = [&members](const char* key, const std::optional<std::string>& value) {
        if (value) {
            members.set(key, *value);
        }
    };
    if (const auto common = Common::sharedInstance()) {
        add("deviceUDID", common->deviceUDID());
        add("productType", common->productType());
        add("osVersion", common->osVersion());
        add("buildVersion", common->buildVersion());
    }
    const auto installed = Platform::installed();
    add("locale", installed->assistant ? installed->assistant->languageCode() : std::nullopt);
    add("countryCode", installed->geographicSettings ? installed->geographicSettings->countryCode() : std::nullopt);
    add("regionCode", installed->region ? installed->region->countryCode() : std::nullopt);
    auto context = std::make_shared<StaticClientContext>();
    context->members = std::make_shared<const Dictionary>(std::move(members));
    LogCategory_Unspecified()->line("KTRVela: static client context: %@", *context->members);
    return context;
}

}  // namespace

bool KTRBaseCmd::init() {
    if (!KTJSONCommand::init()) {
        return false;
    }
    setScheme("https");
    if (const auto common = Common::sharedInstance()) {
        setUserName(common->personID());
        setPassword(common->appToken());
        setHost(common->redirectedHost());
        if (host().empty()) {
            setHost(common->ktrHost());
        }
    }
    // What it is made of belongs to the main thread: from here on any thread finds it made.
    staticClientContext();
    return true;
}

platform::HttpHeaders KTRBaseCmd::headers() const {
    platform::HttpHeaders headers = KTJSONCommand::headers();
    headers.set("X-Orcha-Seek-API-Ver", "4.0");
    headers.set("X-Orcha-AuthScheme", "Forever");
    return headers;
}

Dictionary KTRBaseCmd::jsonBodyDictionary() {
    Dictionary body = KTJSONCommand::jsonBodyDictionary();
    body.set("clientContext", *staticClientContext());
    return body;
}

std::optional<Dictionary> KTRBaseCmd::jsonResponseDictionary() {
    auto response = KTJSONCommand::jsonResponseDictionary();
    const platform::Value* code = response ? response->find("statusCode") : nullptr;
    statusCode_ = code != nullptr && !code->isNull() ? std::optional(jsonInteger(code)) : std::nullopt;
    return response;
}

std::shared_ptr<const Dictionary> KTRBaseCmd::staticClientContext() {
    const auto context = platform::shared<StaticClientContext>();
    return context ? context->members : std::make_shared<const Dictionary>();
}

double KTRBaseCmd::minCallbackInterval() {
    const auto response = jsonResponseDictionary();
    const platform::Value* context = response ? response->find("serverContext") : nullptr;
    if (context == nullptr || context->dictionary() == nullptr) {
        return 0.0;
    }
    return ContextValues::number(*context->dictionary(), "minCallbackIntervalInMS") / kMillisecondsASecond;
}

std::optional<ServiceResult> KTRBaseCmd::result() {
    return std::nullopt;
}

}  // namespace ktr
