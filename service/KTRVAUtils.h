#pragma once

#include <memory>
#include <optional>

#include "platform/assistant/VALocation.h"
#include "platform/base/Date.h"
#include "platform/base/Url.h"
#include "platform/base/Value.h"
#include "platform/location/PlatformLocation.h"

namespace ktr {

/// Between the service's conventions and the platform's: times, context URLs and position dictionaries. The service
/// counts milliseconds since 1970-01-01 UTC, the platform seconds since 2001-01-01 UTC; fractions are kept. Stateless;
/// nothing here reports an error: what cannot be converted gives none.
class KTRVAUtils {
  public:
    /// Milliseconds since 1970 as seconds since the reference date; none for none. Any thread.
    static std::optional<double> timeIntervalForMillisecondsSince1970(const std::optional<double>& milliseconds);
    /// Seconds since the reference date as milliseconds since 1970, not rounded; none for none. Any thread.
    static std::optional<double> millisecondsSince1970ForTimeInterval(const std::optional<double>& timeInterval);

    /// Now minus the hours, minutes and seconds that the clock face shows, in the user's calendar. The fraction of the
    /// present second stays, so the moment lies up to one second after midnight. Main thread.
    static platform::Date todayAtMidnight();
    /// `todayAtMidnight` minus 86400 seconds, also across a daylight-saving change. Main thread.
    static platform::Date yesterdayAtMidnight();

    /// "ktrServerContext://serverContext?" and one "key=value&" a member, in the dictionary's order. Values that are no
    /// strings are written as `Value::description` says; everything but letters, digits and "-._~" is percent-escaped
    /// (RFC 3986). A member "authToken", at whatever depth, is never written. None for none. Any thread.
    static std::optional<platform::Url> contextIdentifierURLForDictionary(
        const std::optional<platform::Dictionary>& dictionary);
    /// The members of a context URL; empty when nothing is usable. As many characters as the prefix has are dropped,
    /// whatever they are. A piece that is not exactly one key and one value, or that does not unescape to UTF-8, is
    /// skipped. A value of an optional sign and decimal digits becomes an integer, saturated to 32 bits; every other
    /// one stays a string. A later key overwrites an earlier one. "+" is no blank. Any thread.
    static platform::Dictionary contextDictionaryForURL(const platform::Url& url);

    /// A position with the object's coordinate and accuracy, fixed now. None for none, and when latitude or longitude
    /// is missing or 0: a place on the equator or the prime meridian counts as unknown. Main thread.
    static std::shared_ptr<platform::PlatformLocation> geoLocationForVALocation(
        const std::shared_ptr<platform::VALocation>& location);
    /// The position as the service wants it: "latitude", "longitude", "source", "horizontalAccuracy" unless 0,
    /// "timestamp" (milliseconds since 1970) unless missing or exactly the reference date. No position reads as one at
    /// 0, 0; an invalid coordinate gives none. Any thread.
    static std::optional<platform::Dictionary> dictionaryForLocation(
        const std::shared_ptr<platform::PlatformLocation>& location);

    /// Always true: the friend-location app is taken to be there.
    static bool isKTRAppInstalled();
};

}  // namespace ktr
