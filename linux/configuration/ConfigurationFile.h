#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "documents/DocumentError.h"
#include "platform/base/Value.h"

namespace ktr::linux_ {

/// Changes single members of the configuration file; the others stay as they are, in their order. What the result would
/// say is read as the program reads it before a byte is written, and the file is replaced as a whole, under a lock. Any
/// thread; it reads and writes the disk.
class ConfigurationFile {
  public:
    /// A member and what it becomes; none: it goes.
    struct Change {
        std::string name;  ///< with dots: "account.host"
        std::optional<platform::Value> value;
    };

    explicit ConfigurationFile(const std::filesystem::path& file);

    /// What can be set, in the order in which it is described.
    static const std::vector<std::string>& names();

    /// The value that stands in the file; null where none does. The error is one line.
    std::variant<platform::Value, std::string> get(const std::string& name) const;
    /// All that stands in the file.
    std::variant<std::vector<std::pair<std::string, platform::Value>>, std::string> list() const;
    /// Empty when done, else one line that says what is wrong; the file is as it was then.
    std::string change(const std::vector<Change>& changes) const;
    /// The same for a value as it is typed: JSON, or else a text as it stands. Where a list is wanted, one text is a
    /// list of one.
    std::string set(const std::string& name, const std::string& typed) const;

  private:
    std::variant<platform::Dictionary, std::string> read() const;

    const std::filesystem::path file_;
};

}  // namespace ktr::linux_
