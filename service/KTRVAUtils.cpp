#include "service/KTRVAUtils.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <string>
#include <string_view>

#include "platform/base/Assert.h"
#include "platform/base/Clock.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"

namespace ktr {

using platform::Date;
using platform::Dictionary;
using platform::PlatformLocation;
using platform::Url;
using platform::Value;

namespace {

constexpr std::string_view kContextPrefix = "ktrServerContext://serverContext?";
/// The account's own secret: it never goes into a URL.
constexpr std::string_view kTokenKey = "authToken";
constexpr double kSecondsADay = 86400.0;

bool isUnreserved(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '-' || c == '.' ||
           c == '_' || c == '~';
}

std::string percentEscaped(std::string_view text) {
    static constexpr std::string_view kHex = "0123456789ABCDEF";
    std::string out;
    out.reserve(text.size());
    for (const char c : text) {
        if (isUnreserved(c)) {
            out.push_back(c);
        } else {
            const auto byte = static_cast<unsigned char>(c);
            out.push_back('%');
            out.push_back(kHex[byte >> 4]);
            out.push_back(kHex[byte & 0xF]);
        }
    }
    return out;
}

/// The same without any member of the token's name, however deep.
Value withoutToken(const Value& value) {
    if (const Dictionary* dictionary = value.dictionary()) {
        Dictionary out;
        for (const auto& [key, member] : *dictionary) {
            if (key != kTokenKey) {
                out.set(key, withoutToken(member));
            }
        }
        return out;
    }
    if (const Value::Array* array = value.array()) {
        Value::Array out;
        for (const Value& element : *array) {
            out.push_back(withoutToken(element));
        }
        return out;
    }
    return value;
}

int hexDigit(char c) {
    if (c >= '0' && c <= '9') {
        return c - '0';
    }
    const char lower = static_cast<char>(c | 0x20);
    return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}

/// None for an incomplete or invalid sequence, and for bytes that are no UTF-8.
std::optional<std::string> percentUnescaped(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (text[at] != '%') {
            out.push_back(text[at]);
            continue;
        }
        if (at + 2 >= text.size()) {
            return std::nullopt;
        }
        const int high = hexDigit(text[at + 1]);
        const int low = hexDigit(text[at + 2]);
        if (high < 0 || low < 0) {
            return std::nullopt;
        }
        out.push_back(static_cast<char>(static_cast<unsigned char>(high * 16 + low)));
        at += 2;
    }
    return platform::isValidUtf8(out) ? std::optional<std::string>(std::move(out)) : std::nullopt;
}

/// An integer, saturated to 32 bits, for an optional sign and decimal digits; else the string.
Value contextValue(std::string text) {
    std::string_view digits = text;
    const bool negative = digits.starts_with('-');
    if (negative || digits.starts_with('+')) {
        digits.remove_prefix(1);
    }
    if (digits.empty() || digits.find_first_not_of("0123456789") != std::string_view::npos) {
        return Value(std::move(text));
    }
    const std::int64_t limit =
        negative ? -std::int64_t{std::numeric_limits<std::int32_t>::min()} : std::numeric_limits<std::int32_t>::max();
    std::int64_t number = 0;
    for (const char digit : digits) {
        number = std::min(number * 10 + (digit - '0'), limit);
    }
    return Value(negative ? -number : number);
}

/// What is left when as many characters as the prefix has are dropped, whatever they are.
std::string_view withoutPrefix(std::string_view text) {
    std::size_t at = 0;
    for (std::size_t dropped = 0; dropped < kContextPrefix.size() && at < text.size(); ++dropped) {
        at += platform::decodeUtf8(text, at).length;
    }
    return text.substr(at);
}

void addPiece(std::string_view piece, Dictionary& dictionary) {
    const auto equals = piece.find('=');
    if (equals == std::string_view::npos || piece.find('=', equals + 1) != std::string_view::npos) {
        return;
    }
    auto key = percentUnescaped(piece.substr(0, equals));
    auto value = percentUnescaped(piece.substr(equals + 1));
    if (key && value) {
        dictionary.set(std::move(*key), contextValue(std::move(*value)));
    }
}

}  // namespace

