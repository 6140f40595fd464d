#include "platform/contacts/Contact.h"
#include "platform/contacts/ContactStore.h"
#include "platform/contacts/MonogramMaker.h"
#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::platform {

Contact::~Contact() = default;
ContactStore::~ContactStore() = default;
ContactFormatter::~ContactFormatter() = default;
AssistantContacts::~AssistantContacts() = default;
MonogramMaker::~MonogramMaker() = default;
MonogramMakerFactory::~MonogramMakerFactory() = default;
AvatarImages::~AvatarImages() = default;
ParsedPhoneNumber::~ParsedPhoneNumber() = default;
PhoneNumberLibrary::~PhoneNumberLibrary() = default;
Telephony::~Telephony() = default;

std::string Contact::description() const {
    return "<Contact " + identifier + ">";
}

bool Contact::isEmpty() const {
    return identifier.empty() && givenName.empty() && familyName.empty() && middleName.empty() && nickname.empty() &&
           organizationName.empty() && storedFullName.empty() && phoneNumbers.empty() && emailAddresses.empty() &&
           !imageData && !thumbnailImageData;
}

}  // namespace ktr::platform
