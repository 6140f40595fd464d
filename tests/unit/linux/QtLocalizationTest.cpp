#include "linux/locale/QtLocalization.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QXmlStreamReader>
#include <algorithm>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "platform/base/Format.h"

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
        EXPECT_TRUE(addBundle(kSnippetsBundle, kCompiled, "snippets"));
        EXPECT_TRUE(addBundle(kHostBundle, kCompiled, "host"));
    }
};

}  // namespace

TEST_P(QtLocalizationTest, EveryLanguage_HasEveryKey) {
    const auto all = languages();
    for (const char* language : {"en", "de", "ar", "ja"}) {
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
            EXPECT_EQ(argumentsOf(text), argumentsOf(all.at("en").at(key))) << language << " " << key << ": " << text;
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
    for (const char* language : {"en", "de", "ar", "ja"}) {
        const ProjectsTexts texts(language);
        for (const char* label : {"_$!<home>!$_", "_$!<work>!$_", "_$!<school>!$_", "_$!<gym>!$_", "_$!<other>!$_"}) {
            const auto shown = texts.text(label, QtLocalization::kSnippetsBundle);
            EXPECT_NE(shown, label) << language;
            EXPECT_EQ(texts.text(label, QtLocalization::kHostBundle, std::nullopt, ""), shown) << language;
        }
    }
}

TEST(QtLocalizationTextsTest, TheWordsReadAsTheyShould) {
    const ProjectsTexts english("en-GB");
    const auto filled = [&](const char* key, platform::FormatArguments arguments) {
        return platform::formatted(english.text(key, QtLocalization::kSnippetsBundle), arguments);
    };
    EXPECT_EQ(filled("APPLICATION_NAME", {}), "Friends");
    EXPECT_EQ(filled("CITY_STATE_LABEL", {"Brinmouth", "HB"}), "Brinmouth, HB");
    EXPECT_EQ(filled("LOCATED_MINUTES", {"4"}), "4\u00a0min ago");
    EXPECT_EQ(filled("LOCATED_LESS_THAN_30SECONDS", {"30"}), "Over 30\u00a0s ago");
    EXPECT_EQ(filled("ARRIVING_LABEL", {"Work"}), "You’ll hear when they arrive at Work");
    const ProjectsTexts arabic("ar-EG");
    EXPECT_EQ(platform::formatted(arabic.text("CITY_STATE_LABEL", QtLocalization::kSnippetsBundle), {"برينماوث", "HB"}),
              "برينماوث، HB");
    const ProjectsTexts japanese("ja");
    EXPECT_EQ(
        platform::formatted(japanese.text("CITY_STATE_LABEL", QtLocalization::kSnippetsBundle), {"Brinmouth", "HB"}),
        "HB Brinmouth");
}

TEST(QtLocalizationTextsTest, ALanguageWithoutTexts_ReadsEnglish) {
    for (const char* language : {"fr-FR", "", "en-AU", "en_US"}) {
        EXPECT_EQ(ProjectsTexts(language).text("APPLICATION_NAME", QtLocalization::kSnippetsBundle), "Friends")
            << language;
    }
}

TEST(QtLocalizationTextsTest, PosixNames_AreRead) {
    EXPECT_EQ(ProjectsTexts("de_AT").text("APPLICATION_NAME", QtLocalization::kSnippetsBundle), "Freunde");
}

TEST(QtLocalizationTextsTest, AFolderWithoutTexts_IsNoBundle) {
    QtLocalization localization("en");
    EXPECT_FALSE(localization.addBundle("org.example", "/nonexistent", "texts"));
    EXPECT_EQ(localization.text("KEY", "org.example", std::nullopt, "default"), "default");
}

}  // namespace ktr::linux_
