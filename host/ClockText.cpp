#include "host/ClockText.h"

#include <QDateTime>
#include <QLocale>
#include <cmath>

namespace ktr::host {

namespace {

QLocale localeFor(const std::string& language, const std::string& region) {
    const QLocale own(QString::fromStdString(language));
    if (language.find('-') != std::string::npos) {
        return own;
    }
    const QLocale habits(QString::fromStdString(region));
    const QLocale both(own.language(), own.script(), habits.territory());
    // Asking for a pair that is not known gives another language.
    return both.language() == own.language() ? both : own;
}

}  // namespace

std::string clockText(platform::Date moment, int offsetSeconds, const std::string& language,
                      const std::string& region) {
    const double sinceEpoch = moment.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
    const QDateTime face =
        QDateTime::fromSecsSinceEpoch(static_cast<qint64>(std::floor(sinceEpoch)), Qt::OffsetFromUTC, offsetSeconds);
    return localeFor(language, region).toString(face.time(), QLocale::ShortFormat).toStdString();
}

}  // namespace ktr::host
