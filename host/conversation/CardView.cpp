#include "host/conversation/CardView.h"

#include <QPainter>
#include <algorithm>
#include <cmath>
#include <utility>

#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/ui/Device.h"
#include "platform/ui/Window.h"

namespace ktr::host {

using namespace platform;

namespace {

/// What rows have to get their images before their card unfolds, seconds.
constexpr double kFolded = 0.25;

bool rightToLeft() {
    return Platform::installed()->assistant->languageIsRightToLeft();
}

bool awaitsImages(const View& view) {
    const auto* image = dynamic_cast<const ImageView*>(&view);
    if (image != nullptr && image->isAwaitingImage()) {
        return true;
    }
    const auto& views = view.presentedSubviews();
    return std::any_of(views.begin(), views.end(), [](const auto& subview) { return awaitsImages(*subview); });
}

}  // namespace

/// What lies over the rows: the card's edge, and the focus ring.
class CardView::Overlay : public View {
  public:
    Overlay() { setUserInteractionEnabled(false); }
    std::optional<Rect> focus;

  protected:
    void draw(Canvas& canvas) const override {
        auto* qt = qtCanvas(canvas);
        if (qt == nullptr) {
            return;
        }
        const auto& palette = qt->palette();
        strokeInside(*qt, toQt(bounds()), measures::kCardCorner, palette.cardEdge.color, palette.cardEdge.width);
        if (focus) {
            constexpr double kInset = measures::kFocusInset;
            strokeInside(*qt, toQt(*focus).adjusted(kInset, kInset, -kInset, -kInset), measures::kFocusCorner,
                         palette.pine, palette.focusRing);
        }
    }
};

bool CardView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    icon_ = create<ImageView>(&ImageView::initWithFrame, Rect{});
    title_ = create<Label>(&Label::initWithFrame, Rect{});
    chooseFont();
    ring_ = create<RingView>(&RingView::initWithFrame, Rect{});
    ring_->setHidden(true);
    content_ = create<View>(&View::initWithFrame, Rect{});
    overlay_ = create<Overlay>(&Overlay::initWithFrame, Rect{});
    for (const std::shared_ptr<View>& view :
         {std::shared_ptr<View>(icon_), std::shared_ptr<View>(title_), std::shared_ptr<View>(ring_), content_,
          std::shared_ptr<View>(overlay_)}) {
        addSubview(view);
    }
    return true;
}

void CardView::setController(const std::shared_ptr<HostSnippetViewController>& controller) {
    controller_ = controller;
    if (const auto header = controller->sashItem()) {
        icon_->setImage(header->image());
        title_->setText(header->title());
    }
    content_->addSubview(controller->view());
    controller->updateViewConstraints();
    setOnScreen(true);
    isFolded_ = awaitsImages(*content_);
    if (isFolded_) {
        unfolding_ = Platform::installed()->mainLoop->schedule(kFolded, false, [weakSelf = weak(this)] {
            if (const auto self = weakSelf.lock()) {
                self->unfold();
            }
        });
    }
}

void CardView::setOnScreen(bool onScreen) {
    if (!controller_ || std::exchange(isOnScreen_, onScreen) == onScreen) {
        return;
    }
    if (onScreen) {
        controller_->viewWillAppear(false);
    } else {
        controller_->viewWillDisappear(false);
    }
}

void CardView::unfold() {
    isFolded_ = false;
    unfolding_.reset();
    setNeedsLayout();
}

void CardView::chooseFont() {
    title_->setFont(preferredFont(TextStyle::Headline));
    isLarge_ = isAccessibilityCategory(Platform::installed()->device->contentSizeCategory());
}

void CardView::letGo() {
    if (!controller_) {
        return;
    }
    if (unfolding_) {
        unfolding_->invalidate();
    }
    unfold();
    setOnScreen(false);
    if (const auto view = controller_->viewIfLoaded()) {
        view->removeFromSuperview();
    }
    controller_.reset();
    updateRing();
}

void CardView::setStill(const std::shared_ptr<StillView>& still) {
    still_ = still;
    content_->addSubview(still);
}

double CardView::heightForWidth(double width) {
    if (still_) {
        contentHeight_ = still_->heightForWidth(width);
        content_->setFrame({0.0, headerHeight(), width, contentHeight_});
        still_->setFrame(content_->bounds());
        content_->layoutIfNeeded();
    } else if (controller_) {
        // Rows measure themselves at the width that they have: it is given first, the height follows.
        layOutContent(width, contentHeight_);
        const double desired = controller_->desiredHeightForWidth(width);
        knownEdge_ = lowerEdge();
        layOutContent(width, std::max({desired, knownEdge_, 0.0}));
        isFolded_ = isFolded_ && awaitsImages(*content_);
    }
    updateRing();
    return headerHeight() + (isFolded_ ? 0.0 : contentHeight_);
}

