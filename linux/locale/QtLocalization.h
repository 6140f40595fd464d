#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/assistant/Localization.h"

class QTranslator;

namespace ktr::linux_ {

/// Texts from Qt's compiled translations (.qm): a file a bundle and language, named "<prefix>_<language>.qm", a context
/// a table, the key as source text. Everything is read when a bundle is added. Main thread.
class QtLocalization : public platform::Localization {
  public:
    /// The table that is meant when none is named.
    static constexpr const char* kDefaultTable = "Localizable";
    /// The bundle of the host's own texts.
    static constexpr const char* kHostBundle = "org.ktr.host";

    /// BCP 47, such as "de-AT": looked for as it is, then as its language and script ("zh-Hant" for "zh-TW"), then as
    /// its language, then in English. Old names of languages ("iw") are understood.
    explicit QtLocalization(std::string language);
    ~QtLocalization() override;
    QtLocalization(const QtLocalization&) = delete;
    QtLocalization& operator=(const QtLocalization&) = delete;

    /// Reads a bundle's texts from `folder`; false when not even its English file can be read. Adding a bundle again
    /// replaces it.
    bool addBundle(const std::string& bundleIdentifier, const std::filesystem::path& folder, const std::string& prefix);

    /// Whether there are texts in a language, or in one that it is a kind of, before English has to stand in. Any
    /// thread.
    static bool hasTexts(const std::string& language, const std::filesystem::path& folder, const std::string& prefix);

    std::string text(const std::string& key, const std::string& bundleIdentifier,
                     const std::optional<std::string>& table = std::nullopt,
                     const std::optional<std::string>& defaultValue = std::nullopt) const override;
    std::string hostBundleIdentifier() const override { return kHostBundle; }
    std::string languageOfTexts() const override { return languageOfTexts_; }

  private:
    using Translators = std::vector<std::unique_ptr<QTranslator>>;

    struct Texts {
        /// The most fitting language first, English last.
        Translators translators;
        /// Texts of the default table that were found: a row asks for the same few each time that it is filled.
        mutable std::unordered_map<std::string, std::string> known;
    };

    static std::optional<std::string> find(const Translators& translators, const std::string& table,
                                           const std::string& key);

    std::string language_;
    /// Of the bundle that was added last: the bundles of a project come in the same languages.
    std::string languageOfTexts_;
    std::map<std::string, Texts> bundles_;
};

}  // namespace ktr::linux_
