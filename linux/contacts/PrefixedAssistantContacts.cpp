#include "linux/contacts/PrefixedAssistantContacts.h"

#include <string_view>

namespace ktr::linux_ {

std::optional<std::string> PrefixedAssistantContacts::contactIdentifierForAssistantIdentifier(
    const std::string& identifier) const {
    const std::string_view prefix = kPrefix;
    if (identifier.size() <= prefix.size() || identifier.compare(0, prefix.size(), prefix) != 0) {
        return std::nullopt;
    }
    return identifier.substr(prefix.size());
}

std::optional<std::string> PrefixedAssistantContacts::assistantIdentifierForContact(
    const platform::Contact& contact) const {
    return contact.identifier.empty() ? std::nullopt : std::optional(kPrefix + contact.identifier);
}

platform::ContactKeys PrefixedAssistantContacts::requiredKeys() const {
    return {"identifier"};
}

}  // namespace ktr::linux_
