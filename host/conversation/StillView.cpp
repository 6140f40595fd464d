#include "host/conversation/StillView.h"

#include <QPainter>
#include <algorithm>
#include <cmath>

#include "host/conversation/Shapes.h"

namespace ktr::host {

using linux_::ColorScheme;
using linux_::Palette;
using platform::AccessibilityNode;
using platform::AccessibilityRole;
using platform::Rect;

namespace {

QImage pictureOf(const platform::View& view, double scale, const Palette& palette) {
    const Rect bounds = view.bounds();
    const double longest = std::max({bounds.width, bounds.height, 1.0});
    const double pixels = std::min(scale, StillView::kMostPixels / longest);
    QImage image(std::max(static_cast<int>(std::ceil(bounds.width * pixels)), 1),
                 std::max(static_cast<int>(std::ceil(bounds.height * pixels)), 1), QImage::Format_ARGB32_Premultiplied);
    image.setDevicePixelRatio(pixels);
    image.fill(Qt::transparent);
    QPainter painter(&image);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
    linux_::QtCanvas canvas(painter, palette);
    view.paint(canvas, bounds);
    return image;
}

}  // namespace

/// A part of the picture that a screen reader speaks.
class StillView::Part : public View {
  public:
    Part(AccessibilityRole role, const Rect& where) : place(where), role_(role) {}
    AccessibilityRole accessibilityRole() const override { return role_; }
    /// In the picture as it was taken.
    const Rect place;

  private:
    AccessibilityRole role_;
};

std::size_t StillView::indexOf(const Palette& palette) {
    return (palette.scheme == ColorScheme::Dark ? 1U : 0U) + (palette.contrast == linux_::Contrast::High ? 2U : 0U);
}

std::shared_ptr<StillView> StillView::of(const std::shared_ptr<View>& view, double scale, bool rightToLeft,
                                         const std::optional<platform::Url>& page, const Open& open) {
    auto still = platform::create<StillView>(&View::initWithFrame, view->bounds());
    still->size_ = {view->bounds().width, view->bounds().height};
    still->rightToLeft_ = rightToLeft;
    for (const ColorScheme scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        for (const auto contrast : {linux_::Contrast::Normal, linux_::Contrast::High}) {
            const Palette& palette = Palette::of(scheme, contrast);
            still->pictures_[indexOf(palette)] = pictureOf(*view, scale, palette);
        }
    }
    std::function<void()> tapped;
    if (page && open) {
        tapped = [open, page = *page] { open(page); };
    }
    for (const AccessibilityNode& node : platform::accessibilityTree(view, rightToLeft).children) {
        still->addPart(node, tapped);
    }
    return still;
}

void StillView::addPart(const AccessibilityNode& node, const std::function<void()>& tapped) {
    if (!node.pressable && node.text.empty()) {
        for (const AccessibilityNode& child : node.children) {
            addPart(child, tapped);
        }
        return;
    }
    const bool opens = node.pressable && tapped;
    // A link that leads nowhere any more is a text.
    const auto role = opens || node.role != AccessibilityRole::Link ? node.role : AccessibilityRole::Text;
    auto part = std::make_shared<Part>(role, node.frame);
    part->setAccessibilityLabel(node.text);
    if (opens) {
        part->addGestureRecognizer(std::make_shared<platform::TapGestureRecognizer>(tapped));
    }
    parts_.push_back(part);
    addSubview(part);
}

double StillView::heightForWidth(double width) const {
    return size_.width > width ? size_.height * width / size_.width : size_.height;
}

double StillView::shrink() const {
    return size_.width > 0.0 ? std::min(frame().width / size_.width, 1.0) : 1.0;
}

Rect StillView::place() const {
    return mirrored({0.0, 0.0, size_.width * shrink(), size_.height * shrink()}, frame().width, rightToLeft_);
}

void StillView::layoutSubviews() {
    const Rect picture = place();
    const double k = shrink();
    for (const auto& part : parts_) {
        part->setFrame(
            {picture.x + part->place.x * k, part->place.y * k, part->place.width * k, part->place.height * k});
    }
}

void StillView::draw(platform::Canvas& canvas) const {
    if (auto* qt = qtCanvas(canvas)) {
        const QImage& picture = pictures_[indexOf(qt->palette())];
        qt->painter().drawImage(qt->snapped(place()), picture);
    }
}

}  // namespace ktr::host
