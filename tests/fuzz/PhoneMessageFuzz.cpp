#include <cmath>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "server/ingest/FixRules.h"
#include "server/ingest/PhoneMessages.h"
#include "tests/fuzz/Require.h"

// Any bytes as a phone's message, in each form: read or junk, and what is kept of it is a place on earth at a time that
// the rules allow.

namespace {

using ktr::fuzz::require;
using ktr::server::FixRules;
using ktr::server::PhoneMessages;
using ktr::server::Report;

constexpr std::int64_t kNow = 1763760000;

void check(const Report& report) {
    require((report.kind == Report::Kind::Position) == !report.fixes.empty(),
            "a position has a fix, nothing else has one");
    for (const auto& raw : report.fixes) {
        const auto outcome = FixRules::admit(raw, kNow);
        require(outcome.fix.has_value() == (outcome.loss == FixRules::Loss::None), "what is lost is counted");
        if (const auto& fix = outcome.fix) {
            require(std::abs(fix->latitude) <= 90.0 && std::abs(fix->longitude) <= 180.0, "on earth");
            require(fix->time <= kNow + FixRules::kMostAhead && fix->time >= kNow - FixRules::kRetention, "in time");
            require(!fix->accuracy || (*fix->accuracy > 0.0 && std::isfinite(*fix->accuracy)),
                    "an accuracy is a length");
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    check(PhoneMessages::ownTracks(text));
    check(PhoneMessages::ownTracks(text, "a key"));
    check(PhoneMessages::parameters(text));
    check(PhoneMessages::traccar(text));
    return 0;
}
