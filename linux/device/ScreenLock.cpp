#include "linux/device/ScreenLock.h"

#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusServiceWatcher>

namespace ktr::linux_ {

namespace {

const QString kSaver = QStringLiteral("org.freedesktop.ScreenSaver");
const QString kSaverPath = QStringLiteral("/org/freedesktop/ScreenSaver");
constexpr int kLongestSilence = 5000;  // milliseconds

}  // namespace

ScreenLock::ScreenLock(const QDBusConnection& session, const QDBusConnection& system)
    : session_(session), lock_(system) {
    lock_.setChanged([this] { tellChanged(); });
    lock_.setKnown([this] { tellChanged(); });
    // Some tell it under an older path alone: of signals the path does not matter.
    session_.connect(kSaver, QString(), kSaver, QStringLiteral("ActiveChanged"), this, SLOT(activeChanged(bool)));
    auto* watcher = new QDBusServiceWatcher(kSaver, session_, QDBusServiceWatcher::WatchForOwnerChange, this);
    connect(watcher, &QDBusServiceWatcher::serviceOwnerChanged, this, [this] { askSaver(); });
    askSaver();
}

bool ScreenLock::isOpen() const {
    const int state = lock_.lockState();
    const bool isLocked = state == LogindLock::kLocked || state == LogindLock::kLocking;
    return isKnown() && !isLocked && !isSaverActive_;
}

void ScreenLock::askSaver() {
    QDBusMessage message = QDBusMessage::createMethodCall(kSaver, kSaverPath, kSaver, QStringLiteral("GetActive"));
    message.setAutoStartService(false);
    auto* watcher = new QDBusPendingCallWatcher(session_.asyncCall(message, kLongestSilence), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this](QDBusPendingCallWatcher* finished) {
        finished->deleteLater();
        // Who has the name and does not know the question only keeps screens awake, and locks none.
        const QDBusPendingReply<bool> reply = *finished;
        isSaverKnown_ = true;
        isSaverActive_ = reply.isValid() && reply.value();
        tellChanged();
    });
}

void ScreenLock::activeChanged(bool isActive) {
    isSaverActive_ = isActive;
    tellChanged();
}

void ScreenLock::tellChanged() const {
    if (changed_) {
        changed_();
    }
}

}  // namespace ktr::linux_
