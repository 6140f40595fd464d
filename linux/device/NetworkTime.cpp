#include "linux/device/NetworkTime.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QUuid>

#include "linux/device/Buses.h"

namespace ktr::linux_ {

std::string NetworkTime::turnOn(const std::string& bus) {
    constexpr int kPatience = 120000;  // milliseconds: somebody types a password
    if (bus.empty() || Buses::greet(bus) != Buses::Greeting::Answered) {
        return "there is no system bus";
    }
    const QString name = QStringLiteral("ktr-network-time-") + QUuid::createUuid().toString(QUuid::WithoutBraces);
    std::string problem;
    {
        const auto connection = QDBusConnection::connectToBus(QString::fromStdString(bus), name);
        QDBusMessage message = QDBusMessage::createMethodCall(
            QStringLiteral("org.freedesktop.timedate1"), QStringLiteral("/org/freedesktop/timedate1"),
            QStringLiteral("org.freedesktop.timedate1"), QStringLiteral("SetNTP"));
        message << true << true;
        message.setInteractiveAuthorizationAllowed(true);
        const QDBusMessage answer = connection.call(message, QDBus::Block, kPatience);
        problem = answer.type() == QDBusMessage::ReplyMessage ? "" : answer.errorMessage().toStdString();
    }
    QDBusConnection::disconnectFromBus(name);
    return problem;
}

}  // namespace ktr::linux_
