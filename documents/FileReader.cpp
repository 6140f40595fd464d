#include "documents/FileReader.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <optional>

#include "documents/FileSteps.h"

namespace ktr::documents {

namespace {

using Error = FileReader::Error;

class Descriptor {
  public:
    explicit Descriptor(int number) : number_(number) {}
    ~Descriptor() {
        if (number_ >= 0) {
            ::close(number_);
        }
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    int number() const { return number_; }

  private:
    int number_;
};

Error failed(int number) {
    if (number == ENOENT || number == ENOTDIR) {
        return {true, "there is no such file"};
    }
    return {false, std::string("the file cannot be read: ") + std::strerror(number)};
}

std::optional<Error> wrongType(mode_t mode) {
    if (S_ISREG(mode)) {
        return std::nullopt;
    }
    const char* what = S_ISDIR(mode)    ? "a folder"
                       : S_ISFIFO(mode) ? "a pipe"
                       : S_ISSOCK(mode) ? "a socket"
                                        : "a device";
    return Error{false, std::string("this is ") + what + ", not a file"};
}

std::string sizeInWords(std::size_t bytes) {
    if (bytes < (std::size_t{1} << 10)) {
        return std::to_string(bytes) + " bytes";
    }
    const bool whole = bytes >= (std::size_t{1} << 20) && bytes % (std::size_t{1} << 20) == 0;
    return whole ? std::to_string(bytes >> 20) + " MiB" : std::to_string(bytes >> 10) + " KiB";
}

std::variant<std::string, Error> readOpened(int descriptor, std::size_t expected, std::size_t most) {
    const Error tooLarge{false, "the file is larger than " + sizeInWords(most)};
    if (expected > most) {
        return tooLarge;
    }
    constexpr std::size_t kBlock = std::size_t{64} * 1024;
    std::string text;
    // One byte more than announced finds the end in one step; a file may have grown since.
    text.resize(expected + 1);
    std::size_t size = 0;
    for (;;) {
        if (size == text.size()) {
            text.resize(size + std::max(kBlock, size / 2));
        }
        const ssize_t count = ::read(descriptor, text.data() + size, text.size() - size);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count < 0) {
            return failed(errno);
        }
        if (count == 0) {
            text.resize(size);
            return text;
        }
        size += static_cast<std::size_t>(count);
        if (size > most) {
            return tooLarge;
        }
    }
}

}  // namespace

std::variant<std::string, Error> FileReader::read(const std::filesystem::path& file, const Terms& terms) {
    if (file.native().find('\0') != std::string::npos) {
        return Error{true, "there is no such file"};
    }
    struct stat facts {};
    // Opening alone makes some devices do something.
    if (::stat(file.c_str(), &facts) != 0) {
        return failed(errno);
    }
    if (auto wrong = wrongType(facts.st_mode)) {
        return *wrong;
    }
    // Not waiting: a pipe could take the file's place between the look at it and the opening.
    const Descriptor descriptor(FileSteps::open(file, O_RDONLY | O_NONBLOCK | O_NOCTTY));
    if (descriptor.number() < 0 || ::fstat(descriptor.number(), &facts) != 0) {
        return failed(errno);
    }
    if (auto wrong = wrongType(facts.st_mode)) {
        return *wrong;
    }
    if (terms.refusal) {
        if (std::string reason = terms.refusal(facts); !reason.empty()) {
            return Error{false, std::move(reason)};
        }
    }
    return readOpened(descriptor.number(), static_cast<std::size_t>(facts.st_size), terms.most);
}

}  // namespace ktr::documents
