#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QObject>
#include <QString>
#include <QVariantMap>
#include <cstdint>
#include <functional>
#include <map>
#include <string>

namespace ktr::linux_ {

/// Shows notifications on the desktop: by its portal (org.freedesktop.portal.Notification), which shows one of a tag
/// once however often it is told, and where there is none by the notification server (org.freedesktop.Notifications,
/// https://specifications.freedesktop.org/notification-spec), which does so by number. Nothing waits. Main thread.
class DesktopNotifier : public QObject {
    Q_OBJECT

  public:
    struct Notification {
        std::string tag;  ///< tells it from others; letters, digits and hyphens
        std::string title;
        std::string body;  ///< plain text
        /// Tells it from others to a server, over restarts of this program. A server that keeps to the standard gives
        /// back what it was given, and replaces what it shows so already. 0: the server chooses.
        std::uint32_t number = 0;
    };
    using Done = std::function<void(bool shown)>;

    /// The bus: the session's, but for tests. `clicked` gets the tag of a notification that somebody opened.
    explicit DesktopNotifier(QDBusConnection bus, std::function<void(std::string tag)> clicked);
    ~DesktopNotifier() override;

    void show(const Notification& notification, Done done);

  private Q_SLOTS:
    void portalActivated(const QString& tag, const QString& action, const QVariantList& parameter);
    void serverActivated(uint number, const QString& action);
    void serverClosed(uint number, uint reason);

  private:
    /// Its end is told whatever has become of the bus.
    QDBusPendingCall call(const QDBusMessage& message) const;
    void askServer(const Notification& notification, const Done& done);

    QDBusConnection bus_;
    const std::function<void(std::string tag)> clicked_;
    std::map<uint, std::string> shown_;  ///< by the server
};

}  // namespace ktr::linux_
