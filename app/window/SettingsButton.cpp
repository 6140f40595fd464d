#include "app/window/SettingsButton.h"

#include <algorithm>
#include <cmath>

#include "app/window/ConversationWidget.h"
#include "host/conversation/WideColumns.h"

namespace ktr::app {

namespace {

constexpr int kTop = 8;
constexpr double kAroundIcon = 4.0;

}  // namespace

SettingsButton::SettingsButton(ConversationWidget& conversation, QWidget* parent)
    : IconButton(Icon::Settings, Tone::Soft, parent), conversation_(conversation) {
    conversation_.setMoved([this] { look(); });
}

double SettingsButton::clearSide() {
    return inkSideOf(Icon::Settings) + 2.0 * kAroundIcon;
}

void SettingsButton::place() {
    const int whole = conversation_.width();
    const double toIconsEnd = (side() + clearSide()) / 2.0;
    double end = host::measures::kGutter;
    if (whole >= host::measures::kWideFrom) {
        // The margin beside the card may be narrower than the target, and its icon stays clear of the card.
        const auto columns = host::WideColumns::of(whole);
        const double margin = whole - columns.cardStart - columns.cardWidth;
        end = std::min({end, std::max(margin - side(), 0.0), margin - toIconsEnd});
    }
    const QRect shape(whole - static_cast<int>(std::floor(end)) - side(), kTop, side(), side());
    const bool isMirrored = conversation_.layoutDirection() == Qt::RightToLeft;
    placeShape(isMirrored ? QRect(whole - shape.right() - 1, shape.y(), side(), side()) : shape);
    conversation_.setCorner({end + toIconsEnd, kTop + toIconsEnd});
    look();
}

void SettingsButton::look() {
    QRectF icon(0.0, 0.0, clearSide(), clearSide());
    icon.moveCenter(QRectF(geometry()).center());
    setVisible(!conversation_.isHidden() && !conversation_.showsSomethingIn(icon));
}

}  // namespace ktr::app
