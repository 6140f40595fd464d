#include "ask/Language.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <random>
#include <set>

#include "ask/Languages.h"
#include "ask/Sentences.h"
#include "ask/Understanding.h"

namespace ktr::ask {
namespace {

std::filesystem::path folder() {
    return std::filesystem::path(KTR_SOURCE_DIR) / "resources/questions";
}

std::set<std::string> tags() {
    std::set<std::string> tags;
    for (const auto& entry : std::filesystem::directory_iterator(folder())) {
        tags.insert(entry.path().stem().string());
    }
    return tags;
}

TEST(LanguageTest, EveryLanguageHasEverySentenceOfEnglishAndNoOther) {
    Languages languages(folder());
    const auto english = languages.language("en");
    ASSERT_TRUE(english) << languages.problem();
    for (const std::string& tag : tags()) {
        const auto language = languages.language(tag);
        ASSERT_TRUE(language) << languages.problem();
        for (const auto& [key, text] : english->sentences()) {
            EXPECT_TRUE(language->sentences().count(key) == 1 && !language->sentence(key).empty())
                << tag << ": " << key;
        }
        EXPECT_EQ(language->sentences().size(), english->sentences().size()) << tag;
        EXPECT_GE(language->suggestions().size(), 6U) << tag;
        EXPECT_EQ(language->relations().size() >= 10, true) << tag;
    }
}

TEST(LanguageTest, EverySentenceNamesWhatItIsAboutAndLeavesNothingUnfilled) {
    Languages languages(folder());
    const Sentences::Arguments arguments{{"name", "NNN"},     {"names", "MMM"},   {"place", "PPP"}, {"where", "WWW"},
                                         {"distance", "DDD"}, {"far", "yes"},     {"when", "then"}, {"time", "TTT"},
                                         {"count", "4"},      {"choices", "CCC"}, {"which", "yes"}, {"every", "no"},
                                         {"end", "yes"}};
    const std::map<std::string, std::vector<std::string>> wanted{{"found", {"NNN", "WWW", "DDD", "TTT"}},
                                                                 {"foundNoWords", {"NNN", "TTT", "DDD"}},
                                                                 {"notSeen", {"NNN"}},
                                                                 {"askedNewer", {"TTT"}},
                                                                 {"ambiguous", {"NNN"}},
                                                                 {"unknownPerson", {"NNN"}},
                                                                 {"unknownPersonNear", {"NNN", "CCC"}},
                                                                 {"howFar", {"NNN", "DDD", "TTT"}},
                                                                 {"howFarUnknown", {"NNN"}},
                                                                 {"near", {"PPP", "MMM", "TTT"}},
                                                                 {"closest", {"PPP", "MMM", "TTT"}},
                                                                 {"nobodyNear", {"PPP"}},
                                                                 {"unknownPlace", {"PPP"}},
                                                                 {"fenceArrives", {"NNN", "PPP"}},
                                                                 {"fenceLeaves", {"NNN", "PPP"}},
                                                                 {"sharedWith", {"MMM", "TTT"}},
                                                                 {"hiddenFrom", {"MMM"}},
                                                                 {"whoSees", {"MMM"}},
                                                                 {"askToShare", {"NNN"}},
                                                                 {"askedToShare", {"NNN", "TTT"}},
                                                                 {"seenMore", {"MMM", "4"}}};
    for (const std::string& tag : tags()) {
        const auto language = languages.language(tag);
        ASSERT_TRUE(language) << languages.problem();
        const Sentences sentences(*language, 0.0);
        for (const auto& [key, pattern] : language->sentences()) {
            const std::string text = sentences.text(key, arguments);
            EXPECT_EQ(text.find_first_of("{}|"), std::string::npos) << tag << ": " << key << ": " << text;
            EXPECT_EQ(text.find('!'), std::string::npos) << tag << ": " << key << ": " << text;
        }
        for (const auto& [key, words] : wanted) {
            const std::string text = sentences.text(key, arguments);
            for (const std::string& word : words) {
                EXPECT_NE(text.find(word), std::string::npos) << tag << ": " << key << ": " << text;
            }
        }
    }
}

// The button's words are the question that it asks.
TEST(LanguageTest, WhatAsksAFriendToShare_IsUnderstoodInEveryLanguage) {
    Languages languages(folder());
    const auto english = languages.language("en");
    ASSERT_TRUE(english);
    std::vector<Person> listed;
    for (const char* name : {"Ann Marsh", "美咲", "Layla Haddad-Nur", "Иван Петров", "Mary Ann O’Neil"}) {
        Person person;
        person.fullName = name;
        person.emails = {"p" + std::to_string(listed.size()) + "@mail.example"};
        listed.push_back(person);
    }
    const People people(listed);
    for (const std::string& tag : tags()) {
        const auto language = languages.language(tag);
        ASSERT_TRUE(language) << languages.problem();
        for (const Person& person : people.all()) {
            for (const std::string& named : {person.fullName, person.emails.front()}) {
                Question question;
                question.text = Sentences(*language, 0.0).text("askToShare", {{"name", named}});
                const auto result = Understanding(*language, *english, people).understand(question);
                const auto* understood = std::get_if<Understood>(&result);
                if (understood == nullptr) {
                    ADD_FAILURE() << tag << ": " << question.text;
                    continue;
                }
                EXPECT_EQ(understood->meaning.wish, Wish::AskToShare) << tag << ": " << question.text;
                ASSERT_EQ(understood->people.size(), 1U) << tag << ": " << question.text;
                EXPECT_EQ(understood->people.front(), &person) << tag << ": " << question.text;
            }
        }
    }
}

// What the first page of the window offers to ask.
TEST(LanguageTest, WhatTheWindowSuggests_IsUnderstoodInEveryLanguage) {
    Languages languages(folder());
    const auto english = languages.language("en");
    ASSERT_TRUE(english);
    const People nobody({});
    const std::map<std::string, Wish> wanted{
        {"SUGGEST_FRIENDS", Wish::WhereAll}, {"SUGGEST_NEAR", Wish::NearMe}, {"SUGGEST_HIDE", Wish::Hide}};
    for (const std::string& tag : tags()) {
        std::ifstream file(std::filesystem::path(KTR_SOURCE_DIR) / ("resources/localization/host_" + tag + ".ts"));
        const std::string texts((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
        const auto language = languages.language(tag);
        ASSERT_TRUE(language) << languages.problem();
        for (const auto& [key, wish] : wanted) {
            const auto source = texts.find("<source>" + key + "</source>");
            ASSERT_NE(source, std::string::npos) << tag << ": " << key;
            const std::string mark = "<translation>";
            const auto begin = texts.find(mark, source) + mark.size();
            Question question;
            question.text = texts.substr(begin, texts.find("</translation>", begin) - begin);
            const auto result = Understanding(*language, *english, nobody).understand(question);
            const auto* understood = std::get_if<Understood>(&result);
            if (understood == nullptr) {
                ADD_FAILURE() << tag << ": " << question.text;
                continue;
            }
            EXPECT_EQ(understood->meaning.wish, wish) << tag << ": " << question.text;
        }
    }
}

TEST(LanguageTest, FileFor_IsTheNearestOfTheFolderAndNeverOutsideIt) {
    const auto files = tags();
    EXPECT_FALSE(Language::fileFor("../questions/en", files));
    EXPECT_FALSE(Language::fileFor("", files));
    EXPECT_EQ(Language::fileFor("pt-BR", files), "pt");
    EXPECT_EQ(Language::fileFor("zh-TW", files), "zh-Hant");
    EXPECT_EQ(Language::fileFor("zh-CN", files), "zh-Hans");
    EXPECT_EQ(Language::fileFor("iw", files), "he");
    EXPECT_FALSE(Language::fileFor("tlh", files));
}

// Voice clients name the language with each question: whoever invents tags must not make a copy of a language for each.
TEST(LanguagesTest, TagsOfOneFileShareWhatItSays) {
    Languages languages(folder());
    const auto english = languages.language("en");
    ASSERT_TRUE(english) << languages.problem();
    for (char first = 'A'; first <= 'Z'; ++first) {
        const std::string tag = std::string("en-") + first + first;
        const auto invented = languages.language(tag);
        ASSERT_TRUE(invented) << tag;
        EXPECT_EQ(invented->tag(), tag);
        EXPECT_EQ(&invented->sentences(), &english->sentences()) << tag;
        EXPECT_EQ(languages.language("x" + tag)->tag(), "en");
    }
    EXPECT_NE(&languages.language("de")->sentences(), &english->sentences());
}

// The name of the language reaches this as a peer sent it, as long as a frame may be.
TEST(LanguagesTest, ATagWithoutEnd_IsNoLanguageAndCostsNothing) {
    std::string tag = "en";
    while (tag.size() < 16000) {
        tag += "-a";
    }
    const auto files = tags();
    EXPECT_FALSE(Language::fileFor(tag, files));
    EXPECT_EQ(Languages(folder()).language(tag)->tag(), "en");
    EXPECT_EQ(Language::fileFor("en-" + std::string(Language::kLongestTag - 3, 'a'), files), "en");
    EXPECT_FALSE(Language::fileFor("en-" + std::string(Language::kLongestTag - 2, 'a'), files));
}

// Once listed, the folder is not looked at again: questions are also read on the main thread.
TEST(LanguagesTest, LanguagesThatWereRead_NeedNoDisk) {
    const auto copy = std::filesystem::temp_directory_path() / ("languages-" + std::to_string(::getpid()));
    std::filesystem::copy(folder(), copy);
    Languages languages(copy);
    ASSERT_TRUE(languages.language("de"));
    std::filesystem::remove_all(copy);
    ASSERT_TRUE(languages.language("de-AT"));
    EXPECT_EQ(languages.language("de-AT")->tag(), "de-AT");
    EXPECT_FALSE(languages.language("fr"));
    EXPECT_FALSE(languages.problem().empty());
}

// Whoever is found was named: every word of a friend's name, in one of its forms, stands in the question.
TEST(LanguageTest, RandomQuestionsNeverNameTheWrongPerson) {
    Languages languages(folder());
    const auto english = languages.language("en");
    ASSERT_TRUE(english);
    Person ann;
    ann.fullName = ann.firstName = "Annabel";
    ann.emails = {"ann@harbour.example"};
    Person otto;
    otto.fullName = otto.firstName = "Ottokar";
    otto.emails = {"otto@mail.example"};
    const People people({ann, otto});
    const std::vector<std::string> words{
        "where",  "is",  "Annabel", "Ottokar", "Annabell", "Otto", "near",  "me", "tell",     "when", "leaves",
        "work",   "and", ",",       "until",   "six",      "hide", "share", "my", "location", "with", "\xff\xfe",
        "\u202e", "家",  "は",      "в",       "{name}",   "[",    "|",     "?",  "   ",      "'s"};
    std::mt19937 random(20261122);  // NOLINT: the same questions every time
    const auto names = tags();
    const std::vector<std::string> all(names.begin(), names.end());
    for (int i = 0; i < 10000; ++i) {
        std::string text;
        for (std::size_t n = random() % 12; n > 0; --n) {
            text += words[random() % words.size()] + (random() % 5 == 0 ? "" : " ");
        }
        Question question;
        question.text = text;
        const auto language = languages.language(all[random() % all.size()]);
        const auto result = Understanding(*language, *english, people).understand(question);
        if (const auto* understood = std::get_if<Understood>(&result)) {
            for (const Person* person : understood->people) {
                EXPECT_NE(text.find(person->fullName), std::string::npos) << text;
            }
        }
    }
}

TEST(LanguageTest, HostileQuestionsEndSoon) {
    Languages languages(folder());
    const People people({});
    const auto english = languages.language("en");
    for (const std::string& tag : tags()) {
        const auto language = languages.language(tag);
        for (const std::string& piece : {std::string("where is "), std::string("a "), std::string("a and "),
                                         std::string("家"), std::string(" ")}) {
            Question question;
            while (question.text.size() < 5000) {
                question.text += piece;
            }
            const auto begin = std::chrono::steady_clock::now();
            Understanding(*language, *english, people).understand(question);
            question.text.resize(200);
            Understanding(*language, *english, people).understand(question);
            EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(2)) << tag << ": " << piece;
        }
    }
}

}  // namespace
}  // namespace ktr::ask
