#pragma once

#include <memory>

#include "platform/ui/View.h"

namespace ktr::platform {

/// Who shows a window's pixels. Main thread.
class KTR_API WindowClient {
  public:
    virtual ~WindowClient();
    /// The rectangle, in the window's coordinates, has to be painted again.
    virtual void windowNeedsDisplay(const Rect& rect) = 0;
    /// Something in the window has to be laid out before the next painting.
    virtual void windowNeedsLayout() = 0;
};

/// The root of a view tree that is on screen (or in a picture). Main thread.
class KTR_API Window : public View {
  public:
    void setClient(std::weak_ptr<WindowClient> client) { client_ = std::move(client); }
    void needsDisplay(const Rect& rect);
    void needsLayout();

  protected:
    void needsDisplayInRoot(const Rect& rect) override { needsDisplay(rect); }
    void needsLayoutInRoot() override { needsLayout(); }

  private:
    std::weak_ptr<WindowClient> client_;
};

}  // namespace ktr::platform
