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
constexpr double kScaleFromTop = 27.0;
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

/// Room for any scale bar and its words.
Rect MapChromeView::scaleRoom(const Size& size, bool isAbove) const {
    constexpr double kAround = 6.0;
    constexpr double kHeight = 36.0;
    const double y = isAbove ? 0.0 : size.height - kHeight;
    return placed({kScaleIn - kAround, y, kMostScale + 2.0 * kAround, kHeight}, size.width);
}

/// Room for the attribution, and for a usual one before it is known.
Rect MapChromeView::pillRoom(const Size& size, bool isAbove) const {
    const Size text = attributionLayout_ ? attributionLayout_->usedSize() : Size{};
    const double width = std::max(text.width + 2.0 * kPillPadding, std::min(kUsualPill, size.width - 2.0 * kPillIn));
    const double height = std::max(kPillHeight, text.height + kPillHeight - kFont.lineHeight());
    const double y = isAbove ? kPillUp : size.height - kPillUp - height;
    return placed({size.width - kPillIn - width, y, width, height}, size.width);
}

Rect MapChromeView::pillRect(const Size& size) const {
    if (!attributionLayout_) {
        return {};
    }
    const double width = attributionLayout_->usedSize().width + 2.0 * kPillPadding;
    const Rect room = pillRoom(size, isPillAbove_);
    return placed({size.width - kPillIn - width, room.y, width, room.height}, size.width);
}

void MapChromeView::avoid(const std::vector<Rect>& rects, const Size& size) {
    const auto isTaken = [&](const Rect& room) {
        return std::any_of(rects.begin(), rects.end(), [&](const Rect& rect) { return rect.intersects(room); });
    };
    const bool isScaleAbove = isTaken(scaleRoom(size, false)) && !isTaken(scaleRoom(size, true));
    const bool isPillAbove = isTaken(pillRoom(size, false)) && !isTaken(pillRoom(size, true));
    if (isScaleAbove != isScaleAbove_ || isPillAbove != isPillAbove_) {
        isScaleAbove_ = isScaleAbove;
        isPillAbove_ = isPillAbove;
        setNeedsDisplay();
    }
}

std::vector<Rect> MapChromeView::clearRects(const Size& size) const {
    return {scaleRoom(size, isScaleAbove_), pillRoom(size, isPillAbove_)};
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
    // Of half the world no one scale is true.
    constexpr double kCoarsest = 20000.0;
    if (viewport_.metresPerPoint() > kCoarsest) {
        return;
    }
    const ScaleBar bar = ScaleBar::at(viewport_.metresPerPoint(), installed->lengths->system());
    const auto words = layOut(installed->lengths->text(bar.amount, bar.unit, LengthWidth::Short), kFont,
                              std::numeric_limits<double>::infinity());
    if (!(bar.points > 0.0) || !words) {
        return;
    }
    const Size size = bounds().size();
    const Rect room = placed({kScaleIn, 0.0, bar.points, size.height}, size.width);
    const Rect pill = pillRect(size);
    // An attribution that reaches into the other corner takes the edge for itself.
    const bool isShared =
        pill.width > 0.0 && isPillAbove_ == isScaleAbove_ && pill.x < room.maxX() && room.x < pill.maxX();
    const double lift = isShared ? pill.height + kPillUp : 0.0;
    const double y = isScaleAbove_ ? kScaleFromTop + lift : size.height - kScaleUp - lift;
    Path line;
    line.moveTo({room.x, y - kTick});
    line.lineTo({room.x, y});
    line.lineTo({room.maxX(), y});
    line.lineTo({room.maxX(), y - kTick});
    const Color halo = Color::ofRole(ColorRole::MapScaleHalo);
    const Color ink = Color::ofRole(ColorRole::MapScale);
    const double middle = room.x + room.width / 2.0;
    const Point at{middle - words->usedSize().width / 2.0, y - kTick - 2.0 - kFont.ascent()};
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
