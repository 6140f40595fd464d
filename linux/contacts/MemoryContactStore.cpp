#include "linux/contacts/MemoryContactStore.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <string_view>
#include <utility>

#include "linux/contacts/PhoneText.h"
#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

/// Numbers that are the same share at least this many digits at their end.
constexpr std::size_t kSharedDigits = 6;

/// By what a number is looked up; empty for one without digits.
std::string lastDigits(std::string_view number) {
    const std::string digits = PhoneText::digits(PhoneText::withoutExtension(PhoneText::withoutScheme(number)));
    return digits.size() <= kSharedDigits ? digits : digits.substr(digits.size() - kSharedDigits);
}

/// The same card gives the same identifier at every start.
std::string madeIdentifier(const platform::Contact& contact) {
    // 64-bit FNV-1a.
    std::uint64_t hash = 0xcbf29ce484222325;
    const auto add = [&hash](const std::string& text) {
        for (const char c : text + '\n') {
            hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3;
        }
    };
    add(contact.storedFullName);
    add(contact.givenName);
    add(contact.familyName);
    add(contact.organizationName);
    for (const auto& email : contact.emailAddresses) {
        add(email.value);
    }
    for (const auto& phone : contact.phoneNumbers) {
        add(phone.value);
    }
    std::array<char, 24> text{};
    std::snprintf(text.data(), text.size(), "card-%016llx", static_cast<unsigned long long>(hash));
    return text.data();
}

}  // namespace

MemoryContactStore::MemoryContactStore(Contacts contacts, std::shared_ptr<PhonenumberLibrary> phoneNumbers,
                                       std::string homeCountryCode)
    : contacts_(std::move(contacts)),
      phoneNumbers_(std::move(phoneNumbers)),
      homeCountryCode_(std::move(homeCountryCode)) {
    std::unordered_map<std::string, int> claims;
    for (std::size_t position = 0; position < contacts_.size(); ++position) {
        platform::Contact& contact = *contacts_[position];
        if (contact.identifier.empty()) {
            contact.identifier = madeIdentifier(contact);
        }
        // Two cards may claim one identifier: the later ones are counted, so that each can be found.
        const std::string claimed = contact.identifier;
        while (!byIdentifier_.emplace(contact.identifier, position).second) {
            // From where the one before stopped: thousands of cards may claim the same.
            int& count = claims.emplace(claimed, 1).first->second;
            contact.identifier = claimed + "#" + std::to_string(++count);
        }
        for (const auto& email : contact.emailAddresses) {
            if (auto& alike = byEmail_[platform::asciiLowercased(email.value)];
                alike.size() < kMostAlike && (alike.empty() || alike.back() != position)) {
                alike.push_back(position);
            }
        }
        for (std::size_t number = 0; number < contact.phoneNumbers.size(); ++number) {
            const std::string digits = lastDigits(contact.phoneNumbers[number].value);
            if (digits.empty()) {
                continue;
            }
            if (auto& alike = byLastDigits_[digits]; alike.size() < kMostCompared) {
                alike.push_back({position, number});
            }
        }
    }
}

MemoryContactStore::~MemoryContactStore() = default;

platform::ContactStore::Contacts MemoryContactStore::contactsAt(const std::vector<std::size_t>& positions) const {
    Contacts out;
    out.reserve(positions.size());
    for (const std::size_t position : positions) {
        out.push_back(contacts_[position]);
    }
    return out;
}

platform::ContactFetch<platform::ContactStore::Contacts> MemoryContactStore::unifiedContactsMatchingEmailAddress(
    const std::string& address, const platform::ContactKeys&) {
    const auto found = byEmail_.find(platform::asciiLowercased(address));
    return {found == byEmail_.end() ? Contacts() : contactsAt(found->second), std::nullopt};
}

bool MemoryContactStore::matches(const std::string& stored, const std::string& asked,
                                 const std::optional<PhoneNumberParts>& askedParts) const {
    const auto storedParts = phoneNumbers_->parts(stored, homeCountryCode_);
    if (!storedParts || !askedParts) {
        return PhoneText::digits(PhoneText::withoutScheme(stored)) ==
               PhoneText::digits(PhoneText::withoutScheme(asked));
    }
    return storedParts->complete && askedParts->complete ? storedParts->e164 == askedParts->e164
                                                         : storedParts->nationalPart == askedParts->nationalPart;
}

platform::ContactFetch<platform::ContactStore::Contacts> MemoryContactStore::unifiedContactsMatchingPhoneNumber(
    const std::string& number, const platform::ContactKeys&) {
    const auto candidates = byLastDigits_.find(lastDigits(number));
    if (candidates == byLastDigits_.end()) {
        return {{}, std::nullopt};
    }
    const auto parts = phoneNumbers_->parts(number, homeCountryCode_);
    std::vector<std::size_t> positions;
    for (const StoredNumber& candidate : candidates->second) {
        const bool isKnown = !positions.empty() && positions.back() == candidate.contact;
        if (positions.size() < kMostAlike && !isKnown &&
            matches(contacts_[candidate.contact]->phoneNumbers[candidate.number].value, number, parts)) {
            positions.push_back(candidate.contact);
        }
    }
    return {contactsAt(positions), std::nullopt};
}

platform::ContactFetch<std::shared_ptr<platform::Contact>> MemoryContactStore::unifiedContactWithIdentifier(
    const std::string& identifier, const platform::ContactKeys&) {
    const auto found = byIdentifier_.find(identifier);
    if (found == byIdentifier_.end()) {
        return {nullptr, "no contact has this identifier"};
    }
    return {contacts_[found->second], std::nullopt};
}

}  // namespace ktr::linux_
