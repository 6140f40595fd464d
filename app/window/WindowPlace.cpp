#include "app/window/WindowPlace.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWidget>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "documents/AtomicFile.h"
#include "documents/FileReader.h"
#include "platform/base/LogArea.h"

namespace ktr::app {

void WindowPlace::restore(QWidget& window) const {
    documents::FileReader::Terms terms;
    terms.most = 256;
    const auto read = documents::FileReader::read(file_, terms);
    const auto* kept = std::get_if<std::string>(&read);
    int width = 0;
    int height = 0;
    int x = 0;
    int y = 0;
    int isMaximized = 0;
    constexpr int kNumbers = 5;
    constexpr int kMost = 16384;
    const bool isRead = kept != nullptr &&
                        std::sscanf(kept->c_str(), "%d %d %d %d %d", &width, &height, &x, &y, &isMaximized) == kNumbers;
    if (!isRead || width < window.minimumWidth() || height < window.minimumHeight() || width > kMost ||
        height > kMost || std::abs(x) > kMost || std::abs(y) > kMost || width <= 0 || height <= 0) {
        return;
    }
    window.resize(width, height);
    if (QGuiApplication::screenAt(QPoint(x + width / 2, y + height / 2)) != nullptr) {
        window.move(x, y);
    }
    if (isMaximized != 0) {
        window.setWindowState(window.windowState() | Qt::WindowMaximized);
    }
}

void WindowPlace::keep(const QWidget& window) const {
    const QRect usual = window.isMaximized() || window.isFullScreen() ? window.normalGeometry() : window.geometry();
    const QPoint corner = window.isMaximized() ? usual.topLeft() : window.pos();
    std::string numbers;
    for (const int number : {usual.width(), usual.height(), corner.x(), corner.y(), window.isMaximized() ? 1 : 0}) {
        numbers += std::to_string(number) + " ";
    }
    std::string problem = documents::AtomicFile::makeFolder(file_.parent_path());
    if (problem.empty()) {
        problem = documents::AtomicFile::write(file_, numbers);
    }
    if (!problem.empty()) {
        platform::areaLog(platform::LogArea::Host)
            .line("the window's place is not kept: %@", platform::FormatArgument(problem).shown());
    }
}

}  // namespace ktr::app
