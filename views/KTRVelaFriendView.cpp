#include "views/KTRVelaFriendView.h"

#include <cmath>
#include <utility>
#include <vector>

#include "model/ContactsUtilities.h"
#include "model/KTRVATheme.h"
#include "model/LabelUtil.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/FilledText.h"
#include "platform/base/Platform.h"
#include "platform/location/Geodesy.h"
#include "service/Common.h"
#include "service/KTRVAUtils.h"
#include "views/SpokenRow.h"

namespace ktr {

using platform::Label;
using platform::LayoutAxis;
using platform::Platform;
using platform::Rect;

namespace {

/// A label that cannot be squeezed in height nor stretched.
void makeFirm(Label& label, double horizontalCompressionResistance) {
    label.setContentCompressionResistancePriority(platform::kRequiredPriority, LayoutAxis::Vertical);
    label.setContentCompressionResistancePriority(horizontalCompressionResistance, LayoutAxis::Horizontal);
    label.setContentHuggingPriority(platform::kRequiredPriority, LayoutAxis::Vertical);
}

/// With an accessibility text size there are no labels: what is set on one goes nowhere.
void setText(const std::shared_ptr<Label>& label, const std::string& text) {
    if (label) {
        label->setText(text);
    }
}

void setSpokenText(const std::shared_ptr<Label>& label, std::optional<std::string> text) {
    if (label) {
        label->setAccessibilityLabel(std::move(text));
    }
}

std::string spokenPlace(const std::string& place) {
    static const std::string kKey = "ACCESSIBILITY_AT_LABEL";
    return platform::filled(AssistantLocalizedString(kKey), {place});
}

std::string spokenDistance(const std::string& distance) {
    static const std::string kKey = "ACCESSIBILITY_DISTANCE";
    return platform::filled(AssistantLocalizedString(kKey), {distance});
}

}  // namespace

bool KTRVelaFriendView::initWithFrame(const Rect& frame) {
    if (!KTRVelaBaseView::initWithFrame(frame)) {
        return false;
    }
    if (const auto installed = Platform::installed()) {
        currentLocationUpdated_ = installed->notificationCenter->addObserver(
            kCurrentLocationUpdatedNotification, [target = platform::weak(this)](const platform::Notification&) {
                if (const auto self = target.lock()) {
                    self->updateView();
                }
            });
    }
    setAvatarViewController(std::make_shared<platform::ContactAvatarController>());
    if (!axSize()) {
        setupView();
    }
    isRefreshingLocation_ = true;
    return true;
}

void KTRVelaFriendView::setupView() {
    setupAvatar();
    setupLabels();
    setupConstraints();
}

void KTRVelaFriendView::setupLabels() {
    using platform::TextStyle;
    constexpr double required = platform::kRequiredPriority;
    // Between a long name and the distance beside it, the name gives way.
    constexpr double givesWay = platform::kDefaultHuggingPriority;

    nameLabel_ = makeLabel(TextStyle::Headline, KTRVATheme::friendNameTextColor());
    makeFirm(*nameLabel_, givesWay);
    addSubview(nameLabel_);
    bringSubviewToFront(friendIconView());

    timeLabel_ = makeLabel(TextStyle::Subheadline, KTRVATheme::friendLocationTextColor());
    makeFirm(*timeLabel_, required);
    addSubview(timeLabel_);

    setupSeparator();

    locationLabel_ = makeLabel(TextStyle::Subheadline, KTRVATheme::friendLocationTextColor());
    makeFirm(*locationLabel_, required);
    addSubview(locationLabel_);

    distanceLabel_ = makeLabel(TextStyle::Body, KTRVATheme::distanceTextColor());
    makeFirm(*distanceLabel_, required);
    distanceLabel_->setContentHuggingPriority(required, LayoutAxis::Horizontal);
    addSubview(distanceLabel_);
}

void KTRVelaFriendView::setupConstraints() {
    const platform::VisualFormatViews views = {
        {"nameLabel", nameLabel_},         {"locationLabel", locationLabel_},    {"timeLabel", timeLabel_},
        {"distanceLabel", distanceLabel_}, {"friendIconView", friendIconView()}, {"separatorView", separatorView()}};
    const platform::VisualFormat::Picture pictures[] = {
        {"H:|-margin-[friendIconView(pd)]", {}},
        {"H:|-lm-[locationLabel]-margin-|", {}},
        {"H:|-lm-[nameLabel]-hs-[distanceLabel]-margin-|", {platform::VisualFormatAlignment::LastBaseline}},
        {"H:|-lm-[timeLabel]-margin-|", {}},
        {"H:|-0-[separatorView]-0-|", {}},
        {"V:|-vmargin-[friendIconView(pd)]-(>=vmargin)-|", {}},
        {"V:|-vmargin-[locationLabel]-vs-[nameLabel]-vs-[timeLabel]-(>=vmargin)-[separatorView(st)]-0-|", {}},
    };
    platform::VisualFormat::addConstraints(*this, pictures, layoutMetrics(), views);
}

void KTRVelaFriendView::setLocation(std::shared_ptr<KTRVALocation> location) {
    if (location != location_) {
        location_ = std::move(location);
    }
    updateView();
}

void KTRVelaFriendView::updateView() {
    // A position may still arrive when the host has already gone: no text can be formatted then, and what is shown
    // stays.
    if (platform::currentPlatform() == nullptr) {
        return;
    }
    updateAvatar();
    updatePlace();
    setText(nameLabel_, nameText());
    updateAge();
    updateDistance();
}

void KTRVelaFriendView::updateAvatar() {
    std::shared_ptr<platform::Contact> contact;
    if (location_) {
        const auto* object = location_->velaLocation().get();
        const auto* attribute = object != nullptr ? object->friend_.get() : nullptr;
        const bool isEmail = attribute != nullptr && Common::sharedInstance()->isHandleEmail(attribute->data);
        contact = isEmail ? ContactsUtilities::contactForEmail(location_->friendEmail())
                          : ContactsUtilities::contactForPhone(location_->friendPhone());
    }
    assignContactLater(std::move(contact));
}

std::string KTRVelaFriendView::nameText() const {
    return location_ ? location_->friendName() : "";
}

std::string KTRVelaFriendView::placeText() const {
    const std::string text = location_ ? location_->friendLocation(!isRefreshingLocation_) : "";
    // Looked up as it stands: a default label in other letters has no text of its own and shows raw.
    return LabelUtil::isDefaultLabel(text) ? AssistantLocalizedString(text) : text;
}

void KTRVelaFriendView::updatePlace() {
    if (!locationLabel_) {
        return;
    }
    const std::string text = placeText();
    const bool isPlaced = location_ && location_->hasCoordinate();
    if (text == locationLabel_->text() && isPlaced == locationLabel_->accessibilityLabel().has_value()) {
        return;
    }
    locationLabel_->setText(text);
    // Without a coordinate nothing is said but the text itself, lest an earlier place be spoken.
    locationLabel_->setAccessibilityLabel(isPlaced ? std::optional(spokenPlace(text)) : std::nullopt);
}

KTRVAUIUtils::AgeStrings KTRVelaFriendView::ageTexts() const {
    const auto* object = location_ ? location_->velaLocation().get() : nullptr;
    const double date = object != nullptr ? object->locationDate.value_or(0.0) : 0.0;
    return date > 0.0 ? KTRVAUIUtils::ageStringsForDate({date}) : KTRVAUIUtils::AgeStrings();
}

void KTRVelaFriendView::updateAge() {
    auto ages = ageTexts();
    setText(timeLabel_, ages.shown);
    setSpokenText(timeLabel_, std::move(ages.spoken));
}

std::shared_ptr<platform::PlatformLocation> KTRVelaFriendView::userLocation() const {
    const auto source = currentLocationDelegate();
    return source ? source->currentLocation() : nullptr;
}

std::string KTRVelaFriendView::distanceText() const {
    const auto distance = location_ ? location_->distanceFromLocation(userLocation()) : std::nullopt;
    return distance.value_or("");
}

void KTRVelaFriendView::updateDistance() {
    const std::string distance = distanceText();
    if (!distanceLabel_) {
        return;
    }
    const std::string text = isVisibility_ ? "" : distance;
    if (text == distanceLabel_->text() && distanceLabel_->accessibilityLabel()) {
        return;
    }
    distanceLabel_->setText(text);
    distanceLabel_->setAccessibilityLabel(text.empty() ? text : spokenDistance(text));
}

std::optional<platform::Url> KTRVelaFriendView::urlForTouch() {
    const std::string handle = location_ ? location_->unformattedHandle() : "";
    const platform::Url url("wayloc://friend/" + handle);
    LogCategory_Unspecified()->line("Opening URL: %@ for friend handle: %@", url, handle);
    return url;
}

std::string KTRVelaFriendView::accessibilityText() const {
    // Whoever listens may come when the host has already gone: then no text can be formatted.
    if (!Platform::installed()) {
        return "";
    }
    std::vector<std::string> parts = {nameText(), accessibilityLabel().value_or("")};
    if (nameLabel_) {
        for (const auto& label : {locationLabel_, distanceLabel_, timeLabel_}) {
            parts.push_back(label ? label->accessibilityText() : "");
        }
    } else {
        const std::string place = placeText();
        const std::string distance = distanceText();
        const bool isPlaced = location_ && location_->hasCoordinate() && !place.empty();
        parts.push_back(isPlaced ? spokenPlace(place) : place);
        parts.push_back(isVisibility_ || distance.empty() ? "" : spokenDistance(distance));
        parts.push_back(ageTexts().spoken);
    }
    return SpokenRow::line(parts);
}

std::optional<platform::AccessibilitySubject> KTRVelaFriendView::accessibilitySubject() const {
    const auto installed = Platform::installed();
    const auto object = location_ ? location_->velaLocation() : nullptr;
    if (isVisibility_ || !object || !installed) {
        return std::nullopt;
    }
    using Subject = platform::AccessibilitySubject;
    Subject subject;
    subject.person = location_->friendName();
    subject.handle = location_->unformattedHandle();
    const bool hasName = object->label || object->city || object->stateCode;
    if (hasName || location_->hasCoordinate()) {
        subject.whereabouts = Subject::Whereabouts::Known;
        subject.place = hasName ? placeText() : "";
    } else {
        subject.whereabouts = isRefreshingLocation_ ? Subject::Whereabouts::Sought : Subject::Whereabouts::Unknown;
    }
    if (const double date = object->locationDate.value_or(0.0); date > 0.0) {
        subject.ageBand = KTRVAUIUtils::ageBandForDate({date});
    }
    const auto user = userLocation();
    const auto place = KTRVAUtils::geoLocationForVALocation(object);
    if (user && place && installed->geodesy) {
        const double metres = installed->geodesy->distance(user->coordinate(), place->coordinate());
        subject.metres = std::isfinite(metres) ? std::optional(metres) : std::nullopt;
        subject.distance = distanceLabel_ ? distanceLabel_->accessibilityText() : distanceText();
    }
    return subject;
}

double KTRVelaFriendView::estimagedHeightForView() {
    return fittingHeight();
}

}  // namespace ktr
