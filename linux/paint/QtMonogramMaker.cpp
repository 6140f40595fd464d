#include "linux/paint/QtMonogramMaker.h"

#include "linux/paint/AvatarImage.h"
#include "linux/paint/Palette.h"
#include "linux/paint/PersonColors.h"

namespace ktr::linux_ {

std::shared_ptr<platform::MonogramMaker> QtMonogramMaker::makerTintedWith(const std::optional<platform::Color>& color) {
    auto maker = std::make_shared<QtMonogramMaker>(*this);
    maker->tint_ = color;
    return maker;
}

std::shared_ptr<platform::Image> QtMonogramMaker::monogramForContact(const platform::Contact& contact) {
    if (contact.isEmpty()) {
        return AvatarImage::blank(diameter_);
    }
    if (auto photo = faces_->photoOf(contact, diameter_)) {
        return photo;
    }
    // A tint is a colour of its own; a role would change with the appearance, which a monogram does not.
    const QColor color = tint_ ? Palette::of(ColorScheme::Light).resolve(*tint_) : PersonColors::colorOf(contact);
    return AvatarImage::letters(diameter_, Initials(contact), color, font_ ? font_->size : 0.0);
}

}  // namespace ktr::linux_
