#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/contacts/ContactStore.h"
#include "platform/ui/Color.h"
#include "platform/ui/Image.h"

namespace ktr {

/// Finds the user's contacts by handle or assistant identifier, their pictures and numbers, and draws monograms.
/// Stateless; a lookup that finds nothing, or fails, gives none. Main thread.
class ContactsUtilities {
  public:
    /// The user's contacts; none when the platform has no store.
    static std::shared_ptr<platform::ContactStore> contactStore();
    /// What every fetch asks for: the name formatter's descriptor and thirty keys, then what the assistant's contact
    /// conversion needs.
    static platform::ContactKeys contactKeys();

    /// The best match of an e-mail address or a phone number; none for an empty one. Fetch errors stay silent.
    static std::shared_ptr<platform::Contact> contactForEmail(const std::optional<std::string>& email);
    static std::shared_ptr<platform::Contact> contactForPhone(const std::optional<std::string>& phone);
    /// A failed fetch is logged at error level.
    static std::shared_ptr<platform::Contact> contactForAssistantId(const std::optional<std::string>& identifier);
    /// The first contact that has image data, else the first; none for an empty list.
    static std::shared_ptr<platform::Contact> findOptimalContactInContacts(
        const std::vector<std::shared_ptr<platform::Contact>>& contacts);

    /// In the contact's order; empty for none.
    static std::vector<std::string> phoneNumbersForContact(const std::shared_ptr<platform::Contact>& contact);
    /// Made from the thumbnail data alone; none without it.
    static std::shared_ptr<platform::Image> imageForContact(const std::shared_ptr<platform::Contact>& contact);

    /// The contact's initials in a circle of the size's diameter. The override colour does not show: the tinted
    /// monograms that the maker offers for it are asked for and not used. None stands for the empty contact. Never
    /// none.
    static std::shared_ptr<platform::Image> monogramForContact(const std::shared_ptr<platform::Contact>& contact,
                                                               unsigned size,
                                                               const std::optional<platform::Color>& colorOverride);
    /// Points: 42, 58, 72, 89, 89 for the sizes 0 to 4; 0 for every other one.
    static double diameterForSize(unsigned size);
};

}  // namespace ktr
