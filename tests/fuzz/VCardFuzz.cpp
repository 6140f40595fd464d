#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "linux/contacts/VCardModule.h"
#include "linux/contacts/VCardText.h"
#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"

// Any bytes as a file of vCards: cards are found within the text and read or refused, and what was read is text.

extern "C" bool ktrReadVCard(const std::string& card, ktr::platform::Contact& contact);

namespace {

using ktr::fuzz::require;
using ktr::linux_::VCardText;
using ktr::platform::Contact;

void check(const Contact& contact) {
    for (const auto* text :
         {&contact.identifier, &contact.namePrefix, &contact.givenName, &contact.middleName, &contact.familyName,
          &contact.previousFamilyName, &contact.nameSuffix, &contact.nickname, &contact.phoneticGivenName,
          &contact.phoneticMiddleName, &contact.phoneticFamilyName, &contact.organizationName, &contact.departmentName,
          &contact.jobTitle, &contact.storedFullName}) {
        require(ktr::platform::isValidUtf8(*text), "names are text");
    }
    for (const auto* values : {&contact.emailAddresses, &contact.phoneNumbers}) {
        require(values->size() <= VCardText::kMostProperties, "handles are capped");
        for (const auto& value : *values) {
            require(ktr::platform::isValidUtf8(value.label) && ktr::platform::isValidUtf8(value.value),
                    "handles are text");
            require(!value.value.empty(), "a handle says something");
        }
    }
    require(contact.imageDataAvailable == contact.imageData.has_value(), "a picture is there or not");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const VCardText found = VCardText::of(text);
    require(found.problems.size() <= VCardText::kMostProblems, "problems are capped");
    std::size_t line = 0;
    for (const VCardText::Card& card : found.cards) {
        require(card.text.data() >= text.data() && card.text.data() + card.text.size() <= text.data() + text.size(),
                "a card is part of the text");
        require(card.line > line, "cards follow each other");
        line = card.line;
        const std::string essential = VCardText::essential(card.text);
        require(essential.size() <= card.text.size(), "nothing is added");
        require(VCardText::essential(essential) == essential, "what is worth reading stays so");
        Contact contact;
        if (ktrReadVCard(ktr::platform::sanitizedUtf8(essential), contact)) {
            check(contact);
        }
    }
    return 0;
}
