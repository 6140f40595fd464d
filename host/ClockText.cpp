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

/// The short format of a locale in letters that Qt fills: some say with "B" which part of the day it is, which Qt shows
/// as a "B".
QString shortFormat(const QLocale& locale) {
    QString format = locale.timeFormat(QLocale::ShortFormat);
    return format.replace(QLatin1Char('B'), QLatin1String("ap"));
}

}  // namespace

std::string clockText(platform::Date moment, int offsetSeconds, const std::string& language,
                      const std::string& region) {
    const double sinceEpoch = moment.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
    const QDateTime face =
        QDateTime::fromSecsSinceEpoch(static_cast<qint64>(std::floor(sinceEpoch)), Qt::OffsetFromUTC, offsetSeconds);
    const QLocale locale = localeFor(language, region);
    return locale.toString(face.time(), shortFormat(locale)).toStdString();
}

}  // namespace ktr::host
