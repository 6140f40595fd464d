#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVirtualObject>
#include <QTimer>
#include <functional>
#include <vector>

#include "app/search/SearchDesk.h"

namespace ktr::app {

/// Speaks to the desktop's search over the session's bus: org.gnome.Shell.SearchProvider2 and org.kde.krunner1, on one
/// object. Answers at once, out of what is known here. What comes before it is ready waits, for two seconds at most.
/// Main thread.
class SearchService : public QDBusVirtualObject {
  public:
    static constexpr const char* kName = "org.ktr.ktr.Search";  ///< on the bus
    static constexpr const char* kPath = "/org/ktr/ktr/Search";
    static constexpr int kPatience = 2000;  ///< milliseconds

    /// Opens the window with these words of the command line.
    using Open = std::function<void(const std::vector<std::string>& words)>;

    /// All outlive this. `heard` is called with each call.
    SearchService(SearchDesk& desk, const QDBusConnection& bus, Open open, std::function<void()> heard);

    void setReady();
    QString introspect(const QString& path) const override;
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override;

  private:
    void answer(const QDBusMessage& message);
    bool answerShell(const QDBusMessage& message);
    bool answerRunner(const QDBusMessage& message);
    void reply(const QDBusMessage& message, const QVariant& value);

    SearchDesk& desk_;
    QDBusConnection bus_;
    const Open open_;
    const std::function<void()> heard_;
    bool isReady_ = false;
    QTimer patience_;
    std::vector<QDBusMessage> waiting_;
};

}  // namespace ktr::app
