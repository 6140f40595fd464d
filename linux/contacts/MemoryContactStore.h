#pragma once

#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "linux/contacts/PhonenumberLibrary.h"
#include "platform/contacts/ContactStore.h"

namespace ktr::linux_ {

/// Contacts held in memory and indexed by handle: a query costs the same with five contacts or fifty thousand. All keys
/// are always fetched. Main thread.
class MemoryContactStore : public platform::ContactStore {
  public:
    /// Of contacts with the same handle so many, the first, are found; of numbers that end alike so many are compared.
    static constexpr std::size_t kMostAlike = 32;
    static constexpr std::size_t kMostCompared = 256;

    /// The order of the list is the store's. A contact without an identifier is given one made from its names and
    /// handles, the same at every start. Numbers that are not complete are read as those of the home country.
    MemoryContactStore(Contacts contacts, std::shared_ptr<PhonenumberLibrary> phoneNumbers,
                       std::string homeCountryCode);
    ~MemoryContactStore() override;

    platform::ContactFetch<Contacts> unifiedContactsMatchingEmailAddress(const std::string& address,
                                                                         const platform::ContactKeys& keys) override;
    platform::ContactFetch<Contacts> unifiedContactsMatchingPhoneNumber(const std::string& number,
                                                                        const platform::ContactKeys& keys) override;
    platform::ContactFetch<std::shared_ptr<platform::Contact>> unifiedContactWithIdentifier(
        const std::string& identifier, const platform::ContactKeys& keys) override;

    const Contacts& contacts() const { return contacts_; }

  private:
    struct StoredNumber {
        std::size_t contact = 0;
        std::size_t number = 0;
    };

    bool matches(const std::string& stored, const std::string& asked,
                 const std::optional<PhoneNumberParts>& askedParts) const;
    /// The contacts at these positions, which are in the store's order, each once.
    Contacts contactsAt(const std::vector<std::size_t>& positions) const;

    Contacts contacts_;
    std::shared_ptr<PhonenumberLibrary> phoneNumbers_;
    std::string homeCountryCode_;
    std::unordered_map<std::string, std::vector<std::size_t>> byEmail_;
    std::unordered_map<std::string, std::size_t> byIdentifier_;
    /// By the last digits: numbers that are the same end alike, however they are written. What shares them is compared
    /// by the phone-number library when it is asked for, so that a large store costs nothing to start with.
    std::unordered_map<std::string, std::vector<StoredNumber>> byLastDigits_;
};

}  // namespace ktr::linux_