void CardView::layOutContent(double width, double height) {
    contentHeight_ = height;
    content_->setFrame({0.0, headerHeight(), width, height});
    content_->layoutIfNeeded();
}

double CardView::headerHeight() const {
    return isLarge_ ? measures::kLargeHeaderHeight : measures::kHeaderHeight;
}

double CardView::lowerEdge() const {
    const auto view = controller_ ? controller_->viewIfLoaded() : nullptr;
    constexpr double kCompressed = 1.0;
    return view ? view->systemLayoutSizeFitting({content_->bounds().width, kCompressedFittingExtent}, kRequiredPriority,
                                                kCompressed)
                      .height
                : 0.0;
}

bool CardView::isOutdated() const {
    constexpr double kSameHeight = 1e-6;
    if (!controller_ || content_->bounds().width <= 0.0) {
        return false;
    }
    const bool isUnfolding = !isFolded_ || !awaitsImages(*content_);
    return std::abs(lowerEdge() - knownEdge_) > kSameHeight ||
           (isUnfolding && frame().height <= headerHeight() && contentHeight_ > 0.0);
}

void CardView::updateRing() {
    ring_->setHidden(!controller_ || !controller_->isSearching());
}

void CardView::layoutSubviews() {
    layOutHeader();
    content_->setFrame({0.0, headerHeight(), bounds().width, contentHeight_});
    overlay_->setFrame(bounds());
}

void CardView::layOutHeader() {
    const double width = bounds().width;
    const bool rtl = rightToLeft();
    const auto place = [&](View& view, const Rect& rect) { view.setFrame(mirrored(rect, width, rtl)); };
    const double icon = isLarge_ ? measures::kLargeHeaderIcon : measures::kHeaderIcon;
    const double iconTop = isLarge_ ? measures::kLargeHeaderIconTop : measures::kHeaderIconTop;
    place(*icon_, {measures::kAxisAvatar - icon / 2.0, iconTop, icon, icon});
    const double ringStart = width - measures::kRingToEnd - measures::kRing;
    const double titleEnd = ring_->hidden() ? width - measures::kCardInset : ringStart - measures::kCardInset;
    const double titleHeight = title_->font().lineHeight();
    place(*title_, {measures::kAxisText, std::floor((headerHeight() - titleHeight) / 2.0),
                    std::max(titleEnd - measures::kAxisText, 0.0), titleHeight});
    place(*ring_, {ringStart, (headerHeight() - measures::kRing) / 2.0, measures::kRing, measures::kRing});
}

void CardView::redraw(const std::optional<Rect>& rect) const {
    const auto window = this->window();
    if (rect && window) {
        const Rect card = frameInRoot();
        window->needsDisplay(rect->offsetBy(card.x, card.y));
    }
}

void CardView::setHighlight(const std::optional<Rect>& rect) {
    if (rect != highlight_) {
        redraw(highlight_);
        highlight_ = rect;
        redraw(highlight_);
    }
}

void CardView::setFocus(const std::optional<Rect>& rect) {
    if (rect != overlay_->focus) {
        redraw(overlay_->focus);
        overlay_->focus = rect;
        redraw(overlay_->focus);
    }
}

namespace {

/// The card without what lies far beyond the part that is painted: a shape costs by its height, and a long answer's is
/// a hundred times the window's. The corners that it has instead are out of sight.
QRectF visibleCard(linux_::QtCanvas& canvas, QRectF card) {
    const QPainter& painter = canvas.painter();
    if (painter.hasClipping()) {
        constexpr double kBeyond = 2.0 * measures::kCardCorner + 2.0;
        const QRectF visible = painter.clipBoundingRect();
        card.setTop(std::max(card.top(), std::min(visible.top(), card.bottom()) - kBeyond));
        card.setBottom(std::min(card.bottom(), std::max(visible.bottom(), card.top()) + kBeyond));
    }
    return card;
}

}  // namespace

void CardView::draw(Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    if (qt == nullptr) {
        return;
    }
    if (opacity_ < 1.0) {
        qt->painter().setOpacity(qt->painter().opacity() * opacity_);
    }
    const QPainterPath shape = roundedPath(visibleCard(*qt, toQt(bounds())), measures::kCardCorner);
    fillPath(*qt, shape, qt->palette().card);
    // Holds for everything in the card: the caller restores the canvas when it leaves the card.
    qt->painter().setClipPath(shape, Qt::IntersectClip);
    if (highlight_) {
        const QRectF row = qt->snapped(*highlight_);
        qt->painter().fillRect(row, qt->palette().highlight);
        const auto& edge = qt->palette().highlightEdge;
        strokeInside(*qt, row, 0.0, edge.color, edge.width);
    }
}

}  // namespace ktr::host
