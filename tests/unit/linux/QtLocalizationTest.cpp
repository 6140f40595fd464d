#include "linux/locale/QtLocalization.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QXmlStreamReader>
#include <algorithm>
#include <array>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include <unicode/locid.h>
#include <unicode/plurrule.h>
#include <unicode/strenum.h>

#include "platform/base/Bundle.h"
#include "platform/base/Format.h"
#include "platform/base/PluralText.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kSources = KTR_SOURCE_DIR "/resources/localization/";
constexpr const char* kCompiled = KTR_RESOURCES "/localization";

/// A source file's texts, by context and key.
std::map<std::string, std::string> sourceTexts(const QString& path) {
    QFile file(path);
    EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << path.toStdString();
    std::map<std::string, std::string> texts;
    QXmlStreamReader reader(&file);
    std::string context;
    std::string key;
    while (!reader.atEnd()) {
        if (reader.readNext() != QXmlStreamReader::StartElement) {
            continue;
        }
        if (reader.name() == QLatin1String("name")) {
            context = reader.readElementText().toStdString();
        } else if (reader.name() == QLatin1String("source")) {
            key = context + "/" + reader.readElementText().toStdString();
        } else if (reader.name() == QLatin1String("translation")) {
            EXPECT_FALSE(reader.attributes().hasAttribute(QLatin1String("type"))) << key << " is not finished";
            EXPECT_TRUE(texts.emplace(key, reader.readElementText().toStdString()).second) << key << " comes twice";
        }
    }
    EXPECT_FALSE(reader.hasError()) << reader.errorString().toStdString();
    return texts;
}

/// The arguments that a text takes, in order of their numbers: "%@" is the next one, "%2$@" the second.
std::multiset<int> argumentsOf(const std::string& text) {
    std::multiset<int> arguments;
    int next = 1;
    for (std::size_t at = text.find('%'); at != std::string::npos; at = text.find('%', at + 1)) {
        if (text.compare(at, 2, "%@") == 0) {
            arguments.insert(next++);
        } else if (at + 3 < text.size() && text[at + 1] >= '1' && text[at + 1] <= '9' &&
                   text.compare(at + 2, 2, "$@") == 0) {
            arguments.insert(text[at + 1] - '0');
        } else {
            ADD_FAILURE() << "a stray \"%\" in " << text;
        }
    }
    return arguments;
}

/// What a text can read like: itself, or each branch of a plural text by its category.
std::map<std::string, std::string> formsOf(const std::string& text) {
    if (!platform::PluralText::isPlural(text)) {
        return {{"other", text}};
    }
    std::map<std::string, std::string> forms;
    const auto other = platform::PluralText::branch(text, "other");
    EXPECT_TRUE(other) << text;
    for (const char* category : {"zero", "one", "two", "few", "many", "other"}) {
        const auto branch = platform::PluralText::branch(text, category);
        if (branch && (std::string(category) == "other" || branch->data() != other->data())) {
            forms.emplace(category, *branch);
        }
    }
    return forms;
}

/// The forms that numbers take in a language.
std::set<std::string> categoriesOf(const std::string& language) {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::PluralRules> rules(
        icu::PluralRules::forLocale(icu::Locale::forLanguageTag(language, status), status));
    const std::unique_ptr<icu::StringEnumeration> words(rules->getKeywords(status));
    std::set<std::string> out;
    while (const char* word = words->next(nullptr, status)) {
        out.insert(word);
    }
    EXPECT_TRUE(U_SUCCESS(status)) << language;
    return out;
}

constexpr std::array kLanguages = {"en", "de", "fr", "es", "pt", "it", "nl",      "sv",      "pl", "uk", "ru",
                                   "tr", "el", "ar", "he", "fa", "hi", "zh-Hans", "zh-Hant", "ja", "ko"};

class QtLocalizationTest : public ::testing::TestWithParam<const char*> {
  protected:
    /// Files of this bundle, by language.
    std::map<std::string, std::map<std::string, std::string>> languages() {
        std::map<std::string, std::map<std::string, std::string>> out;
        const QString prefix = QString::fromLatin1(GetParam()) + QLatin1Char('_');
        const QDir folder(QString::fromLatin1(kSources));
        for (const QString& name : folder.entryList({prefix + QLatin1String("*.ts")})) {
            const auto language = name.mid(prefix.size()).chopped(3).toStdString();
            out[language] = sourceTexts(folder.filePath(name));
        }
        return out;
    }
};

