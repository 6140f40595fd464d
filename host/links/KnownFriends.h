#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/VASnippet.h"
#include "platform/contacts/Contact.h"

namespace ktr::host {

class Host;

/// Whom a conversation was about, and whom the contacts know, by the handles that links have. The host has a platform
/// installed. Main thread.
class KnownFriends {
  public:
    struct Known {
        std::shared_ptr<platform::VAKtrLocation> location;  ///< never null; of a friend without a place without one
        std::optional<platform::Url> context;               ///< of the answer that it comes from
    };

    explicit KnownFriends(const Host& host) : host_(host) {}

    /// The newest that a card knows of this friend; none for somebody who was not asked about.
    std::optional<Known> find(const std::string& handle) const;
    /// Everybody who was asked about, each once, the newest question first.
    std::vector<Known> all() const;
    /// A friend of whom only a contact tells; none for a handle that no contact has.
    static std::optional<Known> fromContacts(const std::string& handle);
    /// A friend of whom nothing is known but this; without a name the handle stands for one.
    static Known named(const std::string& name, const std::string& handle);
    /// Whether one of this friend's handles is that one, however it is written.
    static bool isCalled(const platform::VAKtrLocation& location, const std::string& handle);
    /// Null for a handle that no contact has.
    static std::shared_ptr<platform::Contact> contactOf(const std::string& handle);

    /// All addresses and numbers that an answer has of a person, the service's own first.
    static std::vector<std::string> handlesOf(const platform::VAKtrLocation& location);
    /// By which the service knows a friend, else the first address or number; empty for nobody.
    static std::string handleOf(const platform::VAKtrLocation& location);
    /// The contact behind what an answer says of a person; null where there is none.
    static std::shared_ptr<platform::Contact> contactOf(const platform::VAKtrLocation& location);
    /// The contact's name, else the one that the answer has, else the handle.
    static std::string nameOf(const platform::VAKtrLocation& location);
    /// The same, as one speaks of a friend: the given name alone where there is one.
    static std::string shortNameOf(const platform::VAKtrLocation& location);

  private:
    const Host& host_;
};

}  // namespace ktr::host
