#include "linux/device/DesktopNotifier.h"

#include <QDBusError>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <utility>

namespace ktr::linux_ {

namespace {

const QString kPortal = QStringLiteral("org.freedesktop.portal.Desktop");
const QString kPortalPath = QStringLiteral("/org/freedesktop/portal/desktop");
const QString kPortalInterface = QStringLiteral("org.freedesktop.portal.Notification");
const QString kServer = QStringLiteral("org.freedesktop.Notifications");
const QString kServerPath = QStringLiteral("/org/freedesktop/Notifications");
const QString kAction = QStringLiteral("default");
const QString kProgram = QStringLiteral("ktr");
constexpr int kLongestSilence = 5000;  // milliseconds
constexpr std::size_t kMostShown = 100;

/// The server may read marks in a body.
QString plain(const std::string& text) {
    return QString::fromStdString(text).toHtmlEscaped();
}

}  // namespace

DesktopNotifier::DesktopNotifier(QDBusConnection bus, std::function<void(std::string tag)> clicked)
    : bus_(std::move(bus)), clicked_(std::move(clicked)) {
    bus_.connect(kPortal, kPortalPath, kPortalInterface, QStringLiteral("ActionInvoked"), this,
                 SLOT(portalActivated(QString, QString, QVariantList)));
    bus_.connect(kServer, kServerPath, kServer, QStringLiteral("ActionInvoked"), this,
                 SLOT(serverActivated(uint, QString)));
    bus_.connect(kServer, kServerPath, kServer, QStringLiteral("NotificationClosed"), this,
                 SLOT(serverClosed(uint, uint)));
}

DesktopNotifier::~DesktopNotifier() = default;

QDBusPendingCall DesktopNotifier::call(const QDBusMessage& message) const {
    // What is asked of a bus that is not there would never end.
    return bus_.isConnected() ? bus_.asyncCall(message, kLongestSilence)
                              : QDBusPendingCall::fromError(QDBusError(QDBusError::Disconnected, QString()));
}

void DesktopNotifier::show(const Notification& notification, Done done) {
    QDBusMessage message =
        QDBusMessage::createMethodCall(kPortal, kPortalPath, kPortalInterface, QStringLiteral("AddNotification"));
    message << QString::fromStdString(notification.tag)
            << QVariantMap{{QStringLiteral("title"), QString::fromStdString(notification.title)},
                           {QStringLiteral("body"), QString::fromStdString(notification.body)},
                           {QStringLiteral("priority"), QStringLiteral("normal")},
                           {QStringLiteral("display-hint"), QStringList{QStringLiteral("hide-content-on-lockscreen")}},
                           {QStringLiteral("default-action"), kAction}};
    auto* watcher = new QDBusPendingCallWatcher(call(message), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [this, notification, done = std::move(done)](QDBusPendingCallWatcher* finished) {
                finished->deleteLater();
                if (finished->isError()) {
                    askServer(notification, done);
                } else {
                    done(true);
                }
            });
}

void DesktopNotifier::askServer(const Notification& notification, const Done& done) {
    QDBusMessage message = QDBusMessage::createMethodCall(kServer, kServerPath, kServer, QStringLiteral("Notify"));
    message << kProgram << notification.number << QString() << QString::fromStdString(notification.title)
            << plain(notification.body) << QStringList{kAction, QString()}
            << QVariantMap{{QStringLiteral("desktop-entry"), QStringLiteral("org.ktr.ktr")},
                           {QStringLiteral("category"), QStringLiteral("presence")}}
            << -1;
    auto* watcher = new QDBusPendingCallWatcher(call(message), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [this, tag = notification.tag, done](QDBusPendingCallWatcher* finished) {
                finished->deleteLater();
                const QDBusPendingReply<uint> reply = *finished;
                if (reply.isValid()) {
                    if (shown_.size() >= kMostShown) {
                        shown_.erase(shown_.begin());
                    }
                    shown_[reply.value()] = tag;
                }
                done(reply.isValid());
            });
}

void DesktopNotifier::portalActivated(const QString& tag, const QString& /*action*/,
                                      const QVariantList& /*parameter*/) {
    clicked_(tag.toStdString());
}

void DesktopNotifier::serverActivated(uint number, const QString& /*action*/) {
    if (const auto shown = shown_.find(number); shown != shown_.end()) {
        clicked_(shown->second);
    }
}

void DesktopNotifier::serverClosed(uint number, uint /*reason*/) {
    shown_.erase(number);
}

}  // namespace ktr::linux_
