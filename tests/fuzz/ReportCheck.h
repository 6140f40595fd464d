#pragma once

#include <cmath>
#include <cstdint>

#include "server/ingest/Face.h"
#include "server/ingest/FixRules.h"
#include "server/ingest/Report.h"
#include "tests/fuzz/Require.h"

namespace ktr::fuzz {

/// What holds for whatever a phone sends: it is read or junk, and what is kept of it is a place on earth at a time that
/// the rules allow, and a face that is a picture and no more.
inline void checkReport(const server::Report& report) {
    using server::FixRules;
    constexpr std::int64_t kNow = 1763760000;
    require((report.kind == server::Report::Kind::Position) == !report.fixes.empty(),
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
    if (report.face) {
        std::string complaint;
        if (const auto face = server::Face::cleaned(*report.face, complaint)) {
            require(face->size() <= server::Face::kMostBytes, "a face is small");
        }
    }
}

}  // namespace ktr::fuzz
