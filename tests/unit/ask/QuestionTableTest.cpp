#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <sstream>

#include "ask/Languages.h"
#include "ask/Understanding.h"

namespace ktr::ask {
namespace {

/// Friends in the scripts of their languages, two of one name among them.
std::vector<Person> friends() {
    const auto person = [](const char* first, const char* last, const char* email, const char* nickname = "") {
        Person one;
        one.firstName = first;
        one.lastName = last;
        one.fullName = *last == '\0' ? std::string(first) : std::string(first) + " " + last;
        one.nickname = nickname;
        one.emails = {email};
        return one;
    };
    return {person("Ann", "Marsh", "ann@harbour.example"),        person("Otto", "Brandt", "otto@mail.example"),
            person("Zofia", "Nowak", "zofia@mail.example"),       person("Eva", "Lind", "mum@mail.example", "Mum"),
            person("Max", "Weber", "max.weber@mail.example"),     person("Max", "Stone", "max.stone@mail.example"),
            person("Анна", "Белова", "anna.belova@mail.example"), person("Олена", "Коваль", "olena@mail.example"),
            person("Ελένη", "Παππά", "eleni@mail.example"),       person("ليلى", "حداد", "layla@mail.example"),
            person("نوا", "بركات", "nawa@mail.example"),          person("שירה", "ברק", "shira@mail.example"),
            person("شیرین", "رضایی", "shirin@mail.example"),      person("प्रिया", "शर्मा", "priya@mail.example"),
            person("美咲", "佐藤", "misaki@mail.example"),        person("민지", "김", "minji@mail.example"),
            person("小明", "王", "xiaoming@mail.example"),        person("Ayşe", "Yılmaz", "ayse@mail.example"),
            person("José", "García", "jose@mail.example")};
}

/// A line of a table: the outcome or the wish; who, by e-mail address before its "@", in the order of the question; the
/// place as a word or as it was written; more; and the question.
struct Row {
    std::string file;
    int line = 0;
    std::vector<std::string> fields;
};

std::vector<Row> rows(const std::filesystem::path& file) {
    std::vector<Row> rows;
    std::ifstream stream(file);
    std::string text;
    for (int line = 1; std::getline(stream, text); ++line) {
        if (text.empty() || text.front() == '#') {
            continue;
        }
        Row row{file.filename().string(), line, {}};
        std::istringstream fields(text);
        for (std::string field; std::getline(fields, field, '\t');) {
            row.fields.push_back(field == "-" ? "" : field);
        }
        rows.push_back(row);
    }
    return rows;
}

std::string who(const std::vector<const Person*>& people) {
    std::string who;
    for (const Person* person : people) {
        who += (who.empty() ? "" : ",") + person->handle().substr(0, person->handle().find('@'));
    }
    return who;
}

/// What was understood, in the form of a table's line without its question.
std::vector<std::string> told(const Understanding::Result& result) {
    if (const auto* understood = std::get_if<Understood>(&result)) {
        const Meaning& meaning = understood->meaning;
        std::string place = understood->placePerson != nullptr ? "@" + who({understood->placePerson})
                            : understood->placeWord.empty()    ? meaning.place
                                                               : "<" + understood->placeWord + ">";
        std::string more = meaning.until;
        more += meaning.precision ? std::string("=") + nameOf(*meaning.precision) : "";
        more += meaning.everyTime ? "*" : "";
        more += meaning.thisMoment ? "!" : "";
        return {nameOf(meaning.wish), who(understood->people), place, more};
    }
    if (const auto* unknown = std::get_if<Understanding::UnknownPerson>(&result)) {
        return {"unknownPerson", who(unknown->near), unknown->name, ""};
    }
    if (const auto* several = std::get_if<Understanding::Ambiguous>(&result)) {
        return {"ambiguous", who(several->people), several->name, ""};
    }
    return {std::holds_alternative<Understanding::UnknownMoment>(result) ? "unknownMoment" : "notUnderstood", "", "",
            ""};
}

TEST(QuestionTableTest, EveryQuestionHasItsMeaning) {
    Languages languages(std::filesystem::path(KTR_SOURCE_DIR) / "resources/questions");
    const People people(friends());
    const auto english = languages.language("en");
    ASSERT_TRUE(english) << languages.problem();
    std::size_t questions = 0;
    std::size_t tables = 0;
    for (const auto& entry :
         std::filesystem::directory_iterator(std::filesystem::path(KTR_TEST_DATA) / "ask/questions")) {
        const std::string tag = entry.path().stem().string();
        const auto language = languages.language(tag);
        ASSERT_TRUE(language) << languages.problem();
        ASSERT_EQ(language->tag(), tag) << languages.problem();
        const auto table = rows(entry.path());
        ++tables;
        EXPECT_GE(table.size(), 30U) << tag;
        for (const Row& row : table) {
            ASSERT_EQ(row.fields.size(), 5U) << row.file << ":" << row.line;
            Question question;
            question.text = row.fields.back();
            question.language = tag;
            const auto result = Understanding(*language, *english, people).understand(question);
            const std::vector<std::string> expected(row.fields.begin(), row.fields.end() - 1);
            EXPECT_EQ(told(result), expected) << row.file << ":" << row.line << ": " << question.text;
            ++questions;
        }
    }
    EXPECT_GE(questions, 600U);
    EXPECT_EQ(tables, 21U);
}

}  // namespace
}  // namespace ktr::ask
