#include "ask/Engine.h"

#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <functional>

#include "platform/base/Json.h"

namespace ktr::ask {
namespace {

using platform::Dictionary;
using platform::Value;

constexpr double kNow = 800000000.0;

/// Writes down what it is asked, and answers as it is told.
class ServiceDouble : public ServicePort {
  public:
    struct Sent {
        std::string command;
        Dictionary members;
        std::string language;
    };
    void send(ServiceRequest request, Completion completion) override {
        sent.push_back({request.command, request.members, request.language});
        completion(answer ? answer(request.command, request.members)
                          : ServiceReply{ServiceReply::Failure::Unreachable});
    }
    std::vector<Sent> sent;
    std::function<ServiceReply(const std::string&, const Dictionary&)> answer;
};

Person person(const char* first, const char* last, const char* email) {
    Person one;
    one.firstName = first;
    one.lastName = last;
    one.fullName = std::string(first) + " " + last;
    one.emails = {email};
    return one;
}

Dictionary entry(double latitude, double longitude, double age, const char* label = nullptr) {
    Dictionary location{{"latitude", latitude},
                        {"longitude", longitude},
                        {"timestamp", (kNow - age + platform::kSecondsFrom1970ToReferenceDate) * 1000.0}};
    if (label != nullptr) {
        location.set("labels", Value::Array{Dictionary{{"label", label}}});
    }
    return {{"status", 200}, {"location", location}};
}

ServiceReply locations(Dictionary entries) {
    return {ServiceReply::Failure::None, Dictionary{{"statusCode", 200}, {"locations", std::move(entries)}}};
}

class EngineTest : public ::testing::Test {
  protected:
    EngineTest() {
        World world;
        world.isLocked = [this] { return isLocked; };
        world.distance = [this](double metres, const std::string& language) {
            distanceLanguages.push_back(language);
            return std::to_string(std::lround(metres)) + " m";
        };
        // Degrees near the equator, as if the earth were flat.
        world.metres = [](double a, double b, double c, double d) { return std::hypot(a - c, b - d) * 111320.0; };
        engine = std::make_unique<Engine>(
            std::make_shared<Languages>(std::filesystem::path(KTR_SOURCE_DIR) / "resources/questions"), service, world);
        engine->setPeople({person("Ann", "Marsh", "ann@harbour.example"), person("Otto", "Brandt", "otto@mail.example"),
                           person("Max", "Weber", "weber@mail.example"), person("Max", "Stone", "stone@mail.example")});
    }

    Answer ask(const std::string& text) {
        question.text = text;
        question.now = {kNow};
        std::optional<Answer> answer;
        engine->ask(question, [&](Answer given) { answer = std::move(given); });
        EXPECT_TRUE(answer);
        EXPECT_FALSE(answer->sentence.empty());
        return *answer;
    }

