#include "serve/AssistantAnswers.h"

#include <gtest/gtest.h>

#include <QUrl>

#include "host/scenario/ScenarioReader.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Json.h"
#include "serve/FriendsReader.h"

namespace ktr::test {

using serve::AssistantAnswers;
using serve::LocationService;

class AssistantAnswersTest : public ::testing::Test {
  protected:
    static LocationService of(const serve::FriendsFile& file) { return {file, "1000", "token", 1700000000}; }
    static LocationService demoPeople() {
        auto read = serve::FriendsReader::readFile(KTR_SOURCE_DIR "/resources/service/friends.json");
        auto* file = std::get_if<serve::FriendsFile>(&read);
        EXPECT_NE(file, nullptr);
        return of(file != nullptr ? *file : serve::FriendsFile());
    }
    platform::Dictionary answer(const std::string& question) const {
        return AssistantAnswers(service).answer(question, {0.0, 1.7e12});
    }
    /// The whole names in the snippet; "-" without one.
    std::string names(const std::string& question) const {
        const platform::Dictionary turn = answer(question);
        const platform::Value* snippet = turn.find("snippet");
        if (snippet == nullptr) {
            return "-";
        }
        std::string names;
        for (const auto& location : *snippet->dictionary()->find("locations")->array()) {
            const auto& person = *location.dictionary()->find("friend")->dictionary()->find("object")->dictionary();
            names += (names.empty() ? "" : ", ") + *person.find("fullName")->string();
        }
        return names;
    }
    LocationService service = demoPeople();
};

TEST_F(AssistantAnswersTest, People_AreFoundByName) {
    EXPECT_EQ(names("Where is Ann?"), "Ann Marsh");
    EXPECT_EQ(names("where's ann marsh"), "Ann Marsh");
    EXPECT_EQ(names("ZOFIA"), "Zofia Wrona");
    EXPECT_EQ(names("find Ann and Otto, please"), "Ann Marsh, Otto Brandt");
    EXPECT_EQ(names("where is otto@mail.example?"), "Otto Brandt");
    EXPECT_EQ(names("where is \xE6\xA3\xAE \xE9\x99\xBD\xE6\x96\x97"), "\xE6\xA3\xAE \xE9\x99\xBD\xE6\x96\x97");
}

TEST_F(AssistantAnswersTest, Several_GetAProximity) {
    EXPECT_EQ(answer("Where is Ann?").find("snippet")->dictionary()->find("proximity"), nullptr);
    EXPECT_NE(answer("Where are Ann and Otto?").find("snippet")->dictionary()->find("proximity"), nullptr);
    EXPECT_EQ(*answer("Who is near me?").find("snippet")->dictionary()->find("proximity")->string(), "nearby");
    EXPECT_NE(names("Where are my friends?").find("Zofia Wrona"), std::string::npos);
    EXPECT_EQ(names("Who is near me?").find("Zofia Wrona"), std::string::npos);
}

TEST_F(AssistantAnswersTest, WhatIsNotUnderstood_GetsASentenceThatHelps) {
    for (const char* question : {"", "Tell me a joke", "Where is Nobody?", "Tell me when Nobody gets home"}) {
        EXPECT_EQ(names(question), "-") << question;
        EXPECT_NE(answer(question).find("sentence")->string()->find("Where is Ann?"), std::string::npos);
    }
}

TEST_F(AssistantAnswersTest, PeopleOfAScenario_MayHaveNoHandleAndNoName) {
    const auto read = serve::FriendsReader::readText(R"({"snippet": {"locations": [
        {"latitude": 1, "longitude": 2}, {"friend": {"object": {"firstName": "Zed"}}}]}})",
                                                     "s.json");
    ASSERT_TRUE(std::holds_alternative<serve::FriendsFile>(read));
    const LocationService unnamed = of(std::get<serve::FriendsFile>(read));
    const AssistantAnswers assistant(unnamed);
    const auto sentence = [&](const char* question) {
        return *assistant.answer(question, {0.0, 1.7e12}).find("sentence")->string();
    };
    EXPECT_EQ(sentence("Where are my friends?"), "Here is where they are.");
    EXPECT_EQ(sentence("Who is near me?"), "Somebody is here.");
    EXPECT_EQ(sentence("Where is Zed?"), "Looking for Zed.");
    EXPECT_EQ(sentence("Tell me when Zed leaves"), "Looking for Zed.");
    const auto answer =
        host::ScenarioReader(platform::Date{0.0})
            .readText(platform::writeJson(assistant.answer("Where are my friends?", {0.0, 1.7e12})), "answer");
    EXPECT_TRUE(std::holds_alternative<host::Scenario>(answer));
}

TEST_F(AssistantAnswersTest, Answer_IsAScenario) {
    for (const char* question : {"Where is Ann?", "Where are my friends?", "Where is Shirin?"}) {
        const auto read =
            host::ScenarioReader(platform::Date{0.0}).readText(platform::writeJson(answer(question)), "answer");
        const auto* error = std::get_if<documents::DocumentError>(&read);
        ASSERT_EQ(error, nullptr) << error->text();
        EXPECT_EQ(std::get<host::Scenario>(read).kind, "VAKtrLocationSnippet");
    }
}

TEST_F(AssistantAnswersTest, PreferredEmail_ArrivesAsItIsWhateverItsCharacters) {
    for (const char* email : {"mara.lind@harbour.example", "a&b=c d+%41@x.example", "\xC3\xBC@x.example"}) {
        serve::FriendsFile file;
        file.user.emails = {email};
        service = of(file);
        const auto drawn = host::ScenarioReader(platform::Date{0.0})
                               .readText(platform::writeJson(answer("Share my location")), "answer");
        const auto* scenario = std::get_if<host::Scenario>(&drawn);
        ASSERT_NE(scenario, nullptr) << email;
        const auto snippet = std::dynamic_pointer_cast<platform::VASnippet>(scenario->snippet);
        ASSERT_NE(snippet, nullptr);
        const QString context = QString::fromStdString(snippet->searchContext->text());
        const QString value = context.section(QStringLiteral("preferredEmail="), 1).section(u'&', 0, 0);
        EXPECT_EQ(value.count(u'='), 0);
        EXPECT_EQ(QUrl::fromPercentEncoding(value.toLatin1()).toStdString(), email);
    }
}

}  // namespace ktr::test
