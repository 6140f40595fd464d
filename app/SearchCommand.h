#pragma once

#include <QDBusConnection>
#include <QTimer>
#include <string>
#include <vector>

#include "app/search/SearchDesk.h"
#include "app/search/SearchService.h"
#include "host/ExitCode.h"
#include "host/Host.h"
#include "linux/device/ScreenLock.h"

namespace ktr::app {

/// Answers the desktop's search: the session's bus starts it when somebody searches, and it ends when nobody has for a
/// while. Main thread, with Qt's event loop.
class SearchCommand {
  public:
    /// `idle`: so long nothing is heard before it ends, seconds.
    SearchCommand(host::Host& host, int idle);
    host::ExitCode run();

  private:
    /// Takes the name on the bus; false: another has it, or there is no bus.
    bool takeName();
    void endWhenIdle();
    void lockChanged();
    static void open(const std::vector<std::string>& words);

    host::Host& host_;
    QDBusConnection bus_;
    linux_::ScreenLock lock_;
    SearchDesk desk_;
    QTimer idle_;
    SearchService service_;
};

}  // namespace ktr::app
