#include "host/ClockText.h"

#include <QDateTime>
#include <QLocale>
#include <cmath>

#include "linux/locale/IcuNumberFormatter.h"
#include "linux/locale/LocaleRegion.h"

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

/// The short format of a locale in letters that Qt fills: the halves of the day in the locale's own capital or small
/// letters, and instead of the part of the day ("B"), which Qt shows as a "B".
QString shortFormat(const QLocale& locale) {
    const QLatin1String half("Ap");
    QString format = locale.timeFormat(QLocale::ShortFormat);
    return format.replace(QLatin1String("AP"), half).replace(QLatin1String("ap"), half).replace(QLatin1Char('B'), half);
}

/// The text with the digits of the numbers in the cards, which are the language's in the region.
QString inDigitsOf(QString text, const std::string& language, const std::string& region) {
    const std::string tag = linux_::LocaleRegion(region).localeWithLanguage(language);
    const QString zero = QString::fromStdString(linux_::IcuNumberFormatter(tag).plainStringFromInteger(0));
    for (QChar& c : text) {
        if (zero.size() == 1 && c.digitValue() >= 0) {
            c = QChar(static_cast<char16_t>(zero.front().unicode() + c.digitValue()));
        }
    }
    return text;
}

}  // namespace

std::string clockText(platform::Date moment, int offsetSeconds, const std::string& language,
                      const std::string& region) {
    const double sinceEpoch = moment.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
    const QDateTime face =
        QDateTime::fromSecsSinceEpoch(static_cast<qint64>(std::floor(sinceEpoch)), Qt::OffsetFromUTC, offsetSeconds);
    const QLocale locale = localeFor(language, region);
    return inDigitsOf(locale.toString(face.time(), shortFormat(locale)), language, region).toStdString();
}

}  // namespace ktr::host
