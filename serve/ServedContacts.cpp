#include "serve/ServedContacts.h"

#include "documents/VCard.h"

namespace ktr::serve {

std::string ServedContacts::vCards(const std::vector<ServedFriend>& friends) {
    std::string cards;
    for (const ServedFriend& person : friends) {
        if (person.fullName.empty() && person.firstName.empty() && person.lastName.empty()) {
            continue;
        }
        const std::string whole = person.fullName.empty() ? person.firstName + " " + person.lastName : person.fullName;
        cards += documents::VCard{whole, person.lastName, person.firstName, person.emails, person.phones}.text();
    }
    return cards;
}

}  // namespace ktr::serve