    ServiceDouble service;
    std::unique_ptr<Engine> engine;
    Question question;
    bool isLocked = false;
    std::vector<std::string> distanceLanguages;
};

TEST_F(EngineTest, SomebodySeen_IsSaidWithPlaceAndDistanceAndDrawn) {
    question.position = Position{1.0, 1.0, {}};
    service.answer = [](const std::string&, const Dictionary&) {
        Dictionary ann = entry(1.001, 1.0, 10.0, "Fish Market");
        ann.set("distanceInMeters", "310.52");
        return locations({{"ann@harbour.example", ann}});
    };
    const Answer answer = ask("Where is Ann?");
    EXPECT_EQ(answer.outcome, Outcome::Found);
    EXPECT_EQ(answer.sentence, "Ann Marsh is at Fish Market, 311 m away.");
    EXPECT_NE(platform::writeJson(answer.snippet).find("VAKtrLocationSnippet"), std::string::npos);
    ASSERT_EQ(service.sent.size(), 1U);
    EXPECT_EQ(service.sent.front().command, "getlocations");
    EXPECT_EQ(platform::writeJson(*service.sent.front().members.find("handles")), R"(["ann@harbour.example"])");
}

TEST_F(EngineTest, ServiceAndDistances_AreAskedInTheLanguageOfTheQuestion) {
    question.position = Position{1.0, 1.0, {}};
    service.answer = [](const std::string&, const Dictionary&) {
        Dictionary ann = entry(1.001, 1.0, 10.0, "Fish Market");
        ann.set("distanceInMeters", "310.52");
        return locations({{"ann@harbour.example", ann}});
    };
    question.language = "de-AT";
    ask("Wo ist Ann?");
    EXPECT_EQ(distanceLanguages, std::vector<std::string>({"de-AT"}));
    // Whom there are no words for is answered in English throughout.
    question.language = "xx";
    ask("Where is Ann?");
    ask("Who is near the harbour?");
    ask("Hide my location");
    ASSERT_EQ(service.sent.size(), 5U);
    EXPECT_EQ(service.sent[0].language, "de-AT");
    for (std::size_t i = 1; i < service.sent.size(); ++i) {
        EXPECT_EQ(service.sent[i].language, "en") << service.sent[i].command;
    }
}

TEST_F(EngineTest, WhereTheRowGoesOnChanging_TheSentenceSaysWhenItWasTrue) {
    service.answer = [](const std::string&, const Dictionary&) {
        return locations({{"ann@harbour.example", entry(1.0, 1.0, 10.0, "Fish Market")}});
    };
    question.isLive = true;
    EXPECT_EQ(ask("Where is Ann?").sentence.rfind("At ", 0), 0U);
    question.isLive = false;
    EXPECT_EQ(ask("Where is Ann?").sentence, "Ann Marsh is at Fish Market.");
}

TEST_F(EngineTest, AnOldPlace_IsSaidWithItsTime) {
    service.answer = [](const std::string&, const Dictionary&) {
        return locations({{"ann@harbour.example", entry(1.0, 1.0, 3000.0, "Fish Market")}});
    };
    const Answer answer = ask("Where is Ann?");
    EXPECT_NE(answer.sentence.find("was at Fish Market"), std::string::npos) << answer.sentence;
    EXPECT_DOUBLE_EQ(answer.ageSeconds.value_or(0.0), 3000.0);
}

TEST_F(EngineTest, RightNow_AsksForANewerPlace_AndSaysSinceWhen) {
    service.answer = [](const std::string&, const Dictionary&) {
        ServiceReply reply = locations({{"ann@harbour.example", entry(1.0, 1.0, 600.0, "Fish Market")}});
        reply.body.set("asked", Dictionary{{"ann@harbour.example",
                                            (kNow - 120.0 + platform::kSecondsFrom1970ToReferenceDate) * 1000.0}});
        return reply;
    };
    const std::string now = ask("Where is Ann right now?").sentence;
    EXPECT_NE(now.find("was at Fish Market. A newer place was asked for at "), std::string::npos) << now;
    ASSERT_EQ(service.sent.size(), 1U);
    EXPECT_EQ(platform::writeJson(*service.sent.front().members.find("fresh")), "true");
    EXPECT_NE(ask("How far away is Ann right now?").sentence.find("A newer place"), std::string::npos);
    EXPECT_NE(ask("Is Ann at the Fish Market right now?").sentence.find("A newer place"), std::string::npos);
}

TEST_F(EngineTest, RightNow_OfAPlaceOfNow_SaysNothingOfANewerOne) {
    service.answer = [](const std::string&, const Dictionary&) {
        ServiceReply reply = locations({{"ann@harbour.example", entry(1.0, 1.0, 20.0, "Fish Market")}});
        reply.body.set(
            "asked", Dictionary{{"ann@harbour.example", (kNow + platform::kSecondsFrom1970ToReferenceDate) * 1000.0}});
        return reply;
    };
    EXPECT_EQ(ask("Where is Ann right now?").sentence, "Ann Marsh is at Fish Market.");
    question.isLive = true;
    EXPECT_EQ(ask("Where is Ann right now?").sentence.find("newer"), std::string::npos);
}

TEST_F(EngineTest, ServiceThatAsksNobody_IsNotSaidToHaveAsked) {
    service.answer = [](const std::string&, const Dictionary&) {
        ServiceReply reply = locations({{"ann@harbour.example", entry(1.0, 1.0, 600.0, "Fish Market")}});
        reply.body.set("asked", Dictionary{{"otto@mail.example", 1.0}, {"ann@harbour.example", "soon"}});
        return reply;
    };
    EXPECT_EQ(ask("Where is Ann right now?").sentence.find("newer"), std::string::npos);
}

TEST_F(EngineTest, OnlyWhoMayChangeSomething_AndNamesSomebody_MakesAPhoneWork) {
    service.answer = [](const std::string&, const Dictionary&) {
        return locations({{"ann@harbour.example", entry(1.0, 1.0, 600.0, "Fish Market")}});
    };
    ask("Where is Ann now?");
    ask("Where are my friends right now?");
    question.mayChange = false;
    EXPECT_EQ(ask("Where is Ann right now?").outcome, Outcome::Found);
    ASSERT_EQ(service.sent.size(), 3U);
    for (const auto& sent : service.sent) {
        EXPECT_EQ(sent.members.find("fresh"), nullptr);
    }
}

TEST_F(EngineTest, WhoeverIsNotSeen_IsNotToldApartFromWhomNobodyKnows) {
    std::vector<std::string> answers;
    for (const Dictionary& entries :
         {Dictionary(), Dictionary{{"ann@harbour.example", Dictionary{{"status", 411}, {"location", Value()}}}},
          Dictionary{{"ann@harbour.example", Dictionary{{"status", 200}, {"location", Value()}}}},
          Dictionary{{"ann@harbour.example", entry(0.0, 0.0, 1.0)}}}) {
        service.answer = [&](const std::string&, const Dictionary&) { return locations(entries); };
        const Answer answer = ask("Where is Ann?");
        EXPECT_EQ(answer.outcome, Outcome::NotSeen);
        EXPECT_TRUE(answer.snippet.isNull());
        answers.push_back(platform::writeJson(objectOf(answer)));
    }
    EXPECT_EQ(answers, std::vector<std::string>(answers.size(), answers.front()));
}

TEST_F(EngineTest, OfSeveral_ThoseNotSeenAreNamed) {
    service.answer = [](const std::string&, const Dictionary&) {
        return locations({{"ann@harbour.example", entry(1.0, 1.0, 10.0, "Fish Market")}});
    };
    const Answer answer = ask("Where are Ann and Otto?");
    EXPECT_EQ(answer.outcome, Outcome::Found);
    EXPECT_NE(answer.sentence.find("I can’t see where Otto Brandt is."), std::string::npos) << answer.sentence;
}

TEST_F(EngineTest, WhatTheContactsDecide_AsksNobody) {
    EXPECT_EQ(ask("Where is Xyzzy?").outcome, Outcome::UnknownPerson);
    EXPECT_EQ(ask("Where is Max?").outcome, Outcome::Ambiguous);
    EXPECT_EQ(ask("Tell me a joke").outcome, Outcome::NotUnderstood);
    isLocked = true;
    EXPECT_EQ(ask("Where is Ann?").outcome, Outcome::Locked);
    EXPECT_TRUE(service.sent.empty());
}

TEST_F(EngineTest, AChoice_AnswersWithItsOwnQuestion) {
    const Answer several = ask("Where is Max?");
    ASSERT_EQ(several.choices.size(), 2U);
    service.answer = [](const std::string&, const Dictionary&) {
        return locations({{"stone@mail.example", entry(1.0, 1.0, 1.0, "Fish Market")}});
    };
    EXPECT_EQ(ask(several.choices.back().question).outcome, Outcome::Found);
    EXPECT_EQ(platform::writeJson(*service.sent.back().members.find("handles")), R"(["stone@mail.example"])");
    const Answer near = ask("Where is Anne?");
    EXPECT_EQ(near.outcome, Outcome::UnknownPerson);
    ASSERT_EQ(near.choices.size(), 1U);
    EXPECT_EQ(near.choices.front().name, "Ann Marsh");
}

TEST_F(EngineTest, FailuresOfTheService_AreToldApart) {
    EXPECT_EQ(ask("Where is Ann?").outcome, Outcome::Unreachable);
    service.answer = [](const std::string&, const Dictionary&) {
        return ServiceReply{ServiceReply::Failure::NotSignedIn};
    };
    EXPECT_EQ(ask("Where is Ann?").outcome, Outcome::NotSignedIn);
    EXPECT_EQ(ask("Hide my location").outcome, Outcome::NotSignedIn);
}

TEST_F(EngineTest, AWish_IsOnePost) {
    service.answer = [](const std::string&, const Dictionary&) {
        return ServiceReply{ServiceReply::Failure::None, Dictionary{{"statusCode", 200}, {"hidden", true}}};
    };
    const Answer answer = ask("Hide my location");
    EXPECT_EQ(answer.sentence, "Friends can’t see where you are.");
    ASSERT_EQ(service.sent.size(), 1U);
    EXPECT_EQ(service.sent.front().command, "sharing");
    EXPECT_EQ(platform::writeJson(service.sent.front().members), R"({"wish":"hide"})");
    EXPECT_EQ(ask("Who can see me?").outcome, Outcome::Hidden);
}

TEST_F(EngineTest, WhoOnlyReads_ChangesNothing) {
    question.mayChange = false;
    for (const char* text :
         {"Hide my location", "Share my location with Ann", "Tell me when Ann leaves", "Who sees me?"}) {
        EXPECT_EQ(ask(text).outcome, Outcome::Refused) << text;
    }
    EXPECT_TRUE(service.sent.empty());
}

TEST_F(EngineTest, AFence_IsPromisedOnlyWhenTheServiceKeepsIt) {
    service.answer = [](const std::string&, const Dictionary&) { return ServiceReply{ServiceReply::Failure::Refused}; };
    const Answer refused = ask("Tell me when Otto leaves work");
    EXPECT_EQ(refused.outcome, Outcome::Refused);
    EXPECT_EQ(refused.sentence, "I can’t tell you when Otto Brandt comes or goes.");
    EXPECT_EQ(platform::writeJson(service.sent.back().members),
              R"({"handle":"otto@mail.example","trigger":"OnDeparture","place":{"name":"work"},"once":true})");
    service.answer = [](const std::string&, const Dictionary&) {
        return ServiceReply{ServiceReply::Failure::None,
                            Dictionary{{"fence", Dictionary{{"place", Dictionary{{"latitude", 1.0},
                                                                                 {"longitude", 2.0},
                                                                                 {"radius", 150.0},
                                                                                 {"name", "Work"}}}}}}};
    };
    const Answer kept = ask("Tell me when Otto leaves work");
    EXPECT_EQ(kept.outcome, Outcome::Found);
    const std::string snippet = platform::writeJson(kept.snippet);
    EXPECT_NE(snippet.find(R"("accuracy":150)"), std::string::npos) << snippet;
    EXPECT_NE(snippet.find("OnDeparture"), std::string::npos);
}

TEST_F(EngineTest, NearAPlace_ListsWhoIsNearItNearestFirst) {
    service.answer = [](const std::string& command, const Dictionary&) {
        if (command == "places") {
            return ServiceReply{
                ServiceReply::Failure::None,
                Dictionary{
                    {"places", Value::Array{Dictionary{{"name", "Harbour"}, {"latitude", 1.0}, {"longitude", 1.0}}}}}};
        }
        return locations({{"ann@harbour.example", entry(1.01, 1.0, 1.0)},
                          {"otto@mail.example", entry(1.001, 1.0, 1.0)},
                          {"stone@mail.example", entry(3.0, 1.0, 1.0)}});
    };
    EXPECT_EQ(ask("Who is near the harbour?").sentence, "Near harbour: Otto Brandt (111 m) and Ann Marsh (1113 m).");
    EXPECT_EQ(ask("Who is near Atlantis?").outcome, Outcome::NotSeen);
    EXPECT_EQ(ask("Who is closest to the harbour?").sentence, "Closest to harbour: Otto Brandt (111 m).");
}

TEST_F(EngineTest, WhetherSomebodyIsAtWork_IsSaidAsFarAsItCanBeTold) {
    const char* label = "Work";
    service.answer = [&](const std::string& command, const Dictionary&) {
        return command == "places" ? ServiceReply{ServiceReply::Failure::Refused}
                                   : locations({{"otto@mail.example", entry(1.0, 1.0, 1.0, label)}});
    };
    EXPECT_EQ(ask("Is Otto at work?").sentence, "Yes. Otto Brandt is at work.");
    label = "_$!<home>!$_";
    EXPECT_EQ(ask("Is Otto at work?").sentence, "No. Otto Brandt is at home.");
    label = "Fish Market";
    EXPECT_EQ(ask("Is Otto at work?").sentence.rfind("I can’t tell", 0), 0U);
}

TEST_F(EngineTest, ManyContacts_AreAskedForInSeveralRequestsAndNoneIsLeftOut) {
    constexpr int kMany = 2500;
    std::vector<Person> people;
    people.reserve(kMany);
    for (int i = 0; i < kMany; ++i) {
        people.push_back(
            person(("P" + std::to_string(i)).c_str(), "X", ("p" + std::to_string(i) + "@x.example").c_str()));
    }
    engine->setPeople(people);
    service.answer = [](const std::string&, const Dictionary& members) {
        const auto& handles = *members.find("handles")->array();
        EXPECT_LE(handles.size(), Engine::kMostHandles);
        return locations({{*handles.back().string(), entry(1.0, 1.0, 1.0)}});
    };
    const Answer answer = ask("Where are my friends?");
    EXPECT_EQ(service.sent.size(), 3U);
    EXPECT_NE(answer.sentence.find("P2499"), std::string::npos) << answer.sentence;
    EXPECT_NE(answer.sentence.find("P999 "), std::string::npos) << answer.sentence;
}

TEST_F(EngineTest, WordsThatSayWhereByThemselves_GetNoAt) {
    Dictionary answer = entry(1.0, 1.0, 10.0);
    const auto said = [&](const Dictionary& label, const char* street) {
        Dictionary location = *answer.find("location")->dictionary();
        location.set("labels", Value::Array{label});
        location.set("streetAddress", street);
        answer.set("location", location);
        return ask("Where is Ann?").sentence;
    };
    service.answer = [&](const std::string&, const Dictionary&) {
        return locations({{"ann@harbour.example", answer}});
    };
    EXPECT_EQ(said({{"label", "near Exeter, 40 km"}, {"phrase", true}}, ""), "Ann Marsh is near Exeter, 40 km.");
    EXPECT_EQ(said({{"label", "near Exeter"}}, ""), "Ann Marsh is at near Exeter.") << "a place of that name";
    EXPECT_EQ(said({{"label", "Quay Road, Brinmouth"}}, "Quay Road"), "Ann Marsh is on Quay Road, Brinmouth.");
    EXPECT_EQ(said({{"label", "Fish Market"}}, "Quay Road"), "Ann Marsh is at Fish Market.");
}

TEST_F(EngineTest, WhatIsReadHere_AsksNobody) {
    question.text = "Where is Ann?";
    const auto said = engine->readHere(question);
    const auto* understood = std::get_if<Understood>(&said);
    ASSERT_NE(understood, nullptr);
    ASSERT_EQ(understood->people.size(), 1U);
    EXPECT_EQ(understood->people.front()->handle(), "ann@harbour.example");
    EXPECT_EQ(understood->people.front(), &engine->people()->all().front());
    question.text = "Where is Xyzzy?";
    const auto unknown = engine->readHere(question);
    ASSERT_TRUE(std::holds_alternative<Answer>(unknown));
    EXPECT_EQ(std::get<Answer>(unknown).outcome, Outcome::UnknownPerson);
    EXPECT_TRUE(service.sent.empty());
}

TEST_F(EngineTest, QuestionWhereSomebodyIs_IsUnderstoodInItsLanguage) {
    const auto folder = std::filesystem::path(KTR_SOURCE_DIR) / "resources/questions";
    int languages = 0;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        question.language = entry.path().stem().string();
        question.text = engine->whereIs("Ann Marsh", question.language);
        const auto said = engine->readHere(question);
        const auto* understood = std::get_if<Understood>(&said);
        ASSERT_NE(understood, nullptr) << question.language << ": " << question.text;
        EXPECT_EQ(understood->meaning.wish, Wish::WhereIs) << question.text;
        ASSERT_EQ(understood->people.size(), 1U) << question.text;
        EXPECT_EQ(understood->people.front()->fullName, "Ann Marsh");
        ++languages;
    }
    EXPECT_EQ(languages, 21);
}

}  // namespace
}  // namespace ktr::ask
