#include "views/accessibility/KTRAXVelaFriendView.h"

#include "model/KTRVAUIUtils.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/Format.h"
#include "platform/base/Platform.h"

namespace ktr {

using platform::Platform;

bool KTRAXVelaFriendView::initWithFrame(const platform::Rect& frame) {
    if (!KTRVelaFriendView::initWithFrame(frame)) {
        return false;
    }
    if (axSize()) {
        setupView();
    }
    return true;
}

void KTRAXVelaFriendView::setupView() {
    rendering_ = platform::create<AXRowRendering>(&AXRowRendering::initForRow, *this);
    setupAvatar();
    addSubview(rendering_->imageView());
    setupSeparator();
    bringSubviewToFront(friendIconView());

    const platform::VisualFormatViews views = {{"friendIconView", friendIconView()},
                                               {"imageView", rendering_->imageView()},
                                               {"separatorView", separatorView()}};
    const platform::VisualFormat::Picture pictures[] = {
        {"H:|-margin-[friendIconView(pd)]", {}},
        {"H:|-margin-[imageView]-margin-|", {}},
        {"H:|-0-[separatorView]-0-|", {}},
        {"V:|-vmargin-[friendIconView(pd)]", {}},
        {"V:|-vmargin-[imageView]-vmargin-[separatorView(st)]-0-|", {}},
    };
    platform::VisualFormat::addConstraints(*this, pictures, layoutMetrics(), views);
}

void KTRAXVelaFriendView::updateView() {
    // Without a platform no text can be formatted: what is shown stays.
    if (!Platform::installed()) {
        return;
    }
    updateAvatar();
    generateImageForView();
}

AXRowTexts KTRAXVelaFriendView::texts() const {
    std::vector<std::string> pieces = {placeText()};
    if (const std::string age = ageTexts().shown; !age.empty()) {
        pieces.push_back(platform::formatted(" \u2014 %@", {age}));
    }
    if (const std::string distance = distanceText(); !distance.empty()) {
        pieces.insert(pieces.end(), {"\n", distance});
    }
    return AXRowTexts::make(nameText(), std::move(pieces), isRTLUI());
}

platform::AttributedString KTRAXVelaFriendView::attributedStringForView() const {
    return texts().composed();
}

std::vector<platform::Rect> KTRAXVelaFriendView::exclusionPaths() const {
    return AXRowRendering::exclusionPaths(*this);
}

void KTRAXVelaFriendView::generateImageForView() {
    rendering_->render(*this, texts(), exclusionPaths());
}

double KTRAXVelaFriendView::estimagedHeightForView() {
    LogCategory_Unspecified()->write(platform::LogLevel::Debug, "Calculating estimated height");
    return AXRowRendering::measuredHeight(*this, attributedStringForView());
}

void KTRAXVelaFriendView::layoutSubviews() {
    KTRVelaFriendView::layoutSubviews();
    if (rendering_->isDue(*this) && Platform::installed()) {
        generateImageForView();
    }
}

}  // namespace ktr
