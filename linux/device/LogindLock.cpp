#include "linux/device/LogindLock.h"

#include <sys/types.h>
#include <unistd.h>

#include <QDBusArgument>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusPendingCall>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusServiceWatcher>
#include <QDBusVariant>
#include <utility>

namespace ktr::linux_ {

namespace {

const QString kService = QStringLiteral("org.freedesktop.login1");
const QString kManagerPath = QStringLiteral("/org/freedesktop/login1");
const QString kManager = QStringLiteral("org.freedesktop.login1.Manager");
const QString kSession = QStringLiteral("org.freedesktop.login1.Session");
const QString kUser = QStringLiteral("org.freedesktop.login1.User");
const QString kProperties = QStringLiteral("org.freedesktop.DBus.Properties");
const QString kHint = QStringLiteral("LockedHint");

/// A session as logind names it beside its identifier: (so).
QString pathOfStructure(const QVariant& value) {
    const auto argument = qvariant_cast<QDBusArgument>(value);
    if (argument.currentType() != QDBusArgument::StructureType) {
        return {};
    }
    QString identifier;
    QDBusObjectPath path;
    argument.beginStructure();
    argument >> identifier >> path;
    argument.endStructure();
    // "/" stands for no session.
    return path.path() == QLatin1String("/") ? QString() : path.path();
}

/// Calls without waiting; `answered` gets the finished call, unless `owner` is gone by then.
template <class Answered>
void call(const QDBusConnection& bus, QObject* owner, const QDBusMessage& message, Answered answered) {
    auto* watcher = new QDBusPendingCallWatcher(bus.asyncCall(message), owner);
    QObject::connect(watcher, &QDBusPendingCallWatcher::finished, owner,
                     [answered = std::move(answered)](QDBusPendingCallWatcher* finished) {
                         finished->deleteLater();
                         answered(*finished);
                     });
}

QDBusMessage getProperty(const QString& path, const QString& interface, const QString& name) {
    QDBusMessage message = QDBusMessage::createMethodCall(kService, path, kProperties, QStringLiteral("Get"));
    message << interface << name;
    return message;
}

}  // namespace

LogindLock::LogindLock(QDBusConnection bus) : bus_(std::move(bus)) {
    if (!bus_.isConnected()) {
        isKnown_ = true;
        return;
    }
    auto* watcher = new QDBusServiceWatcher(kService, bus_, QDBusServiceWatcher::WatchForOwnerChange, this);
    connect(watcher, &QDBusServiceWatcher::serviceOwnerChanged, this,
            [this](const QString&, const QString&, const QString& now) {
                if (!now.isEmpty()) {
                    findSession();
                } else if (state_ != kLocked) {
                    // A screen that was locked is locked still: only whoever comes back can say that it is not.
                    setState(kWithoutLock);
                }
            });
    findSession();
}

LogindLock::~LogindLock() = default;

void LogindLock::findSession() {
    QDBusMessage message =
        QDBusMessage::createMethodCall(kService, kManagerPath, kManager, QStringLiteral("GetSessionByPID"));
    message << static_cast<uint>(::getpid());
    call(bus_, this, message, [this](const QDBusPendingCall& answered) {
        const QDBusPendingReply<QDBusObjectPath> reply = answered;
        if (reply.isValid()) {
            useSession(reply.value().path());
        } else {
            findSessionOfUser();
        }
    });
}

// A program that the user's service manager started belongs to no session: the user's screen counts then.
void LogindLock::findSessionOfUser() {
    QDBusMessage message = QDBusMessage::createMethodCall(kService, kManagerPath, kManager, QStringLiteral("GetUser"));
    message << static_cast<uint>(::getuid());
    call(bus_, this, message, [this](const QDBusPendingCall& answered) {
        const QDBusPendingReply<QDBusObjectPath> user = answered;
        if (!user.isValid()) {
            return setIsKnown();
        }
        call(bus_, this, getProperty(user.value().path(), kUser, QStringLiteral("Display")),
             [this](const QDBusPendingCall& display) {
                 const QDBusPendingReply<QDBusVariant> reply = display;
                 const QString path = reply.isValid() ? pathOfStructure(reply.value().variant()) : QString();
                 if (path.isEmpty()) {
                     return setIsKnown();
                 }
                 useSession(path);
             });
    });
}

void LogindLock::useSession(const QString& path) {
    if (session_ != path) {
        const char* slot = SLOT(propertiesChanged(QString, QVariantMap, QStringList));
        const QString name = QStringLiteral("PropertiesChanged");
        if (!session_.isEmpty()) {
            bus_.disconnect(kService, session_, kProperties, name, this, slot);
        }
        session_ = path;
        bus_.connect(kService, session_, kProperties, name, this, slot);
    }
    readHint();
}

void LogindLock::setState(int state) {
    if (std::exchange(state_, state) != state && changed_) {
        changed_();
    }
}

void LogindLock::setIsKnown() {
    if (!std::exchange(isKnown_, true) && known_) {
        known_();
    }
}

void LogindLock::readHint() {
    call(bus_, this, getProperty(session_, kSession, kHint), [this](const QDBusPendingCall& answered) {
        const QDBusPendingReply<QDBusVariant> reply = answered;
        if (reply.isValid()) {
            setHint(reply.value().variant().toBool());
        }
        setIsKnown();
    });
}

void LogindLock::propertiesChanged(const QString& interface, const QVariantMap& changed,
                                   const QStringList& invalidated) {
    if (interface != kSession) {
        return;
    }
    if (const auto hint = changed.find(kHint); hint != changed.end()) {
        setHint(hint->toBool());
    } else if (invalidated.contains(kHint)) {
        readHint();
    }
}

}  // namespace ktr::linux_
