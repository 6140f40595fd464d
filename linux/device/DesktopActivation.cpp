#include "linux/device/DesktopActivation.h"

#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QStringList>
#include <QVariantMap>
#include <utility>

namespace ktr::linux_ {

namespace {

const QString kPath = QStringLiteral("/org/ktr/ktr");
const QString kInterface = QStringLiteral("org.freedesktop.Application");
/// Of RequestName: who has the name keeps it, and nobody waits in line for it.
constexpr uint kDoNotQueue = 4;
constexpr int kLongestHandOver = 2000;  // milliseconds
/// Of one call: a page may ask for a hundred thousand.
constexpr int kMostLinks = 8;

}  // namespace

DesktopActivation::DesktopActivation(const QString& busAddress, Handlers handlers)
    : handlers_(std::move(handlers)), aside_(*this) {
    if (busAddress.isEmpty()) {
        return;
    }
    const QString name = QStringLiteral("ktr-activation-%1").arg(reinterpret_cast<quintptr>(this), 0, 16);
    aside_.run([this, name, busAddress] {
        const QDBusConnection bus = QDBusConnection::connectToBus(busAddress, name);
        return [this, bus] {
            if (bus.isConnected()) {
                useBus(bus);
            }
        };
    });
}

DesktopActivation::~DesktopActivation() {
    if (bus_) {
        bus_->unregisterObject(kPath);
        QDBusConnection::disconnectFromBus(bus_->name());
    }
}

void DesktopActivation::useBus(const QDBusConnection& bus) {
    bus_ = bus;
    bus_->registerVirtualObject(kPath, this);
    // The object first, so that whoever finds the name finds it too.
    QDBusMessage request =
        QDBusMessage::createMethodCall(QStringLiteral("org.freedesktop.DBus"), QStringLiteral("/org/freedesktop/DBus"),
                                       QStringLiteral("org.freedesktop.DBus"), QStringLiteral("RequestName"));
    request << QString::fromLatin1(kName) << kDoNotQueue;
    bus_->asyncCall(request);
}

bool DesktopActivation::handOver(const QString& busAddress, const std::string& url) {
    if (busAddress.isEmpty()) {
        return false;
    }
    const QString name = QStringLiteral("ktr-hand-over");
    bool taken = false;
    {
        const QDBusConnection bus = QDBusConnection::connectToBus(busAddress, name);
        if (bus.isConnected()) {
            QDBusMessage open =
                QDBusMessage::createMethodCall(QString::fromLatin1(kName), kPath, kInterface,
                                               url.empty() ? QStringLiteral("Activate") : QStringLiteral("Open"));
            if (!url.empty()) {
                open << QStringList{QString::fromStdString(url)};
            }
            open << QVariantMap();
            open.setAutoStartService(false);
            taken = bus.call(open, QDBus::Block, kLongestHandOver).type() == QDBusMessage::ReplyMessage;
        }
    }
    QDBusConnection::disconnectFromBus(name);
    return taken;
}

QString DesktopActivation::introspect(const QString& /*path*/) const {
    return QStringLiteral(
        "<interface name=\"org.freedesktop.Application\">"
        "<method name=\"Activate\"><arg type=\"a{sv}\" direction=\"in\"/></method>"
        "<method name=\"Open\"><arg type=\"as\" direction=\"in\"/><arg type=\"a{sv}\" direction=\"in\"/></method>"
        "<method name=\"ActivateAction\"><arg type=\"s\" direction=\"in\"/><arg type=\"av\" direction=\"in\"/>"
        "<arg type=\"a{sv}\" direction=\"in\"/></method></interface>");
}

bool DesktopActivation::handleMessage(const QDBusMessage& message, const QDBusConnection& connection) {
    if (message.interface() != kInterface) {
        return false;
    }
    const QString signature = message.signature();
    if (message.member() == QLatin1String("Open") && signature == QLatin1String("asa{sv}")) {
        connection.send(message.createReply());
        const QStringList urls = message.arguments().value(0).toStringList().mid(0, kMostLinks);
        for (const QString& url : urls) {
            handlers_.open(url.toStdString());
        }
    } else if (message.member() == QLatin1String("Activate") && signature == QLatin1String("a{sv}")) {
        connection.send(message.createReply());
    } else {
        return false;
    }
    handlers_.activate();
    return true;
}

}  // namespace ktr::linux_
