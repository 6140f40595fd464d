#pragma once

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <variant>

#include "documents/DocumentError.h"

namespace ktr::linux_ {

/// One domain's preferences on the disk: a JSON object of texts, mode 0600, and a lock file beside it. Any thread; both
/// operations wait for the disk.
class PreferencesFile {
  public:
    using Texts = std::map<std::string, std::string>;
    /// None removes.
    using Changes = std::map<std::string, std::optional<std::string>>;
    struct Error {
        std::string text;
    };

    /// A file that does not exist holds nothing.
    static std::variant<Texts, Error> read(const std::filesystem::path& file);
    /// The preferences in a text; `file` names it in an error.
    static std::variant<Texts, documents::DocumentError> readText(const std::string& text,
                                                                  const std::filesystem::path& file);
    /// Applies the changes to what the file holds at this moment and replaces it, alone among all processes; gives what
    /// it holds now. Unchanged contents are not written. A file that holds no preferences is put aside under the name
    /// "FILE.broken" first, one that cannot be read stays untouched.
    static std::variant<Texts, Error> merge(const std::filesystem::path& file, const Changes& changes);
};

}  // namespace ktr::linux_
