#include "app/window/friend/FriendRow.h"

#include <QPaintEvent>
#include <QPainter>
#include <algorithm>
#include <cmath>

#include "linux/paint/QtCanvas.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/ui/Accessibility.h"

namespace ktr::app {

using namespace platform;

namespace {

/// What the rows say: one, as a rule.
std::string spoken(const AccessibilityNode& node) {
    if (node.children.empty()) {
        return node.text;
    }
    std::string all;
    for (const auto& child : node.children) {
        const std::string text = spoken(child);
        all += (all.empty() || text.empty() ? "" : ", ") + text;
    }
    return all;
}

}  // namespace

/// What the view tree asks of its window.
class FriendRow::Client : public WindowClient {
  public:
    explicit Client(FriendRow& widget) : widget_(widget) {}
    void windowNeedsDisplay(const Rect&) override { widget_.update(); }
    void windowNeedsLayout() override {
        if (!widget_.isPosted_) {
            widget_.isPosted_ = true;
            QMetaObject::invokeMethod(
                &widget_, [this] { widget_.layOut(); }, Qt::QueuedConnection);
        }
    }

  private:
    FriendRow& widget_;
};

FriendRow::FriendRow(QWidget* parent) : Block(parent), client_(std::make_shared<Client>(*this)) {
    setAttribute(Qt::WA_TransparentForMouseEvents);
}

FriendRow::~FriendRow() {
    letGo();
}

void FriendRow::show(const std::shared_ptr<HostSnippetViewController>& controller) {
    letGo();
    controller_ = controller;
    window_ = platform::create<Window>(&Window::initWithFrame, Rect{});
    window_->addSubview(controller_->view());
    controller_->updateViewConstraints();
    controller_->viewWillAppear(false);
    window_->setClient(client_);
    client_->windowNeedsLayout();
    askForRoom();
}

void FriendRow::letGo() {
    if (controller_) {
        window_->setClient({});
        controller_->viewWillDisappear(false);
        if (const auto view = controller_->viewIfLoaded()) {
            view->removeFromSuperview();
        }
    }
    controller_.reset();
    window_.reset();
}

int FriendRow::shapeHeight(int width) const {
    if (!controller_) {
        return 0;
    }
    const auto place = [&](double height) {
        window_->setFrame({0.0, 0.0, static_cast<double>(width), height});
        controller_->view()->setFrame(window_->bounds());
        window_->layoutIfNeeded();
    };
    // A row measures itself at the width that it has.
    place(std::max(window_->frame().height, 1.0));
    constexpr double kCompressed = 1.0;
    const double desired = controller_->desiredHeightForWidth(width);
    const double lower = controller_->view()
                             ->systemLayoutSizeFitting({static_cast<double>(width), kCompressedFittingExtent},
                                                       kRequiredPriority, kCompressed)
                             .height;
    const double height = std::ceil(std::max({desired, lower, 0.0}));
    place(height);
    return static_cast<int>(height);
}

void FriendRow::layOut() {
    isPosted_ = false;
    if (!window_) {
        return;
    }
    window_->layoutIfNeeded();
    const QString said = QString::fromStdString(spoken(accessibilityTree(window_, isMirrored())));
    if (said != accessibleName()) {
        setAccessibleName(said);
    }
    askForRoom();
    if (changed_) {
        changed_();
    }
}

void FriendRow::paintEvent(QPaintEvent* event) {
    if (!window_) {
        return;
    }
    QPainter painter(this);
    painter.setClipRegion(event->region());
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
    linux_::QtCanvas canvas(painter, colors());
    window_->paint(canvas, window_->bounds());
}

}  // namespace ktr::app
