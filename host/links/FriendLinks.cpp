#include "host/links/FriendLinks.h"

#include <QString>
#include <QUrl>

#include "linux/maps/DesktopMapsApplication.h"

namespace ktr::host {

std::string FriendLinks::place(const platform::Coordinate& coordinate, const std::string& name) {
    return linux_::DesktopMapsApplication::urlFor({coordinate, name});
}

std::optional<std::string> FriendLinks::call(const std::string& number) {
    const QString given = QString::fromStdString(number).trimmed();
    QString digits;
    for (const QChar c : given) {
        // Digits of every script are numbers to a person; a program wants these ten.
        if (c.digitValue() >= 0 && c.isDigit()) {
            digits += QString::number(c.digitValue());
        } else if (c == QLatin1Char('+') && digits.isEmpty()) {
            digits += c;
        }
    }
    const bool hasDigit = digits.size() > (digits.startsWith(QLatin1Char('+')) ? 1 : 0);
    return hasDigit ? std::optional("tel:" + digits.toStdString()) : std::nullopt;
}

std::optional<std::string> FriendLinks::write(const std::string& address) {
    const auto at = address.rfind('@');
    if (at == std::string::npos || at == 0 || at + 1 == address.size()) {
        return std::nullopt;
    }
    // Everything that would end the address, or begin another part of the link, is written as its bytes.
    const QByteArray written = QUrl::toPercentEncoding(QString::fromStdString(address), "@");
    return "mailto:" + written.toStdString();
}

std::string FriendLinks::placeText(const platform::Coordinate& coordinate) {
    return QString::asprintf("%.5f, %.5f", coordinate.latitude, coordinate.longitude).toStdString();
}

FriendLinks::Ways FriendLinks::waysTo(const platform::Contact* contact, const std::string& handle) {
    Ways ways;
    for (const auto& number : contact != nullptr ? contact->phoneNumbers : std::vector<platform::LabeledText>()) {
        ways.call = ways.call ? ways.call : call(number.value);
    }
    for (const auto& address : contact != nullptr ? contact->emailAddresses : std::vector<platform::LabeledText>()) {
        ways.write = ways.write ? ways.write : write(address.value);
    }
    const bool isAddress = handle.find('@') != std::string::npos;
    ways.call = ways.call || isAddress ? ways.call : call(handle);
    ways.write = ways.write || !isAddress ? ways.write : write(handle);
    return ways;
}

}  // namespace ktr::host
