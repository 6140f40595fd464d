#include "views/KTRVelaSingleLabelView.h"

#include "model/KTRVATheme.h"
#include "platform/layout/VisualFormat.h"

namespace ktr {

using platform::Label;
using platform::LayoutAxis;
using platform::TextAlignment;

namespace {

constexpr double kMargin = 15.0;

}  // namespace

bool KTRVelaSingleLabelView::initWithFrame(const platform::Rect& frame) {
    if (!KTRVelaBaseView::initWithFrame(frame)) {
        return false;
    }
    label_ = platform::create<Label>(&Label::initWithFrame, platform::Rect{});
    label_->setFont(platform::preferredFont(platform::TextStyle::Subheadline));
    label_->setTextColor(KTRVATheme::friendLocationTextColor());
    label_->setBackgroundColor(platform::Color::clear());
    label_->setNumberOfLines(0);
    label_->setLineBreakMode(platform::LineBreakMode::WordWrapping);
    label_->setTextAlignment(TextAlignment::Center);
    label_->setContentCompressionResistancePriority(platform::kRequiredPriority, LayoutAxis::Horizontal);
    label_->setContentCompressionResistancePriority(platform::kRequiredPriority, LayoutAxis::Vertical);
    label_->setContentHuggingPriority(platform::kRequiredPriority, LayoutAxis::Vertical);
    label_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(label_);

    const platform::VisualFormatMetrics metrics = {{"margin", kMargin}};
    const platform::VisualFormatViews views = {{"label", label_}};
    const platform::VisualFormat::Picture pictures[] = {{"H:|-margin-[label]-margin-|", {}},
                                                        {"V:|-margin-[label]-margin-|", {}}};
    platform::VisualFormat::addConstraints(*this, pictures, metrics, views);
    return true;
}

void KTRVelaSingleLabelView::setLabelText(const std::string& text) {
    labelText_ = text;
    if (label_) {
        label_->setText(text);
        label_->setTextAlignment(isShowAll_ ? TextAlignment::Center : TextAlignment::Natural);
    }
}

std::optional<platform::Url> KTRVelaSingleLabelView::urlForTouch() {
    if (!isShowAll_) {
        return std::nullopt;
    }
    return platform::Url("wayloc://friends/");
}

double KTRVelaSingleLabelView::estimagedHeightForView() {
    constexpr double margins = 2.0 * kMargin;
    const platform::AttributedString text =
        label_ ? platform::AttributedString(label_->text(), label_->font()) : platform::AttributedString();
    return sizeForText(text, frame().width - margins).height + margins;
}

platform::AccessibilityRole KTRVelaSingleLabelView::accessibilityRole() const {
    return isShowAll_ ? platform::AccessibilityRole::Link : platform::AccessibilityRole::None;
}

}  // namespace ktr
