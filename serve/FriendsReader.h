#pragma once

#include <string>
#include <string_view>
#include <variant>

#include "documents/DocumentError.h"
#include "serve/ServedFriend.h"

namespace ktr::serve {

/// Reads whom the development service knows (docs/service-protocol.md describes the file). A scenario serves too: its
/// snippet's locations become friends who stay where they are. Unknown members go to `warnings`, if there are any to go
/// to. Any thread; `readFile` reads the disk.
class FriendsReader {
  public:
    static std::variant<FriendsFile, documents::DocumentError> readFile(
        const std::string& file, documents::DocumentWarnings* warnings = nullptr);
    static std::variant<FriendsFile, documents::DocumentError> readText(
        std::string_view text, const std::string& file, documents::DocumentWarnings* warnings = nullptr);
};

}  // namespace ktr::serve
