#include "server/rules/Grant.h"

namespace ktr::server {

std::string wordOf(Precision precision) {
    switch (precision) {
        case Precision::Kilometre:
            return "1km";
        case Precision::Town:
            return "town";
        case Precision::Places:
            return "places";
        case Precision::Exact:
            break;
    }
    return "exact";
}

std::optional<Precision> precisionOf(std::string_view word) {
    for (const Precision precision : {Precision::Exact, Precision::Kilometre, Precision::Town, Precision::Places}) {
        if (word == wordOf(precision)) {
            return precision;
        }
    }
    return std::nullopt;
}

std::int64_t Grant::end() const {
    return until.value_or(confirmed.value_or(from) + kQuestion + kPatience);
}

bool Grant::tells(std::int64_t now) const {
    return fences && precision == Precision::Exact && now >= from && now < end();
}

bool Grant::asks(std::int64_t now) const {
    return !until && now >= end() - kPatience && now < end();
}

}  // namespace ktr::server
