#pragma once

#include <filesystem>
#include <string>
#include <variant>

#include "documents/DocumentError.h"
#include "linux/configuration/Configuration.h"

namespace ktr::linux_ {

/// Reads the configuration file. Any thread; it reads the disk.
class ConfigurationReader {
  public:
    /// One line that names the file, the place in it and what was expected there:
    /// `/home/ann/.config/ktr/config.json:3:17: $.account.personId: expected a string, found a number`.
    struct Error {
        std::string text;
        /// The same of a text that stands in no file: without file, line and column, the member by its name.
        /// `account.personId: expected a string, found a number`.
        std::string ofMember;
    };

    /// A file that does not exist reads as an empty one: no account is signed in and everything has its default. One
    /// that others may change is an error: it says where the app token goes. Unknown members go to `warnings`, if there
    /// are any to go to.
    static std::variant<Configuration, Error> readFile(const std::filesystem::path& file,
                                                       documents::DocumentWarnings* warnings = nullptr);
    /// `file` names the text in messages; relative paths inside it start from its folder.
    static std::variant<Configuration, Error> readText(const std::string& text, const std::filesystem::path& file,
                                                       documents::DocumentWarnings* warnings = nullptr);
};

}  // namespace ktr::linux_
