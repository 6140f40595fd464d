#pragma once

#include <QAbstractNativeEventFilter>
#include <cstdint>
#include <functional>

struct xcb_connection_t;

namespace ktr::app {

/// What an X11 window manager says of one window (Extended Window Manager Hints): whether it is hidden, and whether it
/// stands on the workspace that is shown. A compositing one keeps windows mapped that nobody sees, so that nothing else
/// tells. Without X11, and without a window manager, nothing is said and the window counts as shown. Main thread.
class X11Workspace : public QAbstractNativeEventFilter {
  public:
    /// `changed` is called after the window manager has said something else of the window.
    X11Workspace(std::uint32_t window, std::function<void()> changed);
    ~X11Workspace() override;

    bool isShown() const { return isShown_; }

    bool nativeEventFilter(const QByteArray& type, void* message, qintptr* result) override;

  private:
    std::uint32_t atom(const char* name) const;
    bool isHidden() const;
    bool isElsewhere() const;
    void look();

    xcb_connection_t* connection_ = nullptr;
    std::uint32_t window_ = 0;
    std::uint32_t root_ = 0;
    std::function<void()> changed_;
    bool isShown_ = true;
    std::uint32_t state_ = 0, hidden_ = 0, desktop_ = 0, current_ = 0;  ///< atoms
};

}  // namespace ktr::app
