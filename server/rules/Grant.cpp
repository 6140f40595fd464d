#include "server/rules/Grant.h"

namespace ktr::server {

std::string wordOf(Precision precision) {
    switch (precision) {
        case Precision::Kilometre:
            return "1km";
        case Precision::Town:
            return "town";
        case Precision::Exact:
            break;
    }
    return "exact";
}

std::optional<Precision> precisionOf(std::string_view word) {
    for (const Precision precision : {Precision::Exact, Precision::Kilometre, Precision::Town}) {
        if (word == wordOf(precision)) {
            return precision;
        }
    }
    return std::nullopt;
}

}  // namespace ktr::server
