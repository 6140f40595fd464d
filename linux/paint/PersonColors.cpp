#include "linux/paint/PersonColors.h"

#include <QChar>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

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
    return platform::PersonColor::hash(bytes);
}

std::size_t PersonColors::number(std::string_view handle) {
    return platform::PersonColor::number(handle);
}

QColor PersonColors::color(std::size_t number) {
    return QColor::fromRgb(platform::PersonColor::rgb(number));
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
