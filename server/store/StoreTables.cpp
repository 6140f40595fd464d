#include "server/store/StoreTables.h"

namespace ktr::server {

namespace {

constexpr std::array kTables = {
    StoreTable{"person", true, {"id"}, {"identity"}},
    StoreTable{"handle", true, {"person"}, {}},
    StoreTable{"device", true, {"person"}, {"secret", "key"}},
    StoreTable{"sign_in", false, {"person"}, {"link"}},
    StoreTable{"browser", false, {"person"}, {"session"}},
    StoreTable{"fix", false, {"person"}, {}},
    StoreTable{"share", true, {"owner", "viewer"}, {}},
    StoreTable{"viewed", false, {"owner", "viewer"}, {}},
    StoreTable{"place", true, {"owner"}, {}},
    StoreTable{"face", true, {"person"}, {"hash"}},
    StoreTable{"card", false, {"owner"}, {"hash"}},
    StoreTable{"fence", false, {"subject", "watcher"}, {}},
    StoreTable{"outbox", false, {"subject", "watcher"}, {}},
    StoreTable{"fix_wish", false, {"viewer"}, {}},
    StoreTable{"ask", false, {"asker"}, {}},
    StoreTable{"clock", true, {}, {}},
    StoreTable{"forgotten", true, {}, {}},
};

}  // namespace

std::span<const StoreTable> StoreTables::all() {
    return kTables;
}

}  // namespace ktr::server
