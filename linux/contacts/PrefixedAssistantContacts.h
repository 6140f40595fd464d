#pragma once

#include <optional>
#include <string>

#include "platform/contacts/ContactStore.h"

namespace ktr::linux_ {

/// The assistant's contact identifiers are the store's behind "x-assistant-contact:". Main thread.
class PrefixedAssistantContacts : public platform::AssistantContacts {
  public:
    static constexpr const char* kPrefix = "x-assistant-contact:";

    std::optional<std::string> contactIdentifierForAssistantIdentifier(const std::string& identifier) const override;
    /// None for a contact that is in no store.
    std::optional<std::string> assistantIdentifierForContact(const platform::Contact& contact) const override;
    platform::ContactKeys requiredKeys() const override;
};

}  // namespace ktr::linux_
