#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QObject>
#include <QString>
#include <QVariantMap>
#include <functional>
#include <map>
#include <optional>
#include <string>

#include "linux/device/Aside.h"

namespace ktr::linux_ {

/// Has the desktop open URLs: through its portal (org.freedesktop.portal.OpenURI), and where there is none, or it has
/// nobody for a URL, through the program chosen for the scheme (`DesktopHandlers`). What may be opened is not decided
/// here. Nothing waits. Main thread.
class DesktopOpener : public QObject {
    Q_OBJECT

  public:
    /// Called once, on the main thread: whether somebody opened it. Whoever was asked which program to take and chose
    /// none has been served, too.
    using Done = std::function<void(bool opened)>;
    /// Called on a thread of its own; it may wait.
    using Handlers = std::function<bool(const std::string& url)>;

    /// `busAddress` is the session's; empty: there is no portal. Without handlers the desktop's.
    explicit DesktopOpener(QString busAddress, Handlers handlers = {});
    ~DesktopOpener() override;

    void open(const std::string& url, Done done);

  private Q_SLOTS:
    void responded(uint response, const QVariantMap& results, const QDBusMessage& message);

  private:
    struct Asked {
        std::string url;
        Done done;
    };

    void joinBus(Asked asked);
    void askPortal(Asked asked);
    void portalFailed(const QString& request);
    void askHandlers(Asked asked);
    std::optional<Asked> take(const QString& request);

    const QString busAddress_;
    const Handlers handlers_;
    std::optional<QDBusConnection> bus_;
    /// What the portal is at, by the path of its request.
    std::map<QString, Asked> asked_;
    unsigned requests_ = 0;
    Aside aside_;
};

}  // namespace ktr::linux_
