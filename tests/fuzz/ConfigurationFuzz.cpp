#include <cstddef>
#include <cstdint>
#include <string>

#include "linux/configuration/ConfigurationReader.h"
#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"

// Any bytes as a configuration: one that can be used, or one line that says what is wrong.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using ktr::fuzz::require;
    using ktr::linux_::ConfigurationReader;
    const std::string text(reinterpret_cast<const char*>(data), size);
    ktr::documents::DocumentWarnings warnings;
    const auto read = ConfigurationReader::readText(text, "/etc/ktr/config.json", &warnings);
    for (const auto& warning : warnings) {
        require(warning.text().find_first_of("\n\r\x1b") == std::string::npos, "a warning is one line");
        require(ktr::platform::isValidUtf8(warning.text()), "a warning is UTF-8");
    }
    if (const auto* error = std::get_if<ConfigurationReader::Error>(&read)) {
        require(!error->text.empty() && error->text.find_first_of("\n\r\x1b") == std::string::npos,
                "an error is one line");
        require(ktr::platform::isValidUtf8(error->text), "an error is UTF-8");
        return 0;
    }
    const auto& configuration = std::get<ktr::linux_::Configuration>(read);
    require(!configuration.account || !configuration.account->personId.empty(), "an account has a person");
    for (const std::string& file : configuration.certificates) {
        require(file.starts_with('/'), "paths are absolute");
    }
    for (const auto& source : configuration.maps.sources) {
        require(source.file.empty() != source.url.empty(), "a map is a file or an address");
        require(source.url.empty() || source.url.starts_with("https://"), "an address is encrypted");
        require(source.coarsest <= source.finest, "levels ascend");
    }
    require(configuration.positions.gpsdPort >= 1 && configuration.positions.gpsdPort <= 65535, "a port is one");
    return 0;
}
