#include "views/KTRVelaFenceView.h"

#include <utility>

#include "model/ContactsUtilities.h"
#include "model/KTRVATheme.h"
#include "model/LabelUtil.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/Format.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"
#include "service/Common.h"
#include "views/SpokenRow.h"

namespace ktr {

using platform::create;
using platform::Label;
using platform::LayoutAxis;
using platform::Platform;
using platform::Rect;

namespace {

/// An absent label is passed over.
void hideWhenEmpty(const std::shared_ptr<Label>& label) {
    if (label) {
        label->setHidden(label->text().empty());
    }
}

}  // namespace

bool KTRVelaFenceView::initWithFrame(const Rect& frame) {
    if (!KTRVelaBaseView::initWithFrame(frame)) {
        return false;
    }
    setAvatarViewController(std::make_shared<platform::ContactAvatarController>());
    if (!axSize()) {
        setupView();
    }
    isRefreshingLocation_ = true;
    return true;
}

void KTRVelaFenceView::setupView() {
    setupAvatar();
    setupLabels();
    setupConstraints();
}

void KTRVelaFenceView::setupIcon() {
    geoFenceIconImageView_ = create<platform::ImageView>(&platform::ImageView::initWithFrame, Rect{});
    geoFenceIconImageView_->setImage(KTRVATheme::locationIndicator());
    geoFenceIconImageView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(geoFenceIconImageView_);
}

void KTRVelaFenceView::setupLabels() {
    using platform::TextStyle;
    constexpr double required = platform::kRequiredPriority;
    // Between a long name and the icon beside it, the name gives way.
    constexpr double givesWay = platform::kDefaultHuggingPriority;

    nameLabel_ = makeLabel(TextStyle::Body, KTRVATheme::friendNameTextColor());
    addSubview(nameLabel_);

    setupIcon();

    fenceLabel_ = makeLabel(TextStyle::Footnote, KTRVATheme::friendLocationTextColor());
    addSubview(fenceLabel_);

    setupSeparator();

    nameLabel_->setContentCompressionResistancePriority(givesWay, LayoutAxis::Horizontal);
    nameLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Vertical);
    fenceLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Horizontal);
    fenceLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Vertical);
}

void KTRVelaFenceView::setupConstraints() {
    const platform::VisualFormatViews views = {{"nameLabel", nameLabel_},
                                               {"fenceLabel", fenceLabel_},
                                               {"friendIconView", friendIconView()},
                                               {"geoFenceIconImageView", geoFenceIconImageView_},
                                               {"separatorView", separatorView()}};
    const platform::VisualFormat::Picture pictures[] = {
        {"H:|-margin-[friendIconView(pd)]", {}},
        {"H:|-lm-[nameLabel]-hs-[geoFenceIconImageView(ld)]-margin-|", {platform::VisualFormatAlignment::Bottom}},
        {"H:|-lm-[fenceLabel]-margin-|", {}},
        {"H:|-0-[separatorView]-0-|", {}},
        {"V:|-vmargin-[friendIconView(pd)]-(>=vmargin)-|", {}},
        {"V:|-vmargin-[nameLabel]-vs-[fenceLabel]-(>=vmargin)-[separatorView(st)]-0-|", {}},
    };
    platform::VisualFormat::addConstraints(*this, pictures, layoutMetrics(), views);
}

void KTRVelaFenceView::setGeoFence(std::shared_ptr<platform::VAKtrGeoFence> geoFence) {
    geoFence_ = std::move(geoFence);
    updateFenceView();
}

void KTRVelaFenceView::updateFenceView() {
    // Without a platform no text can be formatted: what is shown stays.
    if (!Platform::installed()) {
        return;
    }
    if (nameLabel_) {
        nameLabel_->setText(friendName().value_or(""));
    }
    const std::string sentence = fenceSentence();
    updateAvatar();
    if (fenceLabel_) {
        fenceLabel_->setText(sentence);
    }
    updateViewVisibility();
}

