#pragma once

#include <QObject>
#include <functional>
#include <memory>

#include "app/window/X11Workspace.h"

class QWidget;
class QWindow;

namespace ktr::app {

/// Whether somebody can see a window: it is not minimised, stands on the workspace that is shown, and the session is
/// not locked. Before it was on screen for the first time it counts as seen. Main thread.
class WindowSight : public QObject {
  public:
    /// `isLocked` is asked when anything changes, and at `look`. The window outlives this.
    WindowSight(QWidget& window, std::function<bool()> isLocked);
    ~WindowSight() override;

    bool isSeen() const { return isSeen_; }
    /// Called after that has become another.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }
    /// Something besides the window has changed.
    void look();

  protected:
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void findHandle();

    QWidget& window_;
    std::function<bool()> isLocked_;
    std::function<void()> changed_;
    QWindow* handle_ = nullptr;
    std::unique_ptr<X11Workspace> workspace_;
    bool wasExposed_ = false;
    bool isSeen_ = true;
};

}  // namespace ktr::app
