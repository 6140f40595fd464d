#include "views/accessibility/KTRAXVelaFenceView.h"

#include "model/LogCategory.h"
#include "platform/base/Platform.h"

namespace ktr {

using platform::Platform;

bool KTRAXVelaFenceView::initWithFrame(const platform::Rect& frame) {
    if (!KTRVelaFenceView::initWithFrame(frame)) {
        return false;
    }
    if (axSize()) {
        setupView();
    }
    return true;
}

void KTRAXVelaFenceView::setupView() {
    // Beside the name's first line, whatever its size.
    constexpr double kFromTop = 10.0;
    constexpr double kOfHeadline = 0.2;
    rendering_ = platform::create<AXRowRendering>(&AXRowRendering::initForRow, *this);
    setupAvatar();
    addSubview(rendering_->imageView());
    setupIcon();
    setupSeparator();
    bringSubviewToFront(friendIconView());

    auto metrics = layoutMetrics();
    metrics["geoFenceVertical"] = platform::preferredFont(platform::TextStyle::Headline).size * kOfHeadline + kFromTop;
    const platform::VisualFormatViews views = {{"imageView", rendering_->imageView()},
                                               {"friendIconView", friendIconView()},
                                               {"geoFenceIconImageView", geoFenceIconImageView()},
                                               {"separatorView", separatorView()}};
    // Nothing gives the separator a width: it is not seen.
    const platform::VisualFormat::Picture pictures[] = {
        {"H:|-margin-[friendIconView(pd)]", {}},
        {"H:[geoFenceIconImageView(ld)]-margin-|", {}},
        {"H:|-margin-[imageView]-margin-|", {}},
        {"V:|-vmargin-[friendIconView(pd)]-(>=vmargin)-|", {}},
        {"V:|-geoFenceVertical-[geoFenceIconImageView(ld)]", {}},
        {"V:|-vmargin-[imageView]-(>=vmargin)-[separatorView(st)]-0-|", {}},
    };
    platform::VisualFormat::addConstraints(*this, pictures, metrics, views);
}

void KTRAXVelaFenceView::updateFenceView() {
    // Without a platform no text can be formatted: what is shown stays.
    if (!Platform::installed()) {
        return;
    }
    updateAvatar();
    generateImageForView();
}

AXRowTexts KTRAXVelaFenceView::texts() const {
    return AXRowTexts::make(friendName().value_or(""), {fenceSentence()}, isRTLUI());
}

platform::AttributedString KTRAXVelaFenceView::attributedStringForView() const {
    return texts().composed();
}

std::vector<platform::Rect> KTRAXVelaFenceView::exclusionPaths() const {
    return AXRowRendering::exclusionPaths(*this);
}

void KTRAXVelaFenceView::generateImageForView() {
    rendering_->render(*this, texts(), exclusionPaths());
}

double KTRAXVelaFenceView::estimagedHeightForView() {
    constexpr double kImageMargins = 20.0;
    LogCategory_Unspecified()->write(platform::LogLevel::Debug, "Calculating estimated height");
    const auto image = imageView() ? imageView()->image() : nullptr;
    return image ? image->size().height + kImageMargins
                 : AXRowRendering::measuredHeight(*this, attributedStringForView());
}

void KTRAXVelaFenceView::layoutSubviews() {
    KTRVelaFenceView::layoutSubviews();
    if (rendering_->isDue(*this) && Platform::installed()) {
        generateImageForView();
    }
}

}  // namespace ktr
