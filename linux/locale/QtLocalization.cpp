#include "linux/locale/QtLocalization.h"

#include <algorithm>

#include <QString>
#include <QTranslator>

namespace ktr::linux_ {

namespace {

constexpr const char* kFallbackLanguage = "en";

/// "zh-Hant-TW" gives itself, "zh-Hant", "zh", and then English.
std::vector<std::string> candidates(std::string language) {
    std::vector<std::string> out;
    while (!language.empty()) {
        out.push_back(language);
        const auto cut = language.rfind('-');
        language.resize(cut == std::string::npos ? 0 : cut);
    }
    if (std::find(out.begin(), out.end(), kFallbackLanguage) == out.end()) {
        out.emplace_back(kFallbackLanguage);
    }
    return out;
}

}  // namespace

QtLocalization::QtLocalization(std::string language) : language_(std::move(language)) {
    std::replace(language_.begin(), language_.end(), '_', '-');
}

QtLocalization::~QtLocalization() = default;

bool QtLocalization::addBundle(const std::string& bundleIdentifier, const std::filesystem::path& folder,
                               const std::string& prefix) {
    Translators translators;
    bool english = false;
    for (const std::string& language : candidates(language_)) {
        const auto file = folder / std::string(prefix).append("_").append(language).append(".qm");
        auto translator = std::make_unique<QTranslator>();
        std::error_code ignored;
        if (std::filesystem::is_regular_file(file, ignored) &&
            translator->load(QString::fromStdString(file.string()))) {
            english = english || language == kFallbackLanguage;
            translators.push_back(std::move(translator));
        }
    }
    bundles_[bundleIdentifier] = std::move(translators);
    return english;
}

std::string QtLocalization::text(const std::string& key, const std::string& bundleIdentifier,
                                 const std::optional<std::string>& table,
                                 const std::optional<std::string>& defaultValue) const {
    const std::string context = table.value_or(kDefaultTable);
    if (const auto bundle = bundles_.find(bundleIdentifier); bundle != bundles_.end()) {
        for (const auto& translator : bundle->second) {
            const QString found = translator->translate(context.c_str(), key.c_str());
            if (!found.isNull()) {
                return found.toStdString();
            }
        }
    }
    return defaultValue.value_or(key);
}

}  // namespace ktr::linux_
