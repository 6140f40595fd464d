#include "model/ContactsUtilities.h"

#include <algorithm>
#include <array>

#include "model/LogCategory.h"
#include "platform/base/Assert.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/Platform.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr {

using platform::Contact;
using platform::ContactKeys;
using platform::ContactStore;
using platform::Platform;

namespace {

/// Points. The sizes 3 and 4 share the diameter but not the letters' size: both are meant.
struct MonogramSize {
    double diameter;
    double fontSize;
};
constexpr std::array<MonogramSize, 5> kMonogramSizes = {{{42, 19}, {58, 27}, {72, 41}, {89, 50}, {89, 38}}};
constexpr int kFilledCircle = 1;

/// They are asked for with each contact, and are the same for as long as a platform is installed.
struct SharedContactKeys {
    static std::shared_ptr<SharedContactKeys> makeShared() {
        return std::make_shared<SharedContactKeys>(SharedContactKeys{ContactsUtilities::contactKeys()});
    }
    ContactKeys keys;
};

const ContactKeys& sharedKeys() {
    return platform::shared<SharedContactKeys>()->keys;
}

}  // namespace

std::shared_ptr<ContactStore> ContactsUtilities::contactStore() {
    const Platform* const installed = platform::currentPlatform();
    return installed != nullptr ? installed->contactStore : nullptr;
}

ContactKeys ContactsUtilities::contactKeys() {
    const auto installed = Platform::installed();
    ContactKeys keys = {
        installed->contactFormatter->descriptorForRequiredKeys(platform::ContactFormatterStyle::FullName)};
    static constexpr std::array kFixedKeys = {"namePrefix",
                                              "givenName",
                                              "middleName",
                                              "familyName",
                                              "previousFamilyName",
                                              "nameSuffix",
                                              "nickname",
                                              "phoneticGivenName",
                                              "phoneticMiddleName",
                                              "organizationName",
                                              "departmentName",
                                              "jobTitle",
                                              "birthday",
                                              "nonGregorianBirthday",
                                              "note",
                                              "cropRect",
                                              "imageData",
                                              "thumbnailImageData",
                                              "preferredLikenessSource",
                                              "preferredPersonaIdentifier",
                                              "imageDataAvailable",
                                              "contactType",
                                              "phoneNumbers",
                                              "emailAddresses",
                                              "postalAddresses",
                                              "dates",
                                              "urlAddresses",
                                              "contactRelations",
                                              "socialProfiles",
                                              "instantMessageAddresses"};
    keys.insert(keys.end(), kFixedKeys.begin(), kFixedKeys.end());
    const ContactKeys conversion = installed->assistantContacts->requiredKeys();
    keys.insert(keys.end(), conversion.begin(), conversion.end());
    return keys;
}

std::shared_ptr<Contact> ContactsUtilities::contactForEmail(const std::optional<std::string>& email) {
    KTR_ASSERT_MAIN_THREAD();
    const auto store = contactStore();
    if (!store || !email || email->empty()) {
        return nullptr;
    }
    return findOptimalContactInContacts(store->unifiedContactsMatchingEmailAddress(*email, sharedKeys()).result);
}

std::shared_ptr<Contact> ContactsUtilities::contactForPhone(const std::optional<std::string>& phone) {
    KTR_ASSERT_MAIN_THREAD();
    const auto store = contactStore();
    if (!store || !phone || phone->empty()) {
        return nullptr;
    }
    return findOptimalContactInContacts(store->unifiedContactsMatchingPhoneNumber(*phone, sharedKeys()).result);
}

std::shared_ptr<Contact> ContactsUtilities::contactForAssistantId(const std::optional<std::string>& identifier) {
    KTR_ASSERT_MAIN_THREAD();
    const auto store = contactStore();
    if (!store || !identifier) {
        return nullptr;
    }
    const auto installed = Platform::installed();
    const auto contactIdentifier = installed->assistantContacts->contactIdentifierForAssistantIdentifier(*identifier);
    if (!contactIdentifier) {
        return nullptr;
    }
    const auto fetch = store->unifiedContactWithIdentifier(*contactIdentifier, sharedKeys());
    if (fetch.error) {
        LogCategory_Unspecified()->write(platform::LogLevel::Error, "Could not find contact for assistant ID %@ : %@",
                                         *identifier, fetch.error);
    }
    return fetch.result;
}

std::shared_ptr<Contact> ContactsUtilities::findOptimalContactInContacts(
    const std::vector<std::shared_ptr<Contact>>& contacts) {
    const auto pictured = std::find_if(contacts.begin(), contacts.end(),
                                       [](const auto& contact) { return contact && contact->imageData.has_value(); });
    if (pictured != contacts.end()) {
        return *pictured;
    }
    return contacts.empty() ? nullptr : contacts.front();
}

std::vector<std::string> ContactsUtilities::phoneNumbersForContact(const std::shared_ptr<Contact>& contact) {
    std::vector<std::string> numbers;
    if (contact) {
        for (const platform::LabeledText& number : contact->phoneNumbers) {
            numbers.push_back(number.value);
        }
    }
    return numbers;
}

std::shared_ptr<platform::Image> ContactsUtilities::imageForContact(const std::shared_ptr<Contact>& contact) {
    KTR_ASSERT_MAIN_THREAD();
    if (!contact || !contact->thumbnailImageData) {
        return nullptr;
    }
    return Platform::installed()->images->imageFromData(*contact->thumbnailImageData);
}

std::shared_ptr<platform::Image> ContactsUtilities::monogramForContact(
    const std::shared_ptr<Contact>& contact, unsigned size, const std::optional<platform::Color>& colorOverride) {
    KTR_ASSERT_MAIN_THREAD();
    const auto maker = Platform::installed()->monogramMakers->makeMonogramMaker(kFilledCircle, diameterForSize(size));
    if (size < kMonogramSizes.size()) {
        maker->setFont({platform::FontFace::Rounded, platform::FontWeight::Semibold, kMonogramSizes[size].fontSize});
    }
    // The tinted maker is asked for and dropped: the colour never shows, and is meant not to.
    static_cast<void>(maker->makerTintedWith(colorOverride));
    return maker->monogramForContact(contact ? *contact : *std::make_shared<Contact>());
}

double ContactsUtilities::diameterForSize(unsigned size) {
    return size < kMonogramSizes.size() ? kMonogramSizes[size].diameter : 0.0;
}

}  // namespace ktr
