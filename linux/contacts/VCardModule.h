#pragma once

#include <optional>
#include <string>

#include "platform/contacts/Contact.h"

namespace ktr::linux_ {

/// The only symbol of libktr-contacts.so, of type `VCardModuleEntry`: reads one vCard (RFC 2426 or RFC 6350) into a
/// contact with Evolution Data Server's parser. False when the text is no card that the parser understands. The
/// contact's identifier is the card's UID; empty when it has none. Nothing thrown leaves it. Any thread.
inline constexpr const char* kVCardModuleEntry = "ktrReadVCard";
using VCardModuleEntry = bool (*)(const std::string& card, platform::Contact& contact);

}  // namespace ktr::linux_
