#include "platform/host/HostSnippetViewController.h"

#include "platform/base/Assert.h"
#include "platform/base/MainLoop.h"

namespace ktr::platform {

SnippetHostDelegate::~SnippetHostDelegate() = default;
SnippetControllerFactory::~SnippetControllerFactory() = default;
HostSnippetViewController::~HostSnippetViewController() = default;

bool HostSnippetViewController::init() {
    KTR_ASSERT_MAIN_THREAD();
    return true;
}

void HostSnippetViewController::setDelegate(const std::shared_ptr<SnippetHostDelegate>& delegate) {
    delegate_ = delegate;
}

std::shared_ptr<View> HostSnippetViewController::view() {
    if (!view_) {
        loadView();
    }
    return view_;
}

void HostSnippetViewController::loadView() {
    view_ = create<View>(&View::initWithFrame, Rect{});
}
void HostSnippetViewController::viewWillAppear(bool /*animated*/) {}
void HostSnippetViewController::viewWillDisappear(bool /*animated*/) {}
void HostSnippetViewController::updateViewConstraints() {}

double HostSnippetViewController::desiredHeightForWidth(double /*width*/) {
    return 0.0;
}
std::shared_ptr<AssistantObject> HostSnippetViewController::currentSnippet() const {
    return nullptr;
}

bool HostSnippetViewController::isSearching() const {
    return false;
}

std::shared_ptr<HeaderItem> HostSnippetViewController::sashItem() {
    return nullptr;
}

}  // namespace ktr::platform
