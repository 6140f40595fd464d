#include "linux/device/DesktopOpener.h"

#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <utility>

#include "linux/device/DesktopHandlers.h"

namespace ktr::linux_ {

namespace {

const QString kPortal = QStringLiteral("org.freedesktop.portal.Desktop");
const QString kPath = QStringLiteral("/org/freedesktop/portal/desktop");
const QString kInterface = QStringLiteral("org.freedesktop.portal.OpenURI");
const QString kRequest = QStringLiteral("org.freedesktop.portal.Request");
/// Of the portal's first word, that it is at it; its user may then choose for as long as they like. Milliseconds.
constexpr int kLongestSilence = 5000;
/// What a portal says that has nobody for a URL; 0 is done, 1 that its user called it off.
constexpr uint kFailed = 2;

}  // namespace

DesktopOpener::DesktopOpener(QString busAddress, Handlers handlers)
    : busAddress_(std::move(busAddress)),
      handlers_(handlers ? std::move(handlers) : DesktopHandlers::open),
      aside_(*this) {}

DesktopOpener::~DesktopOpener() {
    if (bus_) {
        QDBusConnection::disconnectFromBus(bus_->name());
    }
}

void DesktopOpener::open(const std::string& url, Done done) {
    Asked asked{url, std::move(done)};
    if (busAddress_.isEmpty()) {
        askHandlers(std::move(asked));
    } else if (bus_ && bus_->isConnected()) {
        askPortal(std::move(asked));
    } else {
        joinBus(std::move(asked));
    }
}

void DesktopOpener::joinBus(Asked asked) {
    const QString name =
        QStringLiteral("ktr-opener-%1-%2").arg(reinterpret_cast<quintptr>(this), 0, 16).arg(++requests_);
    aside_.run([this, name, address = busAddress_, asked = std::move(asked)] {
        const QDBusConnection bus = QDBusConnection::connectToBus(address, name);
        return [this, bus, asked] {
            if (!bus.isConnected()) {
                askHandlers(asked);
                return;
            }
            if (bus_) {
                QDBusConnection::disconnectFromBus(bus_->name());
            }
            bus_ = bus;
            askPortal(asked);
        };
    });
}

void DesktopOpener::askPortal(Asked asked) {
    const QString token = QStringLiteral("ktr%1").arg(++requests_);
    const QString sender = bus_->baseService().mid(1).replace(QLatin1Char('.'), QLatin1Char('_'));
    const QString request = kPath + QStringLiteral("/request/") + sender + QLatin1Char('/') + token;
    // Before it is asked: it may be done at once. From whomever: who owns the portal's name is learnt in the
    // background, and what it says until then would be lost.
    bus_->connect(QString(), request, kRequest, QStringLiteral("Response"), this,
                  SLOT(responded(uint, QVariantMap, QDBusMessage)));
    QDBusMessage message = QDBusMessage::createMethodCall(kPortal, kPath, kInterface, QStringLiteral("OpenURI"));
    message << QString() << QString::fromStdString(asked.url) << QVariantMap{{QStringLiteral("handle_token"), token}};
    asked_[request] = std::move(asked);
    auto* watcher = new QDBusPendingCallWatcher(bus_->asyncCall(message, kLongestSilence), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this, request](QDBusPendingCallWatcher* finished) {
        finished->deleteLater();
        if (finished->isError()) {
            portalFailed(request);
        }
    });
}

std::optional<DesktopOpener::Asked> DesktopOpener::take(const QString& request) {
    const auto found = asked_.find(request);
    if (found == asked_.end()) {
        return std::nullopt;
    }
    Asked asked = std::move(found->second);
    asked_.erase(found);
    bus_->disconnect(QString(), request, kRequest, QStringLiteral("Response"), this,
                     SLOT(responded(uint, QVariantMap, QDBusMessage)));
    return asked;
}

void DesktopOpener::responded(uint response, const QVariantMap& /*results*/, const QDBusMessage& message) {
    if (response == kFailed) {
        portalFailed(message.path());
    } else if (const auto asked = take(message.path()); asked && asked->done) {
        asked->done(true);
    }
}

void DesktopOpener::portalFailed(const QString& request) {
    if (auto asked = take(request)) {
        askHandlers(std::move(*asked));
    }
}

void DesktopOpener::askHandlers(Asked asked) {
    aside_.run([handlers = handlers_, asked = std::move(asked)] {
        const bool opened = handlers(asked.url);
        return [asked, opened] {
            if (asked.done) {
                asked.done(opened);
            }
        };
    });
}

}  // namespace ktr::linux_
