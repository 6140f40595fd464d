#include "platform/base/LogArea.h"

namespace ktr::platform {

namespace {

template <LogArea area>
const Log& logNamed(const char* category) {
    static const Log log("org.ktr.platform", category);
    return log;
}

}  // namespace

const Log& areaLog(LogArea area) {
    switch (area) {
        case LogArea::Account:
            return logNamed<LogArea::Account>("account");
        case LogArea::Contacts:
            return logNamed<LogArea::Contacts>("contacts");
        case LogArea::Maps:
            return logNamed<LogArea::Maps>("maps");
        case LogArea::Net:
            return logNamed<LogArea::Net>("net");
        case LogArea::Paint:
            return logNamed<LogArea::Paint>("paint");
        case LogArea::Positions:
            return logNamed<LogArea::Positions>("positions");
        case LogArea::Preferences:
            return logNamed<LogArea::Preferences>("preferences");
        case LogArea::Host:
            break;
    }
    return logNamed<LogArea::Host>("host");
}

}  // namespace ktr::platform