std::optional<double> KTRVAUtils::timeIntervalForMillisecondsSince1970(const std::optional<double>& milliseconds) {
    if (!milliseconds) {
        return std::nullopt;
    }
    return *milliseconds / 1000.0 - platform::kSecondsFrom1970ToReferenceDate;
}

std::optional<double> KTRVAUtils::millisecondsSince1970ForTimeInterval(const std::optional<double>& timeInterval) {
    if (!timeInterval) {
        return std::nullopt;
    }
    return (*timeInterval + platform::kSecondsFrom1970ToReferenceDate) * 1000.0;
}

Date KTRVAUtils::todayAtMidnight() {
    KTR_ASSERT_MAIN_THREAD();
    const auto installed = platform::Platform::installed();
    const Date now = installed->clock->now();
    const auto time = installed->calendar->timeOfDay(now);
    return installed->calendar->adding({-time.hour, -time.minute, -time.second}, now);
}

Date KTRVAUtils::yesterdayAtMidnight() {
    return {todayAtMidnight().secondsSinceReferenceDate - kSecondsADay};
}

std::optional<Url> KTRVAUtils::contextIdentifierURLForDictionary(const std::optional<Dictionary>& dictionary) {
    if (!dictionary) {
        return std::nullopt;
    }
    std::string text(kContextPrefix);
    for (const auto& [key, value] : *dictionary) {
        if (key != kTokenKey) {
            text += percentEscaped(key) + "=" + percentEscaped(withoutToken(value).description()) + "&";
        }
    }
    return Url::fromText(std::move(text));
}

Dictionary KTRVAUtils::contextDictionaryForURL(const Url& url) {
    Dictionary dictionary;
    std::string_view rest = withoutPrefix(url.text());
    while (!rest.empty()) {
        const auto end = std::min(rest.find('&'), rest.size());
        addPiece(rest.substr(0, end), dictionary);
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    return dictionary;
}

std::shared_ptr<PlatformLocation> KTRVAUtils::geoLocationForVALocation(
    const std::shared_ptr<platform::VALocation>& location) {
    KTR_ASSERT_MAIN_THREAD();
    const double latitude = location ? location->latitude.value_or(0.0) : 0.0;
    const double longitude = location ? location->longitude.value_or(0.0) : 0.0;
    if (latitude == 0.0 || longitude == 0.0) {
        return nullptr;
    }
    PlatformLocation::Fix fix;
    fix.coordinate = {latitude, longitude};
    fix.horizontalAccuracy = location->accuracy.value_or(0.0);
    fix.timestamp = platform::currentPlatform()->clock->now();
    return std::make_shared<PlatformLocation>(fix);
}

std::optional<Dictionary> KTRVAUtils::dictionaryForLocation(const std::shared_ptr<PlatformLocation>& location) {
    const PlatformLocation::Fix fix = location ? location->fix() : PlatformLocation::Fix{};
    if (!platform::isValid(fix.coordinate)) {
        return std::nullopt;
    }
    Dictionary dictionary{
        {"latitude", fix.coordinate.latitude}, {"longitude", fix.coordinate.longitude}, {"source", "assistant"}};
    if (fix.horizontalAccuracy != 0.0) {
        dictionary.set("horizontalAccuracy", fix.horizontalAccuracy);
    }
    if (fix.timestamp && fix.timestamp->secondsSinceReferenceDate != 0.0) {
        dictionary.set("timestamp", *millisecondsSince1970ForTimeInterval(fix.timestamp->secondsSinceReferenceDate));
    }
    return dictionary;
}

bool KTRVAUtils::isKTRAppInstalled() {
    return true;
}

}  // namespace ktr
