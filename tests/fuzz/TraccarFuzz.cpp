#include <cstddef>
#include <cstdint>
#include <string_view>

#include "server/ingest/PhoneMessages.h"
#include "tests/fuzz/ReportCheck.h"

// Any bytes as the JSON of Traccar Client 9 and later.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto report = ktr::server::PhoneMessages::traccar({reinterpret_cast<const char*>(data), size});
    ktr::fuzz::checkReport(report);
    ktr::fuzz::require(!report.face && !report.sealed, "a tracker has no face");
    return 0;
}
