#include "app/window/ShowCommand.h"

#include <QApplication>
#include <QDesktopServices>
#include <QUrl>
#include <cstdio>

#include "app/window/ConversationWindow.h"
#include "documents/Words.h"

namespace ktr::app {

namespace {

constexpr int kTallWindow = 820;
constexpr int kWideWindow = 760;

bool printUrl(const platform::Url& url) {
    return std::printf("%s\n", documents::forLine(url.text(), std::string::npos).c_str()) >= 0 &&
           std::fflush(stdout) == 0;
}

bool openOnDesktop(const platform::Url& url) {
    return QDesktopServices::openUrl(QUrl::fromEncoded(QByteArray::fromStdString(url.text())));
}

}  // namespace

host::ExitCode ShowCommand::run(const std::vector<host::Scenario>& scenarios) {
    QGuiApplication::setApplicationName(QStringLiteral("ktr"));
    host_.delegate().open = options_.printUrls ? printUrl : openOnDesktop;
    linux_::DesktopSettings desktop(linux_::DesktopSettings::Places::ofSession());
    ConversationWindow window(host_);
    window.follow(desktop, options_.reducedMotion);
    window.setWindowTitle(QStringLiteral("ktr"));
    const int width = static_cast<int>(host_.settings().width);
    window.resize(width, width < 900 ? kTallWindow : kWideWindow);
    window.show();
    window.start(scenarios, options_.questions);
    return QApplication::exec() == 0 ? host::ExitCode::Ok : host::ExitCode::Failure;
}

}  // namespace ktr::app
