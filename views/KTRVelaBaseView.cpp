#include "views/KTRVelaBaseView.h"

#include "model/LogCategory.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Device.h"

namespace ktr {

using platform::Color;
using platform::Platform;
using platform::Touches;
using platform::TouchEvent;

namespace {

constexpr double kTabletMapHeight = 389.0;
constexpr double kMapHeight = 219.0;
/// Heights of text depend on it: narrower than a text container's usual padding.
constexpr double kLineFragmentPadding = 0.5;

}  // namespace

bool KTRVelaBaseView::initWithFrame(const platform::Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    const auto installed = Platform::installed();
    if (installed && installed->device) {
        axSize_ = platform::isAccessibilityCategory(installed->device->contentSizeCategory());
    }
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

double KTRVelaBaseView::mapHeight() {
    const auto installed = Platform::installed();
    const auto idiom = installed && installed->device ? installed->device->userInterfaceIdiom() : std::nullopt;
    return idiom == platform::UserInterfaceIdiom::Tablet ? kTabletMapHeight : kMapHeight;
}

}  // namespace ktr
