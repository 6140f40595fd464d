#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/contacts/Contact.h"

namespace ktr::platform {

using ContactKeys = std::vector<std::string>;

/// What a fetch gave, and the reason when it failed.
template <class T>
struct ContactFetch {
    T result;
    std::optional<std::string> error;
};

/// The user's contacts. Answers from memory; never waits. Main thread.
class KTR_API ContactStore {
  public:
    using Contacts = std::vector<std::shared_ptr<Contact>>;

    virtual ~ContactStore();
    /// Contacts with this e-mail address, whatever the case of its letters; in the store's order.
    virtual ContactFetch<Contacts> unifiedContactsMatchingEmailAddress(const std::string& address,
                                                                       const ContactKeys& keys) = 0;
    /// Contacts with this phone number, however it is written: numbers are compared in full when both are complete,
    /// else by their national part; in the store's order.
    virtual ContactFetch<Contacts> unifiedContactsMatchingPhoneNumber(const std::string& number,
                                                                      const ContactKeys& keys) = 0;
    /// An identifier that is not in the store is an error.
    virtual ContactFetch<std::shared_ptr<Contact>> unifiedContactWithIdentifier(const std::string& identifier,
                                                                                const ContactKeys& keys) = 0;
};

enum class ContactFormatterStyle { FullName };

/// Names of contacts by the customs of their script. Main thread.
class KTR_API ContactFormatter {
  public:
    virtual ~ContactFormatter();
    /// None for a contact without any name.
    virtual std::optional<std::string> stringFromContact(const Contact& contact, ContactFormatterStyle style) const = 0;
    /// One key that stands for all that this style needs.
    virtual std::string descriptorForRequiredKeys(ContactFormatterStyle style) const = 0;
};

/// Between the assistant's contact identifiers and the contact store's. Main thread.
class KTR_API AssistantContacts {
  public:
    virtual ~AssistantContacts();
    /// None for an identifier that is not one of the assistant's.
    virtual std::optional<std::string> contactIdentifierForAssistantIdentifier(const std::string& identifier) const = 0;
    virtual std::optional<std::string> assistantIdentifierForContact(const Contact& contact) const = 0;
    /// What the conversion needs fetched.
    virtual ContactKeys requiredKeys() const = 0;
};

}  // namespace ktr::platform
