#include "views/MapSentences.h"

#include <array>
#include <cmath>
#include <optional>

#include "model/LabelUtil.h"
#include "model/PluginBundle.h"
#include "platform/base/Format.h"
#include "platform/base/LengthFormatter.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"
#include "platform/location/Geodesy.h"
#include "service/KTRVAUtils.h"

namespace ktr {

using platform::FormatArguments;
using platform::Platform;
using platform::PlatformLocation;

namespace {

std::string sentence(const char* key, const FormatArguments& arguments) {
    return platform::formatted(AssistantLocalizedString(key), arguments);
}

/// The second sentence after the first, as the language parts them.
void append(std::string& text, const std::string& next) {
    text = text.empty() ? next : sentence("ACCESSIBILITY_MAP_SENTENCES", {text, next});
}

/// Metres from a place to the one on the other side of the earth: who is less sure than that knows nothing.
constexpr double kFarthest = 2.01e7;

/// A length aloud, for one that is greater than 0 and found on earth: others come from mistakes, with hundreds of
/// digits to listen to.
void appendLength(std::string& text, const char* key, const std::optional<double>& metres) {
    const auto lengths = Platform::installed()->lengths;
    if (lengths && metres && *metres > 0.0 && *metres <= kFarthest) {
        append(text, sentence(key, {lengths->textForMetres(*metres, platform::LengthWidth::Spoken)}));
    }
}

const char* directionKey(double azimuth) {
    static constexpr std::array kKeys = {"ACCESSIBILITY_MAP_NORTH", "ACCESSIBILITY_MAP_NORTHEAST",
                                         "ACCESSIBILITY_MAP_EAST",  "ACCESSIBILITY_MAP_SOUTHEAST",
                                         "ACCESSIBILITY_MAP_SOUTH", "ACCESSIBILITY_MAP_SOUTHWEST",
                                         "ACCESSIBILITY_MAP_WEST",  "ACCESSIBILITY_MAP_NORTHWEST"};
    const auto eighths = static_cast<std::size_t>(std::lround(azimuth / 45.0));
    return kKeys[eighths % kKeys.size()];
}

/// How far and in which direction from the user, the distance in the words of the row; no direction leads to where the
/// user is.
void appendWay(std::string& text, const std::shared_ptr<PlatformLocation>& user,
               const std::shared_ptr<PlatformLocation>& place, const std::optional<std::string>& distance) {
    const auto geodesy = Platform::installed()->geodesy;
    if (!user || !place || !geodesy || !distance || distance->empty()) {
        return;
    }
    const double azimuth = geodesy->azimuth(user->coordinate(), place->coordinate());
    append(text, std::isfinite(azimuth) ? sentence(directionKey(azimuth), {*distance})
                                        : sentence("ACCESSIBILITY_MAP_SAME_PLACE", {}));
}

std::string shownLabel(const std::string& label) {
    return LabelUtil::isDefaultLabel(label) ? AssistantLocalizedString(label) : label;
}

}  // namespace

std::string MapSentences::ofFriend(const KTRVALocation& record, const std::shared_ptr<PlatformLocation>& user) {
    const auto object = record.velaLocation();
    const auto place = KTRVAUtils::geoLocationForVALocation(object);
    if (!place) {
        return sentence("ACCESSIBILITY_MAP_UNKNOWN", {record.friendName()});
    }
    const bool hasName = object->label || object->city || object->stateCode;
    std::string text = hasName ? sentence("ACCESSIBILITY_MAP_FRIEND_AT",
                                          {record.friendName(), shownLabel(record.friendLocation(true))})
                               : sentence("ACCESSIBILITY_MAP_FRIEND", {record.friendName()});
    appendLength(text, "ACCESSIBILITY_MAP_ACCURACY", object->accuracy);
    appendWay(text, user, place, record.distanceFromLocation(user));
    return text;
}

std::string MapSentences::ofFence(const platform::VAKtrGeoFence& fence, const std::shared_ptr<PlatformLocation>& user) {
    const auto place = KTRVAUtils::geoLocationForVALocation(fence.location);
    // The names that the row has for it: a fence's default label is looked up in small letters, a friend's is not.
    const auto label = fence.location ? fence.location->label : std::nullopt;
    const std::string name =
        label && !label->empty()
            ? shownLabel(LabelUtil::isDefaultLabel(label) ? platform::asciiLowercased(*label) : *label)
        : fence.location ? fence.location->street.value_or("")
                         : "";
    std::string text =
        name.empty() ? sentence("ACCESSIBILITY_MAP_FENCE", {}) : sentence("ACCESSIBILITY_MAP_FENCE_AT", {name});
    appendLength(text, "ACCESSIBILITY_MAP_RADIUS", fence.location ? fence.location->accuracy : std::nullopt);
    if (user && place) {
        appendWay(text, user, place, KTRVALocation::distanceCalculator()->localizedDistance(*user, *place));
    }
    return text;
}

std::string MapSentences::ofUser(const std::shared_ptr<PlatformLocation>& user) {
    if (!user) {
        return sentence("ACCESSIBILITY_MAP_YOU_UNKNOWN", {});
    }
    std::string text = sentence("ACCESSIBILITY_MAP_YOU", {});
    appendLength(text, "ACCESSIBILITY_MAP_ACCURACY", user->fix().horizontalAccuracy);
    return text;
}

}  // namespace ktr