std::string KTRVelaFenceView::fenceSentence() const {
    const std::string immediate = AssistantLocalizedString("IMMEDIATE_LABEL");
    const auto trigger = geoFence_ ? geoFence_->geoFenceTrigger : std::nullopt;
    if (trigger == platform::VAKtrGeoFenceTriggerImmediateValue) {
        return immediate;
    }
    // Whatever is not leaving is arriving, triggers of a later day included.
    const bool leaving = trigger == platform::VAKtrGeoFenceTriggerOnDepartureValue;
    const std::string format = AssistantLocalizedString(leaving ? "LEAVING_LABEL" : "ARRIVING_LABEL");
    const auto location = geoFence_ ? geoFence_->location : nullptr;
    auto place = location ? location->label : std::nullopt;
    if (place && LabelUtil::isDefaultLabel(place)) {
        // Looked up in small letters, unlike in a friend's row: a default label is found in any letters.
        place = AssistantLocalizedString(platform::asciiLowercased(*place));
    }
    if (!place && location) {
        place = location->street;
    }
    if (!place) {
        return AssistantLocalizedString(leaving ? "LEAVING_LABEL_ABSOLUTE" : "ARRIVING_LABEL_ABSOLUTE");
    }
    return platform::formatted(format, {*place});
}

void KTRVelaFenceView::updateAvatar() {
    std::shared_ptr<platform::Contact> contact;
    if (geoFence_) {
        contact = Common::sharedInstance()->isHandleEmail(serviceHandle())
                      ? ContactsUtilities::contactForEmail(friendEmail())
                      : ContactsUtilities::contactForPhone(friendPhone());
    }
    assignContactLater(std::move(contact));
}

void KTRVelaFenceView::updateViewVisibility() {
    hideWhenEmpty(fenceLabel_);
    hideWhenEmpty(distanceLabel_);
}

std::shared_ptr<platform::VAPerson> KTRVelaFenceView::person() const {
    return geoFence_ && geoFence_->friend_ ? geoFence_->friend_->object : nullptr;
}

std::optional<std::string> KTRVelaFenceView::serviceHandle() const {
    return geoFence_ && geoFence_->friend_ ? geoFence_->friend_->data : std::nullopt;
}

std::optional<std::string> KTRVelaFenceView::friendName() const {
    const auto friendPerson = person();
    if (friendPerson && friendPerson->fullName && !friendPerson->fullName->empty()) {
        return friendPerson->fullName;
    }
    return friendHandle();
}

std::optional<std::string> KTRVelaFenceView::friendEmail() const {
    const auto friendPerson = person();
    if (!friendPerson || friendPerson->emails.empty() || !friendPerson->emails.back()) {
        return std::nullopt;
    }
    return friendPerson->emails.back()->emailAddress;
}

std::optional<std::string> KTRVelaFenceView::friendPhone() const {
    const auto friendPerson = person();
    if (!friendPerson || friendPerson->phones.empty() || !friendPerson->phones.back()) {
        return std::nullopt;
    }
    return friendPerson->phones.back()->number;
}

std::optional<std::string> KTRVelaFenceView::friendHandle() const {
    auto email = friendEmail();
    return email ? email : friendPhone();
}

std::optional<platform::Url> KTRVelaFenceView::urlForTouch() {
    const auto handle = serviceHandle();
    if (!handle) {
        return std::nullopt;
    }
    // The line's words say the opposite of what happens; whoever searches logs knows it as it is.
    LogCategory_Unspecified()->line("Unable to open friend URL, no friend email exists");
    return platform::Url("wayloc://friend/" + *handle);
}

platform::AccessibilityRole KTRVelaFenceView::accessibilityRole() const {
    return serviceHandle() ? platform::AccessibilityRole::Link : platform::AccessibilityRole::Text;
}

std::string KTRVelaFenceView::accessibilityText() const {
    // Whoever listens may come when the host has already gone: then no text can be formatted.
    if (!Platform::installed()) {
        return "";
    }
    return SpokenRow::line({friendName().value_or(""), accessibilityLabel().value_or(""), fenceSentence()});
}

double KTRVelaFenceView::estimagedHeightForView() {
    return fittingHeight();
}

}  // namespace ktr
