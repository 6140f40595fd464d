#pragma once

#include <memory>
#include <optional>

#include "platform/contacts/Contact.h"
#include "platform/ui/Color.h"
#include "platform/ui/Font.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// Draws a contact's initials in a circle. Main thread.
class KTR_API MonogramMaker {
  public:
    virtual ~MonogramMaker();
    virtual void setFont(const Font& font) = 0;
    /// A maker like this one whose monograms have this colour (none: the contact's own); this one stays as it is. Never
    /// none.
    virtual std::shared_ptr<MonogramMaker> makerTintedWith(const std::optional<Color>& color) = 0;
    /// Never none; of an empty contact the blank figure.
    virtual std::shared_ptr<Image> monogramForContact(const Contact& contact) = 0;
};

class KTR_API MonogramMakerFactory {
  public:
    virtual ~MonogramMakerFactory();
    /// The style is 1, the filled circle; the diameter in points. Without `setFont` the letters follow the diameter.
    virtual std::shared_ptr<MonogramMaker> makeMonogramMaker(int style, double diameter) = 0;
};

/// Pictures of contacts as avatars. Main thread.
class KTR_API AvatarImages {
  public:
    virtual ~AvatarImages();
    /// The contact's photo cut to a circle; without one its initials in a colour that is the contact's own on every
    /// device; of an empty contact, or none, the blank figure. Diameter in points. The same contact gives the same
    /// image object.
    virtual std::shared_ptr<Image> avatarForContact(const std::shared_ptr<Contact>& contact, double diameter) = 0;
};

}  // namespace ktr::platform
