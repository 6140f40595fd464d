#pragma once

#include <string_view>

#include "server/ingest/Report.h"

namespace ktr::server {

/// Reads what phones send: pure functions from bytes to a report. They never fail: what is not understood is junk. Any
/// thread.
class PhoneMessages {
  public:
    /// The body of an OwnTracks post: one JSON object with a "_type". A "location" is a position, but for a ping ("t":
    /// "p"), which repeats an old place with the present time. A "card" may bring its owner's face; what it calls them
    /// is not read. Every other type says only that the phone lives: places of a person's own ("waypoint",
    /// "transition") are none of a phone's business. "encrypted" is opened with the phone's key; without one, or with a
    /// wrong one, it is junk.
    static Report ownTracks(std::string_view body, std::string_view key = {});

    /// The parameters of a query or a form, as OsmAnd, Traccar Client before 9 and GPSLogger send them: "id", "lat",
    /// "lon" (or "location=LAT,LON"), "timestamp" or "time" in seconds, in milliseconds, or as a date, "accuracy" or
    /// "acc" in metres.
    static Report parameters(std::string_view form);

    /// The JSON of Traccar Client 9 and later: "location" with "timestamp" and "coords", beside "device_id". Numbers
    /// below zero stand for what is not known.
    static Report traccar(std::string_view body);

    /// Seconds since 1970 of a time in a text: seconds, milliseconds (from 2^31 on), an ISO time, or "2026-05-16
    /// 17:42:00", which means UTC. None for anything else.
    static std::optional<double> timeOf(std::string_view text);
};

}  // namespace ktr::server
