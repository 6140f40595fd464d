#include <cmath>
#include <cstddef>
#include <cstdint>
#include <string>

#include "linux/positions/TrackReader.h"
#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"

// Any bytes as a track, in both of its forms: positions in the order of their time, or one line that says what is
// wrong.

namespace {

using ktr::fuzz::require;
using ktr::linux_::TrackReader;

void check(const std::variant<TrackReader::Track, ktr::documents::DocumentError>& read) {
    if (const auto* error = std::get_if<ktr::documents::DocumentError>(&read)) {
        const std::string line = error->text();
        require(!error->message.empty() && line.find_first_of("\n\r\x1b") == std::string::npos, "an error is one line");
        require(ktr::platform::isValidUtf8(line), "an error is UTF-8");
        return;
    }
    const auto& track = std::get<TrackReader::Track>(read);
    require(!track.empty(), "a track has a position");
    double before = 0.0;
    for (const auto& position : track) {
        require(position.seconds >= before, "time does not go back");
        require(ktr::platform::isValid(position.fix.coordinate), "a position is on the earth");
        require(position.fix.horizontalAccuracy >= 0.0, "an accuracy is a length");
        require(std::isfinite(position.fix.altitude) && std::isfinite(position.fix.speed), "numbers are numbers");
        before = position.seconds;
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    check(TrackReader::readGpx(text, "track.gpx"));
    check(TrackReader::readScenario(text, "track.json"));
    return 0;
}