/// The project's own texts in a language.
class ProjectsTexts : public QtLocalization {
  public:
    explicit ProjectsTexts(const std::string& language) : QtLocalization(language) {
        EXPECT_TRUE(addBundle(platform::kSnippetsBundle, kCompiled, "snippets"));
        EXPECT_TRUE(addBundle(kHostBundle, kCompiled, "host"));
    }
};

}  // namespace

TEST_P(QtLocalizationTest, EveryLanguage_HasEveryKey) {
    const auto all = languages();
    EXPECT_EQ(all.size(), kLanguages.size());
    for (const char* language : kLanguages) {
        ASSERT_TRUE(all.contains(language)) << language;
    }
    for (const auto& [language, texts] : all) {
        for (const auto& [key, text] : all.at("en")) {
            EXPECT_TRUE(texts.contains(key)) << language << " lacks " << key;
        }
        EXPECT_EQ(texts.size(), all.at("en").size()) << language << " has keys that English does not know";
    }
}

TEST_P(QtLocalizationTest, EveryLanguage_TakesTheSameArguments) {
    const auto all = languages();
    for (const auto& [language, texts] : all) {
        for (const auto& [key, text] : texts) {
            const auto expected = argumentsOf(formsOf(all.at("en").at(key)).at("other"));
            for (const auto& [category, form] : formsOf(text)) {
                // "An hour ago", "two hours ago": some languages have words for those that show no number.
                const bool mayLack = category == "zero" || category == "one" || category == "two";
                auto others = expected;
                others.erase(1);
                const auto taken = argumentsOf(form);
                EXPECT_TRUE(taken == expected || (mayLack && taken == others))
                    << language << " " << key << " " << category << ": " << text;
            }
        }
    }
}

TEST_P(QtLocalizationTest, PluralTexts_HaveTheFormsOfTheirLanguageAndNoOthers) {
    for (const auto& [language, texts] : languages()) {
        const auto categories = categoriesOf(language);
        for (const auto& [key, text] : texts) {
            for (const auto& [category, form] : formsOf(text)) {
                EXPECT_TRUE(categories.contains(category)) << language << " " << key << ": " << category;
            }
        }
    }
}

TEST_P(QtLocalizationTest, Texts_AreNeitherEmptyNorPaddedAndHaveOneCharacterForAnEllipsis) {
    for (const auto& [language, texts] : languages()) {
        for (const auto& [key, text] : texts) {
            ASSERT_FALSE(text.empty()) << language << " " << key;
            EXPECT_NE(text.front(), ' ') << language << " " << key;
            EXPECT_NE(text.back(), ' ') << language << " " << key;
            EXPECT_EQ(text.find("..."), std::string::npos) << language << " " << key;
            EXPECT_EQ(text.find('\''), std::string::npos) << language << " " << key << ": a typewriter apostrophe";
        }
    }
}

