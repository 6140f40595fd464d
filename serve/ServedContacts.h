#pragma once

#include <string>
#include <vector>

#include "serve/ServedFriend.h"

namespace ktr::serve {

/// The people of the development service as contacts, so that a conversation with it shows faces and names. Any thread.
class ServedContacts {
  public:
    /// vCard 3.0 (RFC 2426), a card a person.
    static std::string vCards(const std::vector<ServedFriend>& friends);
};

}  // namespace ktr::serve
