#include "linux/maps/TileFreshness.h"

#include <QString>
#include <QStringList>
#include <algorithm>
#include <optional>

#include "documents/HttpTime.h"

namespace ktr::linux_ {

namespace {

constexpr std::int64_t kDay = 86400;
constexpr std::int64_t kYear = 365 * kDay;

/// What is no date has passed already.
std::int64_t dateOf(const std::string& text) {
    const auto date = documents::parseHttpTime(text);
    return date ? static_cast<std::int64_t>(date->secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate)
                : 0;
}

std::optional<std::int64_t> secondsOf(const QString& text) {
    bool good = false;
    const qlonglong seconds = text.trimmed().remove(u'"').toLongLong(&good);
    return good && seconds >= 0 ? std::optional<std::int64_t>(seconds) : std::nullopt;
}

}  // namespace

TileFreshness TileFreshness::of(const std::string& cacheControl, const std::string& age, const std::string& expires,
                                std::int64_t now) {
    TileFreshness freshness;
    std::optional<std::int64_t> most;
    bool isChecked = false;
    for (const QString& directive : QString::fromStdString(cacheControl).toLower().split(u',')) {
        const QString name = directive.section(u'=', 0, 0).trimmed();
        if (name == QLatin1String("max-age")) {
            most = secondsOf(directive.section(u'=', 1)).value_or(0);
        } else if (name == QLatin1String("no-cache")) {
            isChecked = true;
        } else if (name == QLatin1String("no-store")) {
            freshness.isStored = false;
        }
    }
    const std::int64_t old = secondsOf(QString::fromStdString(age)).value_or(0);
    if (isChecked) {
        freshness.expires = now;
    } else if (most) {
        freshness.expires = now + std::clamp<std::int64_t>(*most - std::min(old, kYear), 0, kYear);
    } else if (!expires.empty()) {
        freshness.expires = std::clamp(dateOf(expires), now, now + kYear);
    } else {
        freshness.expires = now + kDay;
    }
    return freshness;
}

}  // namespace ktr::linux_