TEST_P(QtLocalizationTest, NumbersAndUnits_AreNotParted) {
    for (const auto& [language, texts] : languages()) {
        for (const auto& [key, text] : texts) {
            if (key.find("LOCATED_") != std::string::npos) {
                EXPECT_EQ(text.find("%@ "), std::string::npos) << language << " " << key << ": an ordinary blank";
            }
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Bundles, QtLocalizationTest, ::testing::Values("snippets", "host"),
                         [](const auto& tested) { return tested.param; });

TEST(QtLocalizationTextsTest, TheBuiltInLabels_StandInBothTables) {
    for (const char* language : kLanguages) {
        const ProjectsTexts texts(language);
        for (const char* label : {"_$!<home>!$_", "_$!<work>!$_", "_$!<school>!$_", "_$!<gym>!$_", "_$!<other>!$_"}) {
            const auto shown = texts.text(label, platform::kSnippetsBundle);
            EXPECT_NE(shown, label) << language;
            EXPECT_EQ(texts.text(label, QtLocalization::kHostBundle, std::nullopt, ""), shown) << language;
        }
    }
}

TEST(QtLocalizationTextsTest, TheWordsReadAsTheyShould) {
    const ProjectsTexts english("en-GB");
    const auto filled = [&](const char* key, const platform::FormatArguments& arguments) {
        return platform::formatted(english.text(key, platform::kSnippetsBundle), arguments);
    };
    EXPECT_EQ(filled("APPLICATION_NAME", {}), "Friends");
    EXPECT_EQ(filled("CITY_STATE_LABEL", {"Brinmouth", "HB"}), "Brinmouth, HB");
    EXPECT_EQ(filled("LOCATED_MINUTES", {"4"}), "4\u00a0min ago");
    EXPECT_EQ(filled("LOCATED_LESS_THAN_30SECONDS", {"30"}), "Over 30\u00a0s ago");
    EXPECT_EQ(filled("ARRIVING_LABEL", {"Work"}), "You’ll hear as they reach Work");
    const ProjectsTexts arabic("ar-EG");
    EXPECT_EQ(platform::formatted(arabic.text("CITY_STATE_LABEL", platform::kSnippetsBundle), {"برينماوث", "HB"}),
              "برينماوث، HB");
    const ProjectsTexts japanese("ja");
    EXPECT_EQ(platform::formatted(japanese.text("CITY_STATE_LABEL", platform::kSnippetsBundle), {"Brinmouth", "HB"}),
              "HB Brinmouth");
}

TEST(QtLocalizationTextsTest, ALanguageWithoutTexts_ReadsEnglish) {
    for (const char* language : {"nb-NO", "", "en-AU", "en_US", "no such language", "cs", "sr-Latn"}) {
        const ProjectsTexts texts(language);
        EXPECT_EQ(texts.text("APPLICATION_NAME", platform::kSnippetsBundle), "Friends") << language;
        EXPECT_EQ(texts.languageOfTexts(), "en") << language;
    }
}

TEST(QtLocalizationTextsTest, ARegionOrAScript_FindsTheLanguagesTexts) {
    const std::map<std::string, std::string> expected = {{"pt-BR", "pt"},
                                                         {"pt-PT", "pt"},
                                                         {"zh", "zh-Hans"},
                                                         {"zh-CN", "zh-Hans"},
                                                         {"zh-SG", "zh-Hans"},
                                                         {"zh-TW", "zh-Hant"},
                                                         {"zh-HK", "zh-Hant"},
                                                         {"zh-MO", "zh-Hant"},
                                                         {"zh-Hant-HK", "zh-Hant"},
                                                         {"zh-Hans-TW", "zh-Hans"},
                                                         {"zh_TW", "zh-Hant"},
                                                         {"he-IL", "he"},
                                                         {"iw", "he"},
                                                         {"iw-IL", "he"},
                                                         {"es-419", "es"},
                                                         {"fr-CA", "fr"},
                                                         {"ar-AE", "ar"},
                                                         {"en-u-ms-metric", "en"}};
    for (const auto& [language, found] : expected) {
        EXPECT_EQ(ProjectsTexts(language).languageOfTexts(), found) << language;
    }
}

TEST(QtLocalizationTextsTest, PosixNames_AreRead) {
    EXPECT_EQ(ProjectsTexts("de_AT").text("APPLICATION_NAME", platform::kSnippetsBundle), "Freunde");
}

// Texts that were found are kept, by table and bundle.
TEST(QtLocalizationTextsTest, TextsThatAreAskedForAgain_AreTheSame_UntilTheBundleIsAnother) {
    ProjectsTexts texts("de");
    for (int i = 0; i < 2; ++i) {
        EXPECT_EQ(texts.text("APPLICATION_NAME", platform::kSnippetsBundle), "Freunde");
        EXPECT_EQ(texts.text("APPLICATION_NAME", platform::kSnippetsBundle, "NoSuchTable"), "APPLICATION_NAME");
        EXPECT_EQ(texts.text("APPLICATION_NAME", "org.example", std::nullopt, "default"), "default");
        EXPECT_EQ(texts.text("NO_SUCH_KEY", platform::kSnippetsBundle, std::nullopt, "default"), "default");
        EXPECT_EQ(texts.text("NO_SUCH_KEY", platform::kSnippetsBundle), "NO_SUCH_KEY");
    }
    texts.addBundle(platform::kSnippetsBundle, "/nonexistent", "texts");
    EXPECT_EQ(texts.text("APPLICATION_NAME", platform::kSnippetsBundle), "APPLICATION_NAME");
}

TEST(QtLocalizationTextsTest, AFolderWithoutTexts_IsNoBundle) {
    QtLocalization localization("en");
    EXPECT_FALSE(localization.addBundle("org.example", "/nonexistent", "texts"));
    EXPECT_EQ(localization.text("KEY", "org.example", std::nullopt, "default"), "default");
}

}  // namespace ktr::linux_
