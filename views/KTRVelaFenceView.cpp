#include "views/KTRVelaFenceView.h"

#include <utility>

#include "model/ContactsUtilities.h"
#include "model/KTRVATheme.h"
#include "model/LabelUtil.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/Format.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"
#include "platform/layout/VisualFormat.h"
#include "platform/ui/Device.h"
#include "service/Common.h"

namespace ktr {

using platform::create;
using platform::Label;
using platform::LayoutAxis;
using platform::Platform;
using platform::Rect;
using platform::View;

namespace {

constexpr double kAvatarDelay = 0.1;  // seconds
constexpr double kAvatarDiameter = 54.0;

std::shared_ptr<Label> makeLabel(platform::TextStyle style, const platform::Color& color) {
    auto label = create<Label>(&Label::initWithFrame, Rect{});
    label->setFont(platform::preferredFont(style));
    label->setTextColor(color);
    label->setBackgroundColor(platform::Color::clear());
    label->setNumberOfLines(1);
    label->setLineBreakMode(platform::LineBreakMode::TruncatingTail);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    return label;
}

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
    avatarViewController_ = std::make_shared<platform::ContactAvatarController>();
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

void KTRVelaFenceView::setupAvatar() {
    const auto avatar = avatarViewController_->view();
    avatar->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_ = create<View>(&View::initWithFrame, Rect{0.0, 0.0, kAvatarDiameter, kAvatarDiameter});
    friendIconView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_->addSubview(avatar);
    using platform::LayoutAttribute;
    for (const auto edge :
         {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Leading, LayoutAttribute::Trailing}) {
        avatar->anchor(edge).constraintEqualTo(friendIconView_->anchor(edge))->setActive(true);
    }
    addSubview(friendIconView_);
}

void KTRVelaFenceView::setupLabels() {
    using platform::TextStyle;
    constexpr double required = platform::kRequiredPriority;
    // Between a long name and the icon beside it, the name gives way.
    constexpr double givesWay = platform::kDefaultHuggingPriority;

    nameLabel_ = makeLabel(TextStyle::Body, KTRVATheme::friendNameTextColor());
    addSubview(nameLabel_);

    geoFenceIconImageView_ = create<platform::ImageView>(&platform::ImageView::initWithFrame, Rect{});
    geoFenceIconImageView_->setImage(KTRVATheme::locationIndicator());
    geoFenceIconImageView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(geoFenceIconImageView_);

    fenceLabel_ = makeLabel(TextStyle::Footnote, KTRVATheme::friendLocationTextColor());
    addSubview(fenceLabel_);

    separatorView_ = create<View>(&View::initWithFrame, Rect{});
    separatorView_->setLayerBackgroundColor(platform::Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
    separatorView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(separatorView_);

    nameLabel_->setContentCompressionResistancePriority(givesWay, LayoutAxis::Horizontal);
    nameLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Vertical);
    fenceLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Horizontal);
    fenceLabel_->setContentCompressionResistancePriority(required, LayoutAxis::Vertical);
}

void KTRVelaFenceView::setupConstraints() {
    const auto installed = Platform::installed();
    const double scale = installed && installed->device ? installed->device->mainScreenScale() : 1.0;
    const platform::VisualFormatMetrics metrics = {{"margin", 15.0}, {"vmargin", 10.0},       {"hs", 13.0},
                                                   {"vs", 0.0},      {"pd", kAvatarDiameter}, {"ld", 16.0},
                                                   {"lm", 82.0},     {"st", 1.0 / scale}};
    const platform::VisualFormatViews views = {{"nameLabel", nameLabel_},
                                               {"fenceLabel", fenceLabel_},
                                               {"friendIconView", friendIconView_},
                                               {"geoFenceIconImageView", geoFenceIconImageView_},
                                               {"separatorView", separatorView_}};
    const auto add = [&](const char* format, const platform::VisualFormatOptions& options = {}) {
        addConstraints(platform::VisualFormat::constraintsWithVisualFormat(format, options, metrics, views));
    };
    add("H:|-margin-[friendIconView(pd)]");
    add("H:|-lm-[nameLabel]-hs-[geoFenceIconImageView(ld)]-margin-|", {platform::VisualFormatAlignment::Bottom});
    add("H:|-lm-[fenceLabel]-margin-|");
    add("H:|-0-[separatorView]-0-|");
    add("V:|-vmargin-[friendIconView(pd)]-(>=vmargin)-|");
    add("V:|-vmargin-[nameLabel]-vs-[fenceLabel]-(>=vmargin)-[separatorView(st)]-0-|");
}

void KTRVelaFenceView::setGeoFence(std::shared_ptr<platform::VAKtrGeoFence> geoFence) {
    geoFence_ = std::move(geoFence);
    updateFenceView();
}

void KTRVelaFenceView::setSeparatorEnabled(bool enabled) {
    separatorEnabled_ = enabled;
    if (separatorView_) {
        separatorView_->setHidden(!enabled);
    }
}

void KTRVelaFenceView::updateFenceView() {
    // Without a platform nothing can be worded: what is shown stays.
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
    const auto loop = Platform::installed()->mainLoop;
    if (!loop) {
        return;
    }
    // The row is held until the step has run: it is the row that was filled that gets the avatar, whoever drops it.
    loop->schedule(kAvatarDelay, false, [self = platform::strong(this), contact] {
        if (self->avatarViewController_) {
            self->avatarViewController_->setContacts({contact ? contact : std::make_shared<platform::Contact>()});
        }
    });
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
    return serviceHandle() ? platform::AccessibilityRole::Link : platform::AccessibilityRole::Group;
}

double KTRVelaFenceView::estimagedHeightForView() {
    constexpr double priority = 750.0;
    return systemLayoutSizeFitting({frame().width, platform::kCompressedFittingExtent}, priority, priority).height;
}

}  // namespace ktr
