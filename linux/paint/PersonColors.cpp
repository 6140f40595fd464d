#include "linux/paint/PersonColors.h"

#include <QChar>
#include <array>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

constexpr std::array<QRgb, PersonColors::kCount> kColors = {
    0xffB15966,  // rosewood
    0xffAF5D4D,  // brick
    0xff9D692E,  // bronze
    0xff7D762C,  // olive
    0xff597E40,  // moss
    0xff34825A,  // fern
    0xff13817E,  // lagoon
    0xff247CA3,  // ocean
    0xff4A75B4,  // denim
    0xff706BBA,  // iris
    0xff9560A6,  // plum
    0xffAD5786,  // mulberry
};

/// Digits of every script count as the digits they are: a number is one person's, however it is written.
std::string reducedNumber(const std::string& number) {
    std::string reduced;
    for (std::size_t at = 0; at < number.size();) {
        const platform::Utf8Step step = platform::decodeUtf8(number, at);
        at += step.length;
        const int digit = QChar::digitValue(step.codePoint);
        if (step.codePoint == U'+' || step.codePoint == U'\uFF0B') {
            reduced += '+';
        } else if (digit >= 0) {
            reduced += static_cast<char>('0' + digit);
        }
    }
    return reduced;
}

}  // namespace

std::uint32_t PersonColors::hash(std::string_view bytes) {
    std::uint32_t h = 0x811c9dc5U;
    for (const char byte : bytes) {
        h ^= static_cast<unsigned char>(byte);
        h *= 0x01000193U;
    }
    return h;
}

std::size_t PersonColors::number(std::string_view handle) {
    const std::uint32_t h = hash(handle);
    return (h ^ (h >> 16U)) % kCount;
}

QColor PersonColors::color(std::size_t number) {
    return QColor::fromRgb(kColors[number % kCount]);
}

QColor PersonColors::stone() {
    return QColor(0x7F, 0x77, 0x6B);
}

std::string PersonColors::handleOf(const platform::Contact& contact) {
    if (!contact.emailAddresses.empty() && !contact.emailAddresses.front().value.empty()) {
        return platform::asciiLowercased(contact.emailAddresses.front().value);
    }
    if (!contact.phoneNumbers.empty()) {
        if (auto number = reducedNumber(contact.phoneNumbers.front().value); !number.empty()) {
            return number;
        }
    }
    if (!contact.identifier.empty()) {
        return contact.identifier;
    }
    return contact.givenName + " " + contact.familyName + contact.storedFullName + contact.nickname +
           contact.organizationName;
}

QColor PersonColors::colorOf(const platform::Contact& contact) {
    return color(number(handleOf(contact)));
}

}  // namespace ktr::linux_
