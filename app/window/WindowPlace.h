#pragma once

#include <filesystem>

class QWidget;

namespace ktr::app {

/// Where a window was and how large, kept from one day to the next. Numbers alone are kept. Main thread: before the
/// window is seen, and when it has been closed.
class WindowPlace {
  public:
    explicit WindowPlace(std::filesystem::path file) : file_(std::move(file)) {}

    /// Nothing happens where nothing, or nonsense, was kept; on a screen that is not there any more the window comes to
    /// one that is.
    void restore(QWidget& window) const;
    /// What cannot be kept is a line in the log.
    void keep(const QWidget& window) const;

  private:
    const std::filesystem::path file_;
};

}  // namespace ktr::app
