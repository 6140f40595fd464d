#include "linux/configuration/ConfiguredGeography.h"

#include <QLocale>
#include <QTimeZone>

namespace ktr::linux_ {

std::optional<std::string> ConfiguredGeography::countryCode() const {
    if (auto configured = store_->configuration().geographicCountry) {
        return configured;
    }
    const QString code = QLocale::territoryToCode(QTimeZone::systemTimeZone().territory());
    // Territories that are no country ("world", continents) have digits for a code, or none.
    if (code.size() != 2 || !code[0].isLetter() || code == QLatin1String("ZZ")) {
        return std::nullopt;
    }
    return code.toStdString();
}

}  // namespace ktr::linux_
