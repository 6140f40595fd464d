#include "platform/map/MapChromeView.h"

#include <algorithm>
#include <cmath>

#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/LengthFormatter.h"
#include "platform/base/Platform.h"
#include "platform/map/ScaleBar.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

namespace {

constexpr double kScaleIn = 14.0;  // from the start
constexpr double kScaleUp = 13.0;  // from the lower edge
constexpr double kTick = 4.0;
constexpr double kScaleLine = 1.5;
constexpr double kScaleHalo = 2.8;
constexpr double kMostScale = 100.0;
constexpr double kPillIn = 8.0;  // from the end
constexpr double kPillUp = 6.0;
constexpr double kPillHeight = 18.0;
constexpr double kPillPadding = 8.0;
constexpr double kUsualPill = 176.0;
constexpr double kNoteUp = 26.0;
const Font kFont{FontFace::Text, FontWeight::Regular, 11.0};
const Font kNoteFont{FontFace::Text, FontWeight::Regular, 12.0};

bool isRightToLeft() {
    const auto installed = Platform::installed();
    return installed && installed->assistant && installed->assistant->languageIsRightToLeft();
}

std::shared_ptr<const TextLayout> layOut(const std::string& text, const Font& font, double width) {
    const auto installed = Platform::installed();
    if (text.empty() || !installed || !installed->textEngine) {
        return nullptr;
    }
    TextContainer container;
    container.width = width;
    container.alignment = TextAlignment::Left;
    container.rightToLeft = isRightToLeft();
    return installed->textEngine->layOut(AttributedString(text, font), container);
}

}  // namespace

bool MapChromeView::initWithFrame(const Rect& frame) {
    setUserInteractionEnabled(false);
    return View::initWithFrame(frame);
}

void MapChromeView::show(const MapViewport& viewport, bool hasSource, const std::string& attribution) {
    const double width = viewport.size.width - 2.0 * (kPillIn + kPillPadding);
    if (attribution != attribution_ || (width != attributionWidth_ && attributionLayout_)) {
        attributionLayout_ = nullptr;
    }
    attribution_ = attribution;
    if (!attributionLayout_ && !attribution_.empty() && width > 0.0) {
        attributionLayout_ = layOut(attribution_, kFont, width);
        attributionWidth_ = width;
    }
    viewport_ = viewport;
    hasSource_ = hasSource;
    setNeedsDisplay();
}

Rect MapChromeView::placed(const Rect& rect, double width) const {
    return isRightToLeft() ? Rect{width - rect.maxX(), rect.y, rect.width, rect.height} : rect;
}

Rect MapChromeView::pillRect(const Size& size) const {
    if (!attributionLayout_) {
        return {};
    }
    const Size text = attributionLayout_->usedSize();
    const double width = text.width + 2.0 * kPillPadding;
    const double height = std::max(kPillHeight, text.height + kPillHeight - kFont.lineHeight());
    return placed({size.width - kPillIn - width, size.height - kPillUp - height, width, height}, size.width);
}

std::vector<Rect> MapChromeView::clearRects(const Size& size) const {
    constexpr double kAround = 6.0;
    constexpr double kScaleHeight = 36.0;
    const Rect scale{kScaleIn - kAround, size.height - kScaleHeight, kMostScale + 2.0 * kAround, kScaleHeight};
    const double usual = std::min(kUsualPill, size.width - 2.0 * kPillIn);
    Rect pill =
        placed({size.width - kPillIn - usual, size.height - kPillUp - kPillHeight, usual, kPillHeight}, size.width);
    const Rect actual = pillRect(size);
    if (actual.width > pill.width || actual.height > pill.height) {
        pill = actual;
    }
    return {placed(scale, size.width), pill};
}

void MapChromeView::draw(Canvas& canvas) const {
    if (!hasSource_) {
        drawNote(canvas);
        return;
    }
    drawScale(canvas);
    drawAttribution(canvas);
}

void MapChromeView::drawNote(Canvas& canvas) const {
    const auto installed = Platform::installed();
    if (!installed || !installed->localization) {
        return;
    }
    const auto& texts = *installed->localization;
    const auto words = layOut(texts.text("MAP_NOT_AVAILABLE", texts.hostBundleIdentifier()), kNoteFont,
                              std::numeric_limits<double>::infinity());
    if (words) {
        const Size size = words->usedSize();
        canvas.draw(*words, {(bounds().width - size.width) / 2.0, bounds().height - kNoteUp - size.height / 2.0},
                    Color::ofRole(ColorRole::MapNote));
    }
}

void MapChromeView::drawScale(Canvas& canvas) const {
    const auto installed = Platform::installed();
    if (!installed || !installed->lengths) {
        return;
    }
    const ScaleBar bar = ScaleBar::at(viewport_.metresPerPoint(), installed->lengths->system());
    const auto words = layOut(installed->lengths->text(bar.amount, bar.unit, LengthWidth::Short), kFont,
                              std::numeric_limits<double>::infinity());
    if (!(bar.points > 0.0) || !words) {
        return;
    }
    const Size size = bounds().size();
    // An attribution that reaches into the other corner takes the lower edge for itself.
    const Rect pill = pillRect(size);
    const Rect room = placed({kScaleIn, size.height - kScaleUp - kTick, bar.points, kScaleUp + kTick}, size.width);
    const double lift = pill.width > 0.0 && pill.intersects(room) ? size.height - pill.y : 0.0;
    const double y = size.height - kScaleUp - lift;
    Path line;
    line.moveTo({room.x, y - kTick});
    line.lineTo({room.x, y});
    line.lineTo({room.maxX(), y});
    line.lineTo({room.maxX(), y - kTick});
    const Color halo = Color::ofRole(ColorRole::MapScaleHalo);
    const Color ink = Color::ofRole(ColorRole::MapScale);
    const double middle = room.x + room.width / 2.0;
    const Point at{middle - words->usedSize().width / 2.0, y - kTick - 1.0 - kFont.ascent()};
    canvas.stroke(line, halo, {kScaleLine + kScaleHalo, true});
    canvas.drawHalo(*words, at, halo, kScaleHalo);
    canvas.stroke(line, ink, {kScaleLine, true});
    canvas.draw(*words, at, ink);
}

void MapChromeView::drawAttribution(Canvas& canvas) const {
    const Rect pill = pillRect(bounds().size());
    if (!(pill.width > 0.0)) {
        return;
    }
    Path shape;
    shape.addRoundedRect(pill, kPillHeight / 2.0);
    canvas.fill(shape, Color::ofRole(ColorRole::MapAttributionPill));
    const double above = (pill.height - attributionLayout_->usedSize().height) / 2.0;
    canvas.draw(*attributionLayout_, {pill.x + kPillPadding, pill.y + above}, Color::ofRole(ColorRole::MapAttribution));
}

}  // namespace ktr::platform
