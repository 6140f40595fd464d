#include <cstddef>
#include <cstdint>
#include <string_view>

#include "host/scenario/ScenarioReader.h"
#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"

// Any bytes as a scenario: an answer to show, or one line that says what is wrong.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using ktr::fuzz::require;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const ktr::host::ScenarioReader reader(ktr::platform::Date{790171200.0});
    const auto read = reader.readText(text, "fuzz.json");
    if (const auto* error = std::get_if<ktr::documents::DocumentError>(&read)) {
        const std::string line = error->text();
        require(!error->message.empty() && line.find_first_of("\n\r\x1b") == std::string::npos, "an error is one line");
        require(ktr::platform::isValidUtf8(line), "an error is UTF-8");
        return 0;
    }
    const auto& scenario = std::get<ktr::host::Scenario>(read);
    // A question that the assistant does not understand is answered by a sentence alone.
    require(scenario.snippet != nullptr || !scenario.sentence.empty(), "a scenario has an answer");
    if (scenario.snippet) {
        scenario.snippet->description();
    }
    for (const char* language : {"", "en", "de-CH", "ar"}) {
        scenario.question.text(language);
        scenario.sentence.text(language);
    }
    return 0;
}
