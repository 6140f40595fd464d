#pragma once

#include <utility>

#include "platform/base/Api.h"

namespace ktr::platform {

class View;

/// Knows a view without owning it; none once the view is gone. The size of a pointer, and counted without atomic
/// operations: a row is about a hundred of these. A value. Main thread.
class KTR_API ViewReference {
  public:
    ViewReference() = default;
    explicit ViewReference(const View& view);
    ViewReference(const ViewReference& other) : link_(other.link_) { hold(); }
    ViewReference(ViewReference&& other) noexcept : link_(std::exchange(other.link_, nullptr)) {}
    ViewReference& operator=(ViewReference other) noexcept {
        std::swap(link_, other.link_);
        return *this;
    }
    ~ViewReference() { release(); }

    View* get() const { return link_ ? link_->view : nullptr; }
    /// Whether this is about the same view, also when it is gone, or both are about none.
    bool operator==(const ViewReference& other) const { return link_ == other.link_; }

  private:
    friend class View;
    /// One for each view that is referred to; it stays as long as a reference does.
    struct Link {
        View* view = nullptr;
        unsigned references = 0;
    };
    void hold() const {
        if (link_) {
            ++link_->references;
        }
    }
    void release() {
        if (link_ && --link_->references == 0) {
            discard(link_);
        }
    }

    static void discard(const Link* link);

    Link* link_ = nullptr;
};

}  // namespace ktr::platform
