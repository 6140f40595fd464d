#include "views/KTRVelaFriendView.h"

#include <utility>
#include <vector>

#include "model/ContactsUtilities.h"
#include "model/KTRVATheme.h"
#include "model/KTRVAUIUtils.h"
#include "model/LabelUtil.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/layout/ConstraintRule.h"
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

/// A one-line label that cannot be squeezed in height nor stretched.
std::shared_ptr<Label> makeLabel(platform::TextStyle style, const platform::Color& color,
                                 double horizontalCompressionResistance) {
    auto label = create<Label>(&Label::initWithFrame, Rect{});
    label->setFont(platform::preferredFont(style));
    label->setTextColor(color);
    label->setBackgroundColor(platform::Color::clear());
    label->setNumberOfLines(1);
    label->setLineBreakMode(platform::LineBreakMode::TruncatingTail);
    label->setContentCompressionResistancePriority(platform::kRequiredPriority, LayoutAxis::Vertical);
    label->setContentCompressionResistancePriority(horizontalCompressionResistance, LayoutAxis::Horizontal);
    label->setContentHuggingPriority(platform::kRequiredPriority, LayoutAxis::Vertical);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    return label;
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

std::string entry(const platform::Dictionary& texts, const char* key) {
    const platform::Value* value = texts.find(key);
    return value ? value->description() : "";
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
    avatarViewController_ = std::make_shared<platform::ContactAvatarController>();
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

void KTRVelaFriendView::setupAvatar() {
    const auto avatar = avatarViewController_->view();
    avatar->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_ = create<View>(&View::initWithFrame, Rect{0.0, 0.0, kAvatarDiameter, kAvatarDiameter});
    friendIconView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_->addSubview(avatar);
    using platform::LayoutAttribute;
    const platform::ViewReference image(*avatar);
    const platform::ViewReference icon(*friendIconView_);
    std::vector<platform::ConstraintRule> edges;
    edges.reserve(4);
    for (const auto edge :
         {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Leading, LayoutAttribute::Trailing}) {
        edges.push_back({image, icon, {edge, edge}});
    }
    friendIconView_->addRules(edges);
    addSubview(friendIconView_);
}

void KTRVelaFriendView::setupLabels() {
    using platform::TextStyle;
    constexpr double required = platform::kRequiredPriority;
    // Between a long name and the distance beside it, the name gives way.
    constexpr double givesWay = platform::kDefaultHuggingPriority;

    nameLabel_ = makeLabel(TextStyle::Headline, KTRVATheme::friendNameTextColor(), givesWay);
    addSubview(nameLabel_);
    bringSubviewToFront(friendIconView_);

    timeLabel_ = makeLabel(TextStyle::Subheadline, KTRVATheme::friendLocationTextColor(), required);
    addSubview(timeLabel_);

    separatorView_ = create<View>(&View::initWithFrame, Rect{});
    separatorView_->setLayerBackgroundColor(platform::Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
    separatorView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(separatorView_);

    locationLabel_ = makeLabel(TextStyle::Subheadline, KTRVATheme::friendLocationTextColor(), required);
    addSubview(locationLabel_);

    distanceLabel_ = makeLabel(TextStyle::Body, KTRVATheme::distanceTextColor(), required);
    distanceLabel_->setContentHuggingPriority(required, LayoutAxis::Horizontal);
    addSubview(distanceLabel_);
}

void KTRVelaFriendView::setupConstraints() {
    const auto installed = Platform::installed();
    const double scale = installed && installed->device ? installed->device->mainScreenScale() : 1.0;
    // The same for all rows but for the scale.
    static platform::VisualFormatMetrics metrics = {
        {"margin", 15.0},        {"vmargin", 10.0}, {"hs", 13.0}, {"vs", 0.0},
        {"pd", kAvatarDiameter}, {"ld", 16.0},      {"lm", 82.0}, {"st", 1.0}};
    metrics["st"] = 1.0 / scale;
    const platform::VisualFormatViews views = {{"nameLabel", nameLabel_},           {"locationLabel", locationLabel_},
                                               {"timeLabel", timeLabel_},           {"distanceLabel", distanceLabel_},
                                               {"friendIconView", friendIconView_}, {"separatorView", separatorView_}};
    const platform::VisualFormat::Picture pictures[] = {
        {"H:|-margin-[friendIconView(pd)]", {}},
        {"H:|-lm-[locationLabel]-margin-|", {}},
        {"H:|-lm-[nameLabel]-hs-[distanceLabel]-margin-|", {platform::VisualFormatAlignment::LastBaseline}},
        {"H:|-lm-[timeLabel]-margin-|", {}},
        {"H:|-0-[separatorView]-0-|", {}},
        {"V:|-vmargin-[friendIconView(pd)]-(>=vmargin)-|", {}},
        {"V:|-vmargin-[locationLabel]-vs-[nameLabel]-vs-[timeLabel]-(>=vmargin)-[separatorView(st)]-0-|", {}},
    };
    platform::VisualFormat::addConstraints(*this, pictures, metrics, views);
}

void KTRVelaFriendView::setLocation(std::shared_ptr<KTRVALocation> location) {
    if (location != location_) {
        location_ = std::move(location);
    }
    updateView();
}

void KTRVelaFriendView::setSeparatorEnabled(bool enabled) {
    separatorEnabled_ = enabled;
    if (separatorView_) {
        separatorView_->setHidden(!enabled);
    }
}

void KTRVelaFriendView::updateView() {
    // A position may still arrive when the host has already gone: nothing can be worded then, and what is shown stays.
    if (!Platform::installed()) {
        return;
    }
    updateAvatar();
    updatePlace();
    setText(nameLabel_, location_ ? location_->friendName() : "");
    updateAge();
    updateDistance();
}

void KTRVelaFriendView::updateAvatar() {
    const auto attribute = location_ && location_->velaLocation() ? location_->velaLocation()->friend_ : nullptr;
    const auto handle = attribute ? attribute->data : std::nullopt;
    std::shared_ptr<platform::Contact> contact;
    if (location_) {
        contact = Common::sharedInstance()->isHandleEmail(handle)
                      ? ContactsUtilities::contactForEmail(location_->friendEmail())
                      : ContactsUtilities::contactForPhone(location_->friendPhone());
    }
    const auto installed = Platform::installed();
    if (!installed || !installed->mainLoop) {
        return;
    }
    // The row is held until the step has run: it is the row that was filled that gets the avatar, whoever drops it.
    installed->mainLoop->schedule(kAvatarDelay, false, [self = platform::strong(this), contact] {
        if (self->avatarViewController_) {
            self->avatarViewController_->setContacts({contact ? contact : std::make_shared<platform::Contact>()});
        }
    });
}

void KTRVelaFriendView::updatePlace() {
    std::string text = location_ ? location_->friendLocation(!isRefreshingLocation_) : "";
    if (LabelUtil::isDefaultLabel(text)) {
        // Looked up as it stands: a default label in other letters has no text of its own and shows raw.
        text = AssistantLocalizedString(text);
    }
    setText(locationLabel_, text);
    // Without a coordinate nothing is said but the text itself, lest an earlier place be spoken.
    std::optional<std::string> spoken;
    if (location_ && location_->hasCoordinate() && locationLabel_) {
        spoken = platform::formatted(AssistantLocalizedString("ACCESSIBILITY_AT_LABEL"), {locationLabel_->text()});
    }
    setSpokenText(locationLabel_, std::move(spoken));
}

void KTRVelaFriendView::updateAge() {
    const auto object = location_ ? location_->velaLocation() : nullptr;
    const double date = object ? object->locationDate.value_or(0.0) : 0.0;
    std::string text;
    std::string spoken;
    if (date > 0.0) {
        const auto ages = KTRVAUIUtils::dictionaryWithAgeStringsForDate({date});
        text = entry(ages, LabelStringKey);
        spoken = entry(ages, LabelAccessibilityStringKey);
    }
    setText(timeLabel_, text);
    setSpokenText(timeLabel_, std::move(spoken));
}

void KTRVelaFriendView::updateDistance() {
    const auto source = currentLocationDelegate();
    const auto userLocation = source ? source->currentLocation() : nullptr;
    const auto distance = location_ ? location_->distanceFromLocation(userLocation) : std::nullopt;
    std::string text;
    std::string spoken;
    if (distance && !isVisibility_ && !distance->empty()) {
        text = *distance;
        spoken = platform::formatted(AssistantLocalizedString("ACCESSIBILITY_DISTANCE"), {*distance});
    }
    setText(distanceLabel_, text);
    setSpokenText(distanceLabel_, std::move(spoken));
}

std::optional<platform::Url> KTRVelaFriendView::urlForTouch() {
    const std::string handle = location_ ? location_->unformattedHandle() : "";
    const platform::Url url("wayloc://friend/" + handle);
    LogCategory_Unspecified()->line("Opening URL: %@ for friend handle: %@", url, handle);
    return url;
}

double KTRVelaFriendView::estimagedHeightForView() {
    constexpr double priority = 750.0;
    return systemLayoutSizeFitting({frame().width, platform::kCompressedFittingExtent}, priority, priority).height;
}

}  // namespace ktr
