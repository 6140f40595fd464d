#pragma once

#include <memory>
#include <vector>

#include "platform/contacts/Contact.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// Shows the avatar of the first of its contacts in a view of its own. Until it is given contacts, and for an empty
/// contact, that is the blank figure. Main thread.
class KTR_API ContactAvatarController : public Object {
  public:
    ContactAvatarController();
    ~ContactAvatarController() override;
    std::shared_ptr<View> view() const;
    const std::vector<std::shared_ptr<Contact>>& contacts() const { return contacts_; }
    void setContacts(std::vector<std::shared_ptr<Contact>> contacts);

  private:
    class AvatarView;
    std::vector<std::shared_ptr<Contact>> contacts_;
    std::shared_ptr<AvatarView> view_;
};

}  // namespace ktr::platform
