#pragma once

namespace ktr {

/// Hears from a row what concerns the whole snippet: the row's controller. Main thread.
class FriendViewDelegate {
  public:
    virtual ~FriendViewDelegate() = default;
    /// The row needs another height than before: the snippet is to be measured again.
    virtual void viewNeedsResize() = 0;
};

}  // namespace ktr
