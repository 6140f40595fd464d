#include "app/window/ShowCommand.h"

#include <QApplication>
#include <cstdio>
#include <memory>

#include "app/window/ConversationWindow.h"
#include "app/window/WindowPlace.h"
#include "documents/Words.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/device/DesktopActivation.h"
#include "linux/device/DesktopOpener.h"

namespace ktr::app {

namespace {

constexpr int kTallWindow = 820;
constexpr int kWideWindow = 760;

bool printUrl(const platform::Url& url) {
    return std::printf("%s\n", documents::forLine(url.text(), std::string::npos).c_str()) >= 0 &&
           std::fflush(stdout) == 0;
}

}  // namespace

host::ExitCode ShowCommand::run(const std::vector<host::Scenario>& scenarios) {
    QGuiApplication::setApplicationName(QStringLiteral("ktr"));
    QGuiApplication::setDesktopFileName(QString::fromLatin1(linux_::DesktopActivation::kName));
    const QString bus = qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS");
    linux_::DesktopOpener desktopOpener(bus);
    linux_::DesktopSettings desktop(linux_::DesktopSettings::Places::ofSession());
    ConversationWindow window(host_);
    window.follow(desktop, options_.reducedMotion);
    window.openLinks(desktopOpener);
    if (options_.printUrls) {
        host_.delegate().open = printUrl;
    }
    window.setWindowTitle(QStringLiteral("ktr"));
    const int width = static_cast<int>(host_.settings().width);
    window.resize(width, width < 900 ? kTallWindow : kWideWindow);
    // Only the window that one keeps: a scenario's is as large as it was asked for.
    const WindowPlace place(linux_::XdgFolders::state() / "window");
    if (options_.live && options_.width == 0.0) {
        place.restore(window);
    }
    window.show();
    window.start(scenarios, options_.questions);
    const auto follow = [&window](const std::string& url) { window.open(url, host::LinkPolicy::From::Outside); };
    if (!options_.link.empty()) {
        follow(options_.link);
    }
    std::unique_ptr<linux_::DesktopActivation> activation;
    if (options_.live) {
        activation = std::make_unique<linux_::DesktopActivation>(
            bus, linux_::DesktopActivation::Handlers{follow, [&window] {
                                                         window.show();
                                                         window.raise();
                                                         window.activateWindow();
                                                     }});
    }
    const bool ended = QApplication::exec() == 0;
    if (options_.live) {
        place.keep(window);
    }
    return ended ? host::ExitCode::Ok : host::ExitCode::Failure;
}

}  // namespace ktr::app
