#include "server/store/StoreTables.h"

namespace ktr::server {

namespace {

constexpr std::array kTables = {
    StoreTable{"person", true, {"id"}, {"identity"}},
    StoreTable{"handle", true, {"person"}, {}},
    StoreTable{"device", true, {"person"}, {"secret", "key", "cards_sent"}},
    StoreTable{"sign_in", false, {"person"}, {"link"}},
    StoreTable{"browser", false, {"person"}, {"session"}},
    StoreTable{"fix", false, {"person"}, {}},
    StoreTable{"share", true, {"owner", "viewer"}, {}},
    StoreTable{"viewed", false, {"owner", "viewer"}, {}},
    StoreTable{"place", true, {"owner"}, {}},
    StoreTable{"clock", true, {}, {}},
    StoreTable{"forgotten", true, {}, {}},
};

}  // namespace

std::span<const StoreTable> StoreTables::all() {
    return kTables;
}

}  // namespace ktr::server
