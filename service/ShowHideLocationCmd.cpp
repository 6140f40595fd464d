#include "service/ShowHideLocationCmd.h"

#include "model/KTRVAMyLocation.h"
#include "model/LogCategory.h"
#include "service/KTRVAUtils.h"

namespace ktr {

using platform::Dictionary;
using platform::Value;

namespace {

/// Words the list only when the log keeps the line.
class DescribedAnswer : public platform::Object {
  public:
    explicit DescribedAnswer(const Dictionary& answer) : answer_(answer) {}
    std::string description() const override { return "(" + Value(answer_).description() + ")"; }

  private:
    const Dictionary& answer_;
};

std::optional<Dictionary> objectAt(const Dictionary& dictionary, const char* key) {
    const Value* value = dictionary.find(key);
    const Dictionary* object = value != nullptr ? value->dictionary() : nullptr;
    return object != nullptr ? std::optional(*object) : std::nullopt;
}

std::optional<std::string> preferredEmailOf(const std::optional<Dictionary>& myInfo) {
    const Value* value = myInfo ? myInfo->find("preferredEmail") : nullptr;
    const std::string* text = value != nullptr ? value->string() : nullptr;
    return text != nullptr ? std::optional(*text) : std::nullopt;
}

}  // namespace

std::string ShowHideLocationCmd::path() const {
    return std::string(KTRUrlBase) + "showHideLocation";
}

Dictionary ShowHideLocationCmd::jsonBodyDictionary() {
    Dictionary body = KTRBaseCmd::jsonBodyDictionary();
    // The body holds its own copy of the client context: the one that all commands share stays as it is.
    Dictionary context = objectAt(body, "clientContext").value_or(Dictionary());
    if (const auto location = currentLocationDictionary()) {
        context.set("location", *location);
    }
    body.set("clientContext", std::move(context));
    body.set("prefs", Dictionary{{"hideLocation", hideLocation_ ? "Yes" : "No"}});
    return body;
}

std::optional<Dictionary> ShowHideLocationCmd::currentLocationDictionary() const {
    return KTRVAUtils::dictionaryForLocation(currentLocation_);
}

std::optional<ServiceResult> ShowHideLocationCmd::result() {
    const auto response = jsonResponseDictionary();
    if (!response) {
        return ServiceResult();
    }
    ServiceResult found = {*response};
    const auto myInfo = objectAt(*response, "myInfo");
    const auto preferredEmail = preferredEmailOf(myInfo);
    auto context = objectAt(*response, "serverContext");
    if (preferredEmail) {
        context = context.value_or(Dictionary());
        context->set("preferredEmail", *preferredEmail);
    }
    LogCategory_Unspecified()->line("serverContextDictionary: %@", context);
    setContextIdentifierURL(KTRVAUtils::contextIdentifierURLForDictionary(context));
    LogCategory_Unspecified()->line("visibility_response: %@", std::make_shared<DescribedAnswer>(*response));
    found.emplace_back(KTRVAMyLocation::myLocation(!hideLocation_, myInfo, preferredEmail));
    return found;
}

}  // namespace ktr
