#include "views/KTRVelaBaseView.h"

#include "model/LogCategory.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/layout/PinnedEdges.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Device.h"

namespace ktr {

using platform::Color;
using platform::create;
using platform::Label;
using platform::Platform;
using platform::Rect;
using platform::Touches;
using platform::TouchEvent;
using platform::View;

namespace {

constexpr double kTabletMapHeight = 389.0;
constexpr double kMapHeight = 219.0;
/// Heights of text depend on it: narrower than a text container's usual padding.
constexpr double kLineFragmentPadding = 0.5;
constexpr double kAvatarDelay = 0.1;  // seconds
constexpr double kAvatarDiameter = 54.0;

}  // namespace

bool KTRVelaBaseView::initWithFrame(const platform::Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    axSize_ = accessibilitySizeIsActive();
    const auto installed = Platform::installed();
    if (installed && installed->assistant) {
        isRTLUI_ = installed->assistant->languageIsRightToLeft();
    }
    addGestureRecognizer(std::make_shared<platform::TapGestureRecognizer>([target = platform::weak(this)] {
        if (const auto self = target.lock()) {
            self->viewTouched();
        }
    }));
    return true;
}

void KTRVelaBaseView::viewTouched() {
    const auto url = urlForTouch();
    if (!url) {
        return;
    }
    LogCategory_Unspecified()->line("Opening URL: %@", *url);
    if (const auto handler = urlHandler()) {
        handler->handleURL(*url);
    }
}

std::optional<platform::Url> KTRVelaBaseView::urlForTouch() {
    return std::nullopt;
}

double KTRVelaBaseView::estimagedHeightForView() {
    return 0.0;
}

platform::Size KTRVelaBaseView::sizeForText(const platform::AttributedString& text, double width,
                                            const std::vector<platform::Rect>& exclusionPaths) const {
    const auto installed = Platform::installed();
    if (!(width > 0.0) || text.empty() || !installed || !installed->textEngine) {
        return {};
    }
    platform::TextContainer container;
    container.width = width;
    container.exclusionPaths = exclusionPaths;
    container.lineFragmentPadding = kLineFragmentPadding;
    container.hyphenationFactor = 0.0;
    container.lineBreakMode = platform::LineBreakMode::WordWrapping;
    container.rightToLeft = isRTLUI_;
    return installed->textEngine->layOut(text, container)->usedSize();
}

void KTRVelaBaseView::touchesBegan(const Touches& touches, const TouchEvent& event) {
    View::touchesBegan(touches, event);
    // The same on every appearance: a press darkens what is under the finger, whatever the theme.
    setBackgroundColor(Color::white(0.0, 0.2));
}

void KTRVelaBaseView::touchesEnded(const Touches& touches, const TouchEvent& event) {
    View::touchesEnded(touches, event);
    setBackgroundColor(Color::clear());
}

void KTRVelaBaseView::touchesCancelled(const Touches& touches, const TouchEvent& event) {
    View::touchesCancelled(touches, event);
    setBackgroundColor(Color::clear());
}

void KTRVelaBaseView::setSeparatorEnabled(bool enabled) {
    separatorEnabled_ = enabled;
    if (separatorView_) {
        separatorView_->setHidden(!enabled);
    }
}

void KTRVelaBaseView::setupAvatar() {
    using platform::LayoutAttribute;
    const auto avatar = avatarViewController_->view();
    avatar->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_ = create<View>(&View::initWithFrame, Rect{0.0, 0.0, kAvatarDiameter, kAvatarDiameter});
    friendIconView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    friendIconView_->addSubview(avatar);
    platform::pinEdges(
        *avatar, *friendIconView_,
        {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Leading, LayoutAttribute::Trailing});
    addSubview(friendIconView_);
}

void KTRVelaBaseView::setupSeparator() {
    separatorView_ = create<View>(&View::initWithFrame, Rect{});
    separatorView_->setLayerBackgroundColor(Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
    separatorView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(separatorView_);
}

std::shared_ptr<Label> KTRVelaBaseView::makeLabel(platform::TextStyle style, const Color& color) {
    auto label = create<Label>(&Label::initWithFrame, Rect{});
    label->setFont(platform::preferredFont(style));
    label->setTextColor(color);
    label->setBackgroundColor(Color::clear());
    label->setNumberOfLines(1);
    label->setLineBreakMode(platform::LineBreakMode::TruncatingTail);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    return label;
}

platform::VisualFormatMetrics KTRVelaBaseView::layoutMetrics() {
    const auto installed = Platform::installed();
    const double scale = installed && installed->device ? installed->device->mainScreenScale() : 1.0;
    return {{"margin", 15.0},        {"vmargin", 10.0}, {"hs", 13.0}, {"vs", 0.0},
            {"pd", kAvatarDiameter}, {"ld", 16.0},      {"lm", 82.0}, {"st", 1.0 / scale}};
}

void KTRVelaBaseView::assignContactLater(std::shared_ptr<platform::Contact> contact) {
    const bool isGiven = contactsAwaited_ == 0 && hasContact_ && contact_ == contact.get();
    const auto installed = isGiven ? nullptr : Platform::installed();
    if (!installed || !installed->mainLoop) {
        return;
    }
    ++contactsAwaited_;
    installed->mainLoop->schedule(kAvatarDelay, false, [self = platform::strong(this), shown = std::move(contact)] {
        --self->contactsAwaited_;
        if (self->avatarViewController_) {
            self->avatarViewController_->setContacts({shown ? shown : std::make_shared<platform::Contact>()});
            self->hasContact_ = true;
            self->contact_ = shown.get();
        }
    });
}

double KTRVelaBaseView::fittingHeight() {
    constexpr double priority = 750.0;
    return systemLayoutSizeFitting({frame().width, platform::kCompressedFittingExtent}, priority, priority).height;
}

bool KTRVelaBaseView::accessibilitySizeIsActive() {
    const auto installed = Platform::installed();
    return installed && installed->device &&
           platform::isAccessibilityCategory(installed->device->contentSizeCategory());
}

double KTRVelaBaseView::mapHeight() {
    const auto installed = Platform::installed();
    const auto idiom = installed && installed->device ? installed->device->userInterfaceIdiom() : std::nullopt;
    return idiom == platform::UserInterfaceIdiom::Tablet ? kTabletMapHeight : kMapHeight;
}

}  // namespace ktr
