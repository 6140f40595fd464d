#include "platform/contacts/ContactAvatarController.h"

#include <algorithm>

#include "platform/base/Platform.h"
#include "platform/contacts/MonogramMaker.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

class ContactAvatarController::AvatarView : public View {
  public:
    AvatarView() { setUserInteractionEnabled(false); }

    void setContact(std::shared_ptr<Contact> contact) {
        // Whoever is in no address book is given another empty contact at each filling: it looks like the last one.
        const bool isUnknownAgain = contact && contact_ && contact->isEmpty() && contact_->isEmpty();
        if (contact != contact_ && !isUnknownAgain) {
            contact_ = std::move(contact);
            setNeedsDisplay();
        }
    }

  protected:
    void draw(Canvas& canvas) const override {
        const auto platform = Platform::installed();
        const double diameter = std::min(bounds().width, bounds().height);
        if (!platform || !platform->avatarImages || diameter <= 0.0) {
            return;
        }
        if (const auto image = platform->avatarImages->avatarForContact(contact_, diameter)) {
            canvas.draw(*image,
                        {(bounds().width - diameter) / 2.0, (bounds().height - diameter) / 2.0, diameter, diameter});
        }
    }

  private:
    std::shared_ptr<Contact> contact_;
};

ContactAvatarController::ContactAvatarController() : view_(std::make_shared<AvatarView>()) {}
ContactAvatarController::~ContactAvatarController() = default;

std::shared_ptr<View> ContactAvatarController::view() const {
    return view_;
}

void ContactAvatarController::setContacts(std::vector<std::shared_ptr<Contact>> contacts) {
    contacts_ = std::move(contacts);
    view_->setContact(contacts_.empty() ? nullptr : contacts_.front());
}

}  // namespace ktr::platform
