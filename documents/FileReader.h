#pragma once

#include <sys/stat.h>

#include <cstddef>
#include <filesystem>
#include <functional>
#include <string>
#include <variant>

namespace ktr::documents {

/// The one way to read a file whole: only a regular one, never more than was agreed, and with every failure reported.
/// It does not wait for a pipe's writer, does not open devices, and reads on after signals and short reads. Any thread;
/// it waits for the disk.
class FileReader {
  public:
    /// What a file must be like.
    struct Terms {
        std::size_t most = std::size_t{64} << 20;  ///< bytes; a larger file is an error
        /// Why the opened file is refused, from its facts; empty when it is not. Null: any owner is accepted.
        std::function<std::string(const struct stat&)> refusal;
    };
    struct Error {
        bool isMissing = false;  ///< there is nothing of this name
        std::string reason;      ///< a sentence without the file's name: "there is no such file"
    };

    static std::variant<std::string, Error> read(const std::filesystem::path& file, const Terms& terms);
    static std::variant<std::string, Error> read(const std::filesystem::path& file) { return read(file, Terms()); }
};

}  // namespace ktr::documents
