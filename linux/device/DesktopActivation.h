#pragma once

#include <QDBusConnection>
#include <QDBusVirtualObject>
#include <QString>
#include <functional>
#include <optional>
#include <string>

#include "linux/device/Aside.h"

namespace ktr::linux_ {

/// The one window of a session that links go to: it owns the program's name on the session's bus and answers
/// org.freedesktop.Application (desktop entry specification, "D-Bus activation"). A second window has no name and hears
/// nothing. Nothing waits, but for `handOver`. Main thread.
class DesktopActivation : public QDBusVirtualObject {
  public:
    /// Of the bus, and of the desktop entry.
    static constexpr const char* kName = "org.ktr.ktr";

    struct Handlers {
        std::function<void(const std::string& url)> open;  ///< somebody wants this opened; it is checked by nobody yet
        std::function<void()> activate;                    ///< the window is to come to the front
    };

    /// `busAddress` is the session's; empty: nobody is heard.
    DesktopActivation(const QString& busAddress, Handlers handlers);
    ~DesktopActivation() override;

    /// Gives a URL to the window that is there, or with an empty one has it come to the front; false when there is
    /// none, or it does not answer in time. It waits for two seconds at most: before anything is on screen.
    static bool handOver(const QString& busAddress, const std::string& url);

    QString introspect(const QString& path) const override;
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override;

  private:
    void useBus(const QDBusConnection& bus);

    const Handlers handlers_;
    std::optional<QDBusConnection> bus_;
    Aside aside_;
};

}  // namespace ktr::linux_
