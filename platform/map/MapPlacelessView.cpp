#include "platform/map/MapPlacelessView.h"

#include <algorithm>
#include <limits>
#include <memory>
#include <vector>

#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/Platform.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Canvas.h"
#include "platform/ui/Font.h"

namespace ktr::platform {

namespace {

constexpr double kRadius = 34.0;
constexpr double kCentreDown = 88.0;  ///< of a map that is kUsualHeight high; of others the same share
constexpr double kUsualHeight = 219.0;
constexpr double kStroke = 1.8;
constexpr double kWordsBelow = 70.0;  ///< their lower edge, below the centre
constexpr double kToWords = 6.0;      ///< at least, from the circle
constexpr double kMargin = 8.0;       ///< of the circle and of the words, above and below
/// Twenty dashes of 6.1 points, with 4.58 between them.
constexpr int kDashes = 20;
constexpr double kDashShare = 6.1 / (6.1 + 4.58);

void drawCircle(Canvas& canvas, Point centre) {
    const Color edge = Color::ofRole(ColorRole::MapNote);
    Path disc;
    disc.addCircle(centre, kRadius);
    canvas.fill(disc, Color::ofRole(ColorRole::MapAttributionPill));
    constexpr double kStep = 360.0 / kDashes;
    for (int dash = 0; dash < kDashes; ++dash) {
        Path arc;
        arc.addArc(centre, kRadius - kStroke / 2.0, dash * kStep, kStep * kDashShare);
        canvas.stroke(arc, edge, {kStroke, true});
    }
    Path person;
    person.addCircle({centre.x, centre.y - 6.0}, 5.2);
    canvas.stroke(person, edge, {kStroke, true});
    Path shoulders;
    shoulders.moveTo({centre.x - 9.5, centre.y + 13.0});
    shoulders.cubicTo({centre.x - 9.5, centre.y + 6.5}, {centre.x - 5.0, centre.y + 4.0}, {centre.x, centre.y + 4.0});
    shoulders.cubicTo({centre.x + 5.0, centre.y + 4.0}, {centre.x + 9.5, centre.y + 6.5},
                      {centre.x + 9.5, centre.y + 13.0});
    canvas.stroke(shoulders, edge, {kStroke, true});
}

/// Where a line begins that is in the middle of what is left and right of what it would touch.
double clearOf(const std::vector<Rect>& taken, const Rect& line, const Rect& free) {
    double from = free.x;
    double to = free.maxX();
    for (const Rect& rect : taken) {
        if (!rect.intersects(line)) {
            continue;
        }
        const double before = rect.x - from;
        const double after = to - rect.maxX();
        (before < after ? from : to) = before < after ? rect.maxX() : rect.x;
    }
    return from == free.x && to == free.maxX() ? line.x : (from + to - line.width) / 2.0;
}

std::shared_ptr<const TextLayout> layOutWords() {
    const auto installed = Platform::installed();
    if (!installed || !installed->localization || !installed->textEngine) {
        return nullptr;
    }
    const auto& texts = *installed->localization;
    TextContainer container;
    container.width = std::numeric_limits<double>::infinity();
    container.rightToLeft = installed->assistant && installed->assistant->languageIsRightToLeft();
    container.alignment = TextAlignment::Left;
    return installed->textEngine->layOut(AttributedString(texts.text("MAP_NO_PLACE", texts.hostBundleIdentifier()),
                                                          preferredFont(TextStyle::Subheadline)),
                                         container);
}

}  // namespace

bool MapPlacelessView::initWithFrame(const Rect& frame) {
    setUserInteractionEnabled(false);
    return View::initWithFrame(frame);
}

void MapPlacelessView::setFree(const Rect& free, const std::vector<Rect>& taken) {
    if (free_ != free || taken_ != taken) {
        free_ = free;
        taken_ = taken;
        setNeedsDisplay();
    }
}

void MapPlacelessView::draw(Canvas& canvas) const {
    canvas.fill(bounds(), Color::ofRole(ColorRole::MapLand));
    const Rect free = free_.value_or(bounds());
    const auto words = layOutWords();
    const Size size = words ? words->usedSize() : Size{};
    const double toWords =
        std::max(kWordsBelow - preferredFont(TextStyle::Subheadline).lineHeight(), kRadius + kToWords);
    const double below = words ? toWords + size.height : kRadius;
    Point centre{free.x + free.width / 2.0, free.y + free.height * kCentreDown / kUsualHeight};
    const double highest = free.y + kMargin + kRadius;
    const double lowest = free.maxY() - kMargin - below;
    Rect line{centre.x - size.width / 2.0, free.y + (free.height - size.height) / 2.0, size.width, size.height};
    if (highest <= lowest) {
        centre.y = std::clamp(centre.y, highest, lowest);
        drawCircle(canvas, centre);
        line.y = centre.y + toWords;
    }
    line.x = clearOf(taken_, line, free);
    if (words && size.height <= free.height) {
        canvas.draw(*words, {line.x, line.y}, Color::ofRole(ColorRole::StandardText));
    }
}

}  // namespace ktr::platform
