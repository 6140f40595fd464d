#include <cstddef>
#include <cstdint>
#include <string>

#include "linux/configuration/PreferencesFile.h"
#include "platform/base/Json.h"
#include "platform/base/Utf8.h"
#include "platform/base/Value.h"
#include "tests/fuzz/Require.h"

// Any bytes as preferences: texts that come back the same when they are written, or one line that says what is wrong.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using ktr::fuzz::require;
    using ktr::linux_::PreferencesFile;
    const std::string text(reinterpret_cast<const char*>(data), size);
    const auto read = PreferencesFile::readText(text, "preferences.json");
    if (const auto* error = std::get_if<ktr::documents::DocumentError>(&read)) {
        const std::string line = error->text();
        require(!error->message.empty() && line.find_first_of("\n\r\x1b") == std::string::npos, "an error is one line");
        require(ktr::platform::isValidUtf8(line), "an error is UTF-8");
        return 0;
    }
    const auto& texts = std::get<PreferencesFile::Texts>(read);
    ktr::platform::Dictionary members;
    for (const auto& [key, value] : texts) {
        members.set(key, value);
    }
    const auto again = PreferencesFile::readText(ktr::platform::writeJson(members), "preferences.json");
    const auto* same = std::get_if<PreferencesFile::Texts>(&again);
    require(same != nullptr && *same == texts, "what is written is read again");
    return 0;
}
