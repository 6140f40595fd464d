#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <variant>

namespace ktr::linux_ {

/// The app token in a file that nobody but its owner can read. Any thread; it reads the disk.
class TokenFile {
  public:
    struct Error {
        bool missing = false;  ///< there is no such file
        std::string text;      ///< one line that names the file; never anything of its contents
    };

    /// The file's text without the line end at its end. Refused: a file of another owner, one that group or others may
    /// read, write or execute, what is no regular file, more than 16 KiB, and an empty token or one with control
    /// characters.
    static std::variant<std::string, Error> read(const std::filesystem::path& file);

    /// The token in a text: without the line end at its end. None for what is refused in a file's text, too.
    static std::optional<std::string> tokenIn(std::string text);
};

}  // namespace ktr::linux_
