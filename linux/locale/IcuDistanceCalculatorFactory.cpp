#include "linux/locale/IcuDistanceCalculatorFactory.h"

#include <system_error>
#include <utility>

#include <QSettings>
#include <QStandardPaths>

namespace ktr::linux_ {

IcuDistanceCalculatorFactory::IcuDistanceCalculatorFactory(std::shared_ptr<platform::Geodesy> geodesy,
                                                           std::optional<std::filesystem::path> preferences,
                                                           std::optional<UnitSystem> chosen)
    : geodesy_(std::move(geodesy)), preferences_(std::move(preferences)), chosen_(chosen) {}

std::filesystem::path IcuDistanceCalculatorFactory::sessionPreferences() {
    const auto folder = QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation);
    return std::filesystem::path(folder.toStdString()) / "ktr";
}

std::optional<UnitSystem> IcuDistanceCalculatorFactory::preferredUnits(const std::string& suite) const {
    if (chosen_) {
        return chosen_;
    }
    if (!preferences_ || suite.empty() || suite.find('/') != std::string::npos) {
        return std::nullopt;
    }
    const auto file = *preferences_ / (suite + ".conf");
    std::error_code ignored;
    if (!std::filesystem::is_regular_file(file, ignored)) {
        return std::nullopt;
    }
    const QSettings settings(QString::fromStdString(file.string()), QSettings::IniFormat);
    const auto word = settings.value(QStringLiteral("units/system")).toString();
    if (word == QLatin1String("metric")) {
        return UnitSystem::Metric;
    }
    if (word == QLatin1String("us")) {
        return UnitSystem::ImperialUS;
    }
    if (word == QLatin1String("uk")) {
        return UnitSystem::ImperialUK;
    }
    return std::nullopt;
}

std::shared_ptr<platform::DistanceCalculator> IcuDistanceCalculatorFactory::makeDistanceCalculator(
    const platform::DistanceCalculator::Settings& settings) {
    return std::make_shared<IcuDistanceCalculator>(settings, preferredUnits(settings.defaultsSuite), geodesy_);
}

}  // namespace ktr::linux_
