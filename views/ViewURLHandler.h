#pragma once

#include "platform/base/Url.h"

namespace ktr {

/// Opens the URL of a tap for a row: the row's controller. Main thread.
class ViewURLHandler {
  public:
    virtual ~ViewURLHandler() = default;
    /// What cannot be opened is the handler's business; the row hears nothing of it.
    virtual void handleURL(const platform::Url& url) = 0;
};

}  // namespace ktr
