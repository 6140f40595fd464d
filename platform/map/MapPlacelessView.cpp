#include "platform/map/MapPlacelessView.h"

#include <limits>

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
constexpr double kWordsBelow = 70.0;  ///< the centre
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

}  // namespace

bool MapPlacelessView::initWithFrame(const Rect& frame) {
    setUserInteractionEnabled(false);
    return View::initWithFrame(frame);
}

void MapPlacelessView::draw(Canvas& canvas) const {
    canvas.fill(bounds(), Color::ofRole(ColorRole::MapLand));
    const Point centre{bounds().width / 2.0, bounds().height * kCentreDown / kUsualHeight};
    drawCircle(canvas, centre);
    const auto installed = Platform::installed();
    if (!installed || !installed->localization || !installed->textEngine) {
        return;
    }
    const auto& texts = *installed->localization;
    TextContainer container;
    container.width = std::numeric_limits<double>::infinity();
    container.rightToLeft = installed->assistant && installed->assistant->languageIsRightToLeft();
    container.alignment = TextAlignment::Left;
    const Font font = preferredFont(TextStyle::Subheadline);
    const auto words = installed->textEngine->layOut(
        AttributedString(texts.text("MAP_NO_PLACE", texts.hostBundleIdentifier()), font), container);
    if (words) {
        const Size size = words->usedSize();
        canvas.draw(*words, {centre.x - size.width / 2.0, centre.y + kWordsBelow - font.lineHeight()},
                    Color::ofRole(ColorRole::StandardText));
    }
}

}  // namespace ktr::platform
