#include "linux/device/SystemDeviceInformation.h"

#include <sys/utsname.h>
#include <systemd/sd-id128.h>

#include <algorithm>
#include <array>
#include <iterator>
#include <map>
#include <sstream>
#include <utility>
#include <variant>

#include "documents/FileReader.h"

namespace ktr::linux_ {

namespace {

namespace fs = std::filesystem;

/// This program's own number: identifiers derived with it are no other program's.
constexpr sd_id128_t kApplication = SD_ID128_MAKE(8e, 5f, 2a, 61, b0, 3d, 4c, 17, 9a, c4, 70, d2, 1f, 66, e8, 3b);

/// A small file; none where there is none, or none that can be read.
std::optional<std::string> textOf(const fs::path& file) {
    constexpr std::size_t kMost = std::size_t{64} * 1024;
    auto read = documents::FileReader::read(file, {kMost, {}});
    auto* text = std::get_if<std::string>(&read);
    return text != nullptr ? std::optional(std::move(*text)) : std::nullopt;
}

/// The first line of a small file, without what is no text around it; empty when there is none.
std::string lineOf(const fs::path& file) {
    std::string line = textOf(file).value_or("");
    line.erase(std::find(line.begin(), line.end(), '\n'), line.end());
    // The device tree ends its texts with a zero byte.
    line.erase(std::find(line.begin(), line.end(), '\0'), line.end());
    const std::size_t begin = line.find_first_not_of(" \t\r");
    const std::size_t end = line.find_last_not_of(" \t\r");
    return begin == std::string::npos ? "" : line.substr(begin, end - begin + 1);
}

bool isFiller(const std::string& product) {
    constexpr std::array kFillers = {"To be filled by O.E.M.",
                                     "To Be Filled By O.E.M.",
                                     "System Product Name",
                                     "Default string",
                                     "Not Specified",
                                     "None",
                                     "Undefined",
                                     "Not Applicable",
                                     "Unknown"};
    return product.empty() || std::find(kFillers.begin(), kFillers.end(), product) != kFillers.end();
}

/// A value as a shell would read it: in double or single quotes or bare, with backslash escapes.
std::string unquoted(const std::string& value) {
    std::string text;
    char quote = '\0';
    for (std::size_t i = 0; i < value.size(); ++i) {
        const char c = value[i];
        if (c == '\\' && quote != '\'' && i + 1 < value.size()) {
            text += value[++i];
        } else if (quote == '\0' && (c == '"' || c == '\'')) {
            quote = c;
        } else if (c == quote && quote != '\0') {
            quote = '\0';
        } else {
            text += c;
        }
    }
    return text;
}

/// The file format is described in os-release(5).
std::map<std::string, std::string> osRelease(const fs::path& root) {
    auto text = textOf(root / "etc/os-release");
    if (!text) {
        text = textOf(root / "usr/lib/os-release");
    }
    std::istringstream stream(text.value_or(""));
    std::map<std::string, std::string> values;
    for (std::string line; std::getline(stream, line);) {
        const std::size_t equals = line.find('=');
        if (equals != std::string::npos && line.front() != '#') {
            values[line.substr(0, equals)] = unquoted(line.substr(equals + 1));
        }
    }
    return values;
}

std::optional<std::string> present(std::string text) {
    return text.empty() ? std::nullopt : std::optional(std::move(text));
}

}  // namespace

SystemDeviceInformation::SystemDeviceInformation(const fs::path& root) {
    sd_id128_t identifier{};
    if (sd_id128_get_machine_app_specific(kApplication, &identifier) >= 0) {
        std::array<char, SD_ID128_STRING_MAX> text{};
        identifier_ = sd_id128_to_string(identifier, text.data());
    }
    std::string product = lineOf(root / "sys/class/dmi/id/product_name");
    if (isFiller(product)) {
        product = lineOf(root / "proc/device-tree/model");
    }
    product_ = isFiller(product) ? std::nullopt : std::optional(product);
    auto release = osRelease(root);
    version_ = present(release["VERSION_ID"]);
    build_ = present(release["BUILD_ID"]);
    utsname kernel{};
    if (!build_ && ::uname(&kernel) == 0) {
        build_ = present(kernel.release);
    }
}

}  // namespace ktr::linux_
