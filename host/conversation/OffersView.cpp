#include "host/conversation/OffersView.h"

#include <QPainter>
#include <algorithm>

#include "host/conversation/BubbleView.h"
#include "host/conversation/Shapes.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"

namespace ktr::host {

using platform::Rect;

namespace {

constexpr double kBetweenPills = 8.0;
constexpr double kBetweenQuestions = 10.0;
constexpr double kTitleToQuestions = 10.0;
constexpr double kPillsToNote = 8.0;
constexpr double kRingOutside = 3.0;

bool rightToLeft() {
    return platform::Platform::installed()->assistant->languageIsRightToLeft();
}

std::shared_ptr<platform::Label> footnote() {
    auto label = platform::create<platform::Label>(&platform::Label::initWithFrame, Rect{});
    label->setNumberOfLines(0);
    label->setLineBreakMode(platform::LineBreakMode::WordWrapping);
    label->setHidden(true);
    return label;
}

}  // namespace

bool OffersView::initWithFrame(const Rect& frame) {
    if (!FadeView::initWithFrame(frame)) {
        return false;
    }
    title_ = footnote();
    note_ = footnote();
    addSubview(title_);
    addSubview(note_);
    setHidden(true);
    return true;
}

bool OffersView::asksOn() const {
    return !offers_.empty() && offers_.front()->kind() == Offer::Kind::Question;
}

void OffersView::setOffers(const Offers& offers) {
    given_ = offers;
    for (const auto& offer : offers_) {
        offer->removeFromSuperview();
    }
    offers_.clear();
    for (const Offer& offer : offers.offers) {
        auto view = platform::create<OfferView>(&OfferView::initWithFrame, Rect{});
        view->setOffer(offer);
        addSubview(view);
        offers_.push_back(std::move(view));
    }
    for (const auto& [label, words] : {std::pair(title_, offers.title), std::pair(note_, offers.note)}) {
        label->setFont(platform::preferredFont(platform::TextStyle::Footnote));
        label->setText(words);
        label->setHidden(words.empty());
    }
    setHidden(offers.isEmpty());
    if (palette_ != nullptr) {
        setPalette(*palette_);
    }
}

void OffersView::setPalette(const linux_::Palette& palette) {
    palette_ = &palette;
    for (const auto& label : {title_, note_}) {
        label->setTextColor(textColor(palette.inkSoft));
    }
    for (const auto& offer : offers_) {
        offer->setPalette(palette);
    }
}

double OffersView::layOutPills(double width, double top, bool atEnd) {
    const double gap = asksOn() ? kBetweenQuestions : kBetweenPills;
    double together = -gap;
    double highest = 0.0;
    for (const auto& offer : offers_) {
        const platform::Size size = offer->sizeForWidth(width);
        together += size.width + gap;
        highest = std::max(highest, size.height);
    }
    const bool isSideBySide = !asksOn() && together <= width;
    double x = isSideBySide && atEnd ? width - together : 0.0;
    double y = top;
    for (const auto& offer : offers_) {
        const platform::Size size = offer->sizeForWidth(width);
        const double start = isSideBySide ? x : atEnd ? width - size.width : 0.0;
        const double height = isSideBySide ? highest : size.height;
        offer->setFrame(
            mirrored({start + kAround, y + kAround, size.width, height}, width + 2.0 * kAround, rightToLeft()));
        offer->layoutIfNeeded();
        (isSideBySide ? x : y) += gap + (isSideBySide ? size.width : height);
    }
    return offers_.empty() ? top : isSideBySide ? y + highest : y - gap;
}

double OffersView::layOut(double width, bool atEnd) {
    const bool isAtEnd = atEnd || asksOn();
    // The end edge as an alignment: a natural one has no name for it.
    const auto alignment = !isAtEnd        ? platform::TextAlignment::Natural
                           : rightToLeft() ? platform::TextAlignment::Left
                                           : platform::TextAlignment::Right;
    const auto put = [&](platform::Label& label, double y) {
        const double height = wrappedSize(label.text(), label.font(), width).size.height;
        label.setTextAlignment(alignment);
        label.setFrame({kAround, y + kAround, width, height});
        return height;
    };
    double y = title_->hidden() ? 0.0 : put(*title_, 0.0) + kTitleToQuestions;
    y = layOutPills(width, y, isAtEnd);
    if (!note_->hidden()) {
        y += offers_.empty() ? 0.0 : kPillsToNote;
        y += put(*note_, y);
    }
    return y;
}

void OffersView::mark(const platform::View* focused, const platform::View* hovered) {
    std::shared_ptr<platform::View> marked;
    for (const auto& offer : offers_) {
        offer->setHovered(offer.get() == hovered);
        if (offer.get() == focused) {
            marked = offer;
        }
    }
    if (marked != focused_.lock()) {
        focused_ = marked;
        setNeedsDisplay();
    }
}

void OffersView::draw(platform::Canvas& canvas) const {
    FadeView::draw(canvas);
    auto* qt = qtCanvas(canvas);
    const auto focused = std::dynamic_pointer_cast<OfferView>(focused_.lock());
    if (qt == nullptr || !focused) {
        return;
    }
    const double width = qt->palette().focusRing;
    // The gap stays, also where the ring is wider.
    const double out = kRingOutside + width;
    strokeInside(*qt, toQt(focused->frame()).adjusted(-out, -out, out, out), focused->corner() + out,
                 qt->palette().pine, width);
}

}  // namespace ktr::host
