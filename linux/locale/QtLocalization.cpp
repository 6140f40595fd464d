#include "linux/locale/QtLocalization.h"

#include <algorithm>

#include <QString>
#include <QTranslator>

#include <unicode/locid.h>

namespace ktr::linux_ {

namespace {

constexpr const char* kFallbackLanguage = "en";

void add(std::vector<std::string>& candidates, const std::string& language) {
    if (!language.empty() && std::find(candidates.begin(), candidates.end(), language) == candidates.end()) {
        candidates.push_back(language);
    }
}

/// "zh-TW" gives itself, "zh-Hant", "zh", and then English: the region says which script is meant.
std::vector<std::string> candidates(const std::string& language) {
    std::vector<std::string> out;
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(language, status);
    locale.canonicalize(status);
    if (U_SUCCESS(status) && !locale.isBogus()) {
        add(out, locale.toLanguageTag<std::string>(status));
        const std::string name = locale.getLanguage();
        locale.addLikelySubtags(status);
        if (const std::string script = locale.getScript(); U_SUCCESS(status) && !script.empty()) {
            add(out, name + "-" + script);
        }
        add(out, name);
    }
    add(out, kFallbackLanguage);
    return out;
}

std::filesystem::path fileOf(const std::filesystem::path& folder, const std::string& prefix,
                             const std::string& language) {
    return folder / std::string(prefix).append("_").append(language).append(".qm");
}

}  // namespace

bool QtLocalization::hasTexts(const std::string& language, const std::filesystem::path& folder,
                              const std::string& prefix) {
    const bool isEnglish = language.substr(0, language.find('-')) == kFallbackLanguage;
    for (const std::string& candidate : candidates(language)) {
        std::error_code ignored;
        if ((candidate != kFallbackLanguage || isEnglish) &&
            std::filesystem::is_regular_file(fileOf(folder, prefix, candidate), ignored)) {
            return true;
        }
    }
    return false;
}

QtLocalization::QtLocalization(std::string language)
    : language_(std::move(language)), languageOfTexts_(kFallbackLanguage) {
    std::replace(language_.begin(), language_.end(), '_', '-');
}

QtLocalization::~QtLocalization() = default;

bool QtLocalization::addBundle(const std::string& bundleIdentifier, const std::filesystem::path& folder,
                               const std::string& prefix) {
    Translators translators;
    bool english = false;
    for (const std::string& language : candidates(language_)) {
        const auto file = fileOf(folder, prefix, language);
        auto translator = std::make_unique<QTranslator>();
        std::error_code ignored;
        if (std::filesystem::is_regular_file(file, ignored) &&
            translator->load(QString::fromStdString(file.string()))) {
            english = english || language == kFallbackLanguage;
            languageOfTexts_ = translators.empty() ? language : languageOfTexts_;
            translators.push_back(std::move(translator));
        }
    }
    bundles_[bundleIdentifier] = Texts{std::move(translators), {}};
    return english;
}

std::optional<std::string> QtLocalization::find(const Translators& translators, const std::string& table,
                                                const std::string& key) {
    for (const auto& translator : translators) {
        const QString found = translator->translate(table.c_str(), key.c_str());
        if (!found.isNull()) {
            return found.toStdString();
        }
    }
    return std::nullopt;
}

std::string QtLocalization::text(const std::string& key, const std::string& bundleIdentifier,
                                 const std::optional<std::string>& table,
                                 const std::optional<std::string>& defaultValue) const {
    const auto bundle = bundles_.find(bundleIdentifier);
    if (bundle == bundles_.end()) {
        return defaultValue.value_or(key);
    }
    const Texts& texts = bundle->second;
    if (table) {
        return find(texts.translators, *table, key).value_or(defaultValue.value_or(key));
    }
    if (const auto known = texts.known.find(key); known != texts.known.end()) {
        return known->second;
    }
    auto found = find(texts.translators, kDefaultTable, key);
    if (!found) {
        // Not kept: such keys may be anybody's words, without end.
        return defaultValue.value_or(key);
    }
    texts.known.emplace(key, *found);
    return *std::move(found);
}

}  // namespace ktr::linux_
