#include "model/KTRVAMyLocation.h"

#include "model/PluginBundle.h"
#include "service/Common.h"

namespace ktr {

using platform::Dictionary;
using platform::VAKtrLocation;

namespace {

using WithVelaLocation = bool (KTRVAMyLocation::*)(bool, const std::shared_ptr<VAKtrLocation>&,
                                                   const std::optional<std::string>&);
using WithDictionary = bool (KTRVAMyLocation::*)(bool, const std::optional<Dictionary>&,
                                                 const std::optional<std::string>&);

}  // namespace

bool KTRVAMyLocation::initWithMyLocation(bool visible, const std::shared_ptr<VAKtrLocation>& velaLocation,
                                         const std::optional<std::string>& preferredEmail) {
    if (!init()) {
        return false;
    }
    decode(visible, std::nullopt, preferredEmail);
    if (velaLocation) {
        setVelaLocation(velaLocation);
    }
    return true;
}

bool KTRVAMyLocation::initWithMyLocation(bool visible, const std::optional<Dictionary>& dictionary,
                                         const std::optional<std::string>& preferredEmail) {
    if (!init()) {
        return false;
    }
    decode(visible, dictionary, preferredEmail);
    return true;
}

void KTRVAMyLocation::decode(bool visible, const std::optional<Dictionary>& dictionary,
                             const std::optional<std::string>& preferredEmail) {
    const auto common = Common::sharedInstance();
    decodeHandle(preferredEmail || !common ? preferredEmail : common->username(), nullptr, dictionary);
    isVisible_ = visible;
}

std::shared_ptr<KTRVAMyLocation> KTRVAMyLocation::myLocation(bool visible,
                                                             const std::shared_ptr<VAKtrLocation>& velaLocation,
                                                             const std::optional<std::string>& preferredEmail) {
    const WithVelaLocation initialiser = &KTRVAMyLocation::initWithMyLocation;
    return platform::create<KTRVAMyLocation>(initialiser, visible, velaLocation, preferredEmail);
}

std::shared_ptr<KTRVAMyLocation> KTRVAMyLocation::myLocation(bool visible, const std::optional<Dictionary>& dictionary,
                                                             const std::optional<std::string>& preferredEmail) {
    const WithDictionary initialiser = &KTRVAMyLocation::initWithMyLocation;
    return platform::create<KTRVAMyLocation>(initialiser, visible, dictionary, preferredEmail);
}

std::string KTRVAMyLocation::friendLocation(bool refreshFinished) const {
    return isVisible_ ? KTRVALocation::friendLocation(refreshFinished) : AssistantLocalizedString("HIDDEN_LOCATION");
}

std::shared_ptr<platform::Bundle> KTRVAMyLocation::bundle() {
    return KTRVALocation::bundle();
}

std::string KTRVAMyLocation::description() const {
    return std::string("<KTRVAMyLocation ") + (isVisible_ ? "visible" : "hidden") + ">";
}

}  // namespace ktr
