#include "host/scenario/ScenarioReader.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "host/scenario/AssistantObjectReader.h"
#include "platform/assistant/VASnippet.h"

namespace ktr::host {

namespace {

constexpr double kNow = 1000.0;

class KTRScenarioReaderTest : public ::testing::Test {
  public:
    static Scenario read(const std::string& text, const std::string& file = "folder/dinner.json") {
        const auto result = ScenarioReader({kNow}).readText(text, file);
        if (const auto* error = std::get_if<documents::DocumentError>(&result)) {
            ADD_FAILURE() << error->text();
            return {};
        }
        return std::get<Scenario>(result);
    }
    static std::string error(const std::string& text) {
        const auto result = ScenarioReader({kNow}).readText(text, "dinner.json");
        const auto* error = std::get_if<documents::DocumentError>(&result);
        return error == nullptr ? "no error" : error->text();
    }
    static std::string errorOfFile(const std::string& file) {
        const auto result = ScenarioReader({kNow}).readFile(file);
        const auto* error = std::get_if<documents::DocumentError>(&result);
        return error == nullptr ? "no error" : error->text();
    }
    static std::shared_ptr<platform::VAKtrLocationSnippet> locations(const std::string& list) {
        const Scenario scenario = read(R"({"snippet": {"kind": "VAKtrLocationSnippet", "locations": )" + list + "}}");
        return std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(scenario.snippet);
    }
    static std::string withSnippet(const std::string& members) {
        return R"({"snippet": {"kind": "VAKtrLocationSnippet"}, )" + members + "}";
    }
};

TEST_F(KTRScenarioReaderTest, Snippet_ReadsEveryProperty) {
    const auto snippet = locations(R"([{"kind": "VAKtrLocation", "latitude": 50.5, "longitude": -3, "accuracy": 25,
        "locationDate": 900.5, "label": "_$!<home>!$_", "street": "Quay", "city": "Brinmouth", "stateCode": "HB",
        "distance": 310.5, "friend": {"kind": "VAPersonAttribute", "data": "ann@harbour.example", "object":
        {"kind": "VAPerson", "fullName": "Ann Marsh", "firstName": "Ann", "lastName": "Marsh", "identifier": "id",
         "emails": [{"kind": "VAEmail", "emailAddress": "ann@harbour.example"}],
         "phones": [{"kind": "VAPhone", "number": "+441632960001"}]}}}])");
    ASSERT_TRUE(snippet);
    ASSERT_EQ(snippet->locations->size(), 1u);
    const auto& location = *snippet->locations->front();
    EXPECT_EQ(location.latitude, 50.5);
    EXPECT_EQ(location.longitude, -3.0);
    EXPECT_EQ(location.accuracy, 25.0);
    EXPECT_EQ(location.locationDate, 900.5);
    EXPECT_EQ(location.label, "_$!<home>!$_");
    EXPECT_EQ(location.street, "Quay");
    EXPECT_EQ(location.city, "Brinmouth");
    EXPECT_EQ(location.stateCode, "HB");
    EXPECT_EQ(location.distance, 310.5);
    EXPECT_EQ(location.friend_->data, "ann@harbour.example");
    const auto& person = *location.friend_->object;
    EXPECT_EQ(person.fullName, "Ann Marsh");
    EXPECT_EQ(person.firstName, "Ann");
    EXPECT_EQ(person.lastName, "Marsh");
    EXPECT_EQ(person.identifier, "id");
    EXPECT_EQ(person.emails.at(0)->emailAddress, "ann@harbour.example");
    EXPECT_EQ(person.phones.at(0)->number, "+441632960001");
}

TEST_F(KTRScenarioReaderTest, EndlessNames_AreCutAndEndlessHandlesAreNone) {
    const std::string endless(1 << 20, 'x');
    const auto snippet = locations(R"([{"label": ")" + endless + R"(", "street": ")" + endless + R"(", "city": ")" +
                                   endless + R"(", "stateCode": ")" + endless + R"(", "friend": {"data": ")" + endless +
                                   R"(", "object": {"fullName": ")" + endless + R"(", "firstName": ")" + endless +
                                   R"(", "emails": [{"emailAddress": ")" + endless + R"("}], "phones": [{"number": ")" +
                                   endless + R"("}]}}}])");
    ASSERT_TRUE(snippet);
    const std::string cut = endless.substr(0, AssistantObjectReader::kLongestText) + "\u2026";
    const auto& location = *snippet->locations->front();
    for (const auto& text : {location.label, location.street, location.city, location.stateCode,
                             location.friend_->object->fullName, location.friend_->object->firstName}) {
        EXPECT_EQ(text, cut);
    }
    EXPECT_FALSE(location.friend_->data) << "half of it would be another's";
    EXPECT_FALSE(location.friend_->object->emails.front()->emailAddress);
    EXPECT_FALSE(location.friend_->object->phones.front()->number);
}

TEST_F(KTRScenarioReaderTest, AbsentAndNull_BothReadAsNone) {
    const auto snippet = locations(R"([{}, {"latitude": null, "friend": null, "label": null, "locationDate": null}])");
    ASSERT_EQ(snippet->locations->size(), 2u);
    for (const auto& location : *snippet->locations) {
        EXPECT_FALSE(location->latitude);
        EXPECT_FALSE(location->friend_);
        EXPECT_FALSE(location->label);
        EXPECT_FALSE(location->locationDate);
    }
    EXPECT_FALSE(snippet->proximity);
    EXPECT_FALSE(snippet->searchContext);
}

TEST_F(KTRScenarioReaderTest, Sentence_MayBeTheWholeAnswer) {
    const Scenario scenario = read(R"({"question": "Tell me a joke", "sentence": "I know none."})");
    EXPECT_EQ(scenario.snippet, nullptr);
    EXPECT_EQ(scenario.sentence.text("en"), "I know none.");
}

TEST_F(KTRScenarioReaderTest, Clock_OfTheScenarioDoesNotCountInALiveConversation) {
    const auto live = ScenarioReader({kNow}, ScenarioReader::Clock::Present)
                          .readText(R"({"clock": "2001-01-01T01:00:00Z",
                              "snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"ageSeconds": 60}]}})",
                                    "live.json");
    const auto& scenario = std::get<Scenario>(live);
    EXPECT_FALSE(scenario.clock);
    const auto& snippet = dynamic_cast<platform::VAKtrLocationSnippet&>(*scenario.snippet);
    EXPECT_EQ(snippet.locations->front()->locationDate, kNow - 60.0);
}

TEST_F(KTRScenarioReaderTest, AgeSeconds_CountsBackFromTheScenariosClock) {
    const auto snippet = locations(R"([{"ageSeconds": 90}])");
    EXPECT_EQ(snippet->locations->front()->locationDate, kNow - 90.0);
    const Scenario clocked = read(
        R"({"clock": "2001-01-01T01:00:00Z", "snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"ageSeconds": 60}]}})");
    const auto& dated = dynamic_cast<platform::VAKtrLocationSnippet&>(*clocked.snippet);
    EXPECT_EQ(dated.locations->front()->locationDate, 3540.0);
}

TEST_F(KTRScenarioReaderTest, World_IsRead) {
    const Scenario scenario = read(withSnippet(
        R"("question": "Where?", "sentence": {"en": "Here.", "pt-BR": "Aqui."}, "language": "en-GB", "region": "de-CH",
        "country": "ch", "textSize": "XXXL", "idiom": "display", "clock": "2026-05-16T17:42:00+02:00", "dark": true,
        "contacts": ["people.vcf", "../all"], "positions": [{"latitude": 1, "longitude": 2},
        {"at": 30, "latitude": 3, "longitude": 4, "accuracy": 5}], "unknown": [[{}]])"));
    EXPECT_EQ(scenario.question.text("fr"), "Where?");
    EXPECT_EQ(scenario.sentence.text("pt"), "Aqui.");
    EXPECT_EQ(scenario.language, "en-GB");
    EXPECT_EQ(scenario.region, "de-CH");
    EXPECT_EQ(scenario.country, "CH");
    EXPECT_EQ(scenario.textSize, platform::ContentSizeCategory::XXXL);
    EXPECT_EQ(scenario.idiom, platform::UserInterfaceIdiom::Display);
    EXPECT_EQ(scenario.clock->offsetSeconds, 7200);
    EXPECT_EQ(scenario.dark, true);
    EXPECT_EQ(scenario.contacts, (std::vector<std::string>{"folder/people.vcf", "all"}));
    ASSERT_EQ(scenario.positions.size(), 2u);
    EXPECT_EQ(scenario.positions[0].accuracy, 10.0);
    EXPECT_EQ(scenario.positions[1].at, 30.0);
    EXPECT_EQ(scenario.positions[1].accuracy, 5.0);
}

TEST_F(KTRScenarioReaderTest, GeoFence_IsRead) {
    const Scenario scenario = read(R"({"snippet": {"kind": "VAKtrGeoFenceSnippet",
        "searchContext": "ktrServerContext://serverContext?geoFenceZoomLevel=1&", "cueKtrGeoFence": {
        "kind": "VAKtrGeoFence", "geoFenceTrigger": "OnDeparture", "friend": {"data": "ann@harbour.example"},
        "location": {"kind": "VALocation", "latitude": 50.5, "longitude": -3, "accuracy": 150, "label": "Mum's",
        "street": "Quay"}}}})");
    EXPECT_EQ(scenario.kind, "VAKtrGeoFenceSnippet");
    const auto& snippet = dynamic_cast<platform::VAKtrGeoFenceSnippet&>(*scenario.snippet);
    EXPECT_EQ(snippet.searchContext->text(), "ktrServerContext://serverContext?geoFenceZoomLevel=1&");
    const auto& fence = *snippet.cueKtrGeoFence;
    EXPECT_EQ(fence.geoFenceTrigger, "OnDeparture");
    EXPECT_EQ(fence.friend_->data, "ann@harbour.example");
    EXPECT_EQ(fence.location->latitude, 50.5);
    EXPECT_EQ(fence.location->longitude, -3.0);
    EXPECT_EQ(fence.location->accuracy, 150.0);
    EXPECT_EQ(fence.location->label, "Mum's");
    EXPECT_EQ(fence.location->street, "Quay");
}

TEST_F(KTRScenarioReaderTest, GeoFence_PartsMayBeAbsent) {
    const auto fenceOf = [](const std::string& members) {
        const Scenario scenario = read(R"({"snippet": {"kind": "VAKtrGeoFenceSnippet")" + members + "}}");
        return dynamic_cast<platform::VAKtrGeoFenceSnippet&>(*scenario.snippet).cueKtrGeoFence;
    };
    EXPECT_EQ(fenceOf(""), nullptr);
    EXPECT_EQ(fenceOf(R"(, "cueKtrGeoFence": null)"), nullptr);
    const auto fence = fenceOf(R"(, "cueKtrGeoFence": {})");
    ASSERT_NE(fence, nullptr);
    EXPECT_EQ(fence->friend_, nullptr);
    EXPECT_EQ(fence->location, nullptr);
    EXPECT_FALSE(fence->geoFenceTrigger);
}

TEST_F(KTRScenarioReaderTest, Visibility_IsRead) {
    const auto visible = [](const std::string& members) {
        const Scenario scenario = read(R"({"snippet": {"kind": "VAKtrVisibilityView")" + members + "}}");
        return dynamic_cast<platform::VAKtrVisibilityView&>(*scenario.snippet).visible;
    };
    EXPECT_TRUE(visible(R"(, "visible": true)"));
    EXPECT_FALSE(visible(R"(, "visible": false)"));
    EXPECT_FALSE(visible(""));
}

TEST_F(KTRScenarioReaderTest, Account_IsAUserName) {
    EXPECT_EQ(read(withSnippet(R"("account": {"userName": "+441632960006"})")).userName, "+441632960006");
    EXPECT_FALSE(read(withSnippet(R"("account": {})")).userName);
    EXPECT_FALSE(read(withSnippet(R"("dark": true)")).userName);
}

TEST_F(KTRScenarioReaderTest, ByteOrderMark_IsPassedOver) {
    EXPECT_EQ(read("\xEF\xBB\xBF{\"snippet\": {\"kind\": \"X\"}}").kind, "X");
}

TEST_F(KTRScenarioReaderTest, UnknownKind_IsHandedOn) {
    const Scenario scenario = read(R"({"snippet": {"kind": "VAWeather"}})");
    EXPECT_EQ(scenario.snippet->description(), "VAWeather");
    EXPECT_EQ(std::dynamic_pointer_cast<platform::VASnippet>(scenario.snippet), nullptr);
}

TEST_F(KTRScenarioReaderTest, WrongTypes_NameFilePlacePathAndExpectation) {
    EXPECT_EQ(
        error("{\"snippet\": {\"kind\": \"VAKtrLocationSnippet\", \"locations\": [{}, {},\n {\"latitude\": \"x\"}]}}"),
        "dinner.json:2:15: $.snippet.locations[2].latitude: expected a number, found a string");
    const std::pair<const char*, const char*> cases[] = {
        {R"("dark": "yes")", "$.dark: expected true or false, found a string"},
        {R"("positions": {})", "$.positions: expected a list, found an object"},
        {R"("positions": [3])", "$.positions[0]: expected an object, found a number"},
        {R"("positions": [{"latitude": 1}])", "$.positions[0]: expected a member \"longitude\""},
        {R"("positions": [{"latitude": 91, "longitude": 0}])",
         "$.positions[0].latitude: expected a number from -90 to 90"},
        {R"("positions": [{"at": -1, "latitude": 1, "longitude": 0}])",
         "$.positions[0].at: expected a number of 0 or more"},
        {R"("positions": [{"at": 9, "latitude": 1, "longitude": 0}, {"latitude": 1, "longitude": 0}])",
         "expected the positions in the order of their time"},
        {R"("question": 3)", "$.question: expected a string, or an object of one text a language, found a number"},
        {R"("question": {"en": true})", "$.question.en: expected a string, found a boolean"},
        {R"("question": {"!": "x"})", "$.question[\"!\"]: expected a language"},
        {R"("clock": "noon")", "$.clock: expected a date and time such as"},
        {R"("language": "english language")", "$.language: expected a language such as"},
        {R"("country": "GBR")", "$.country: expected a country of two letters"},
        {R"("textSize": "huge")", "$.textSize: expected one of XS"},
        {R"("idiom": "watch")", "$.idiom: expected one of phone"},
        {R"("contacts": 1)", "$.contacts: expected a string or a list of strings, found a number"},
        {R"("account": "ann")", "$.account: expected an object, found a string"},
        {R"("account": {"userName": 1})", "$.account.userName: expected a string, found a number"},
        {R"("contacts": ["a", 1])", "$.contacts[1]: expected a string, found a number"},
    };
    for (const auto& [members, expected] : cases) {
        EXPECT_NE(error(withSnippet(members)).find(expected), std::string::npos) << error(withSnippet(members));
    }
}

TEST_F(KTRScenarioReaderTest, WrongSnippets_AreTold) {
    const std::pair<const char*, const char*> cases[] = {
        {"{}", "dinner.json:1:1: $: expected a member \"snippet\""},
        {"[]", "dinner.json:1:1: $: expected an object, found a list"},
        {R"({"snippet": []})", "dinner.json:1:13: $.snippet: expected an object, found a list"},
        {R"({"snippet": {}})", "dinner.json:1:13: $.snippet: expected a member \"kind\""},
        {R"({"snippet": {"kind": "VAKtrLocationSnippet", "searchContext": "a b"}})",
         "$.snippet.searchContext: expected a URL"},
        {R"({"snippet": {"kind": "VAKtrVisibilityView", "visible": 1}})",
         "$.snippet.visible: expected true or false, found a number"},
        {R"({"snippet": {"kind": "VAKtrGeoFenceSnippet", "cueKtrGeoFence": {"location": {"kind": "VAKtrLocation"}}}})",
         "$.snippet.cueKtrGeoFence.location.kind: expected \"VALocation\", found \"VAKtrLocation\""},
        {R"({"snippet": {"kind": "VAKtrGeoFenceSnippet", "cueKtrGeoFence": {"kind": "VAFence"}}})",
         "$.snippet.cueKtrGeoFence.kind: expected \"VAKtrGeoFence\", found \"VAFence\""},
        {R"({"snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"kind": "VALocation"}]}})",
         "$.snippet.locations[0].kind: expected \"VAKtrLocation\", found \"VALocation\""},
        {R"({"snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"ageSeconds": 1, "locationDate": 2}]}})",
         "$.snippet.locations[0].ageSeconds: expected either locationDate or ageSeconds, found both"},
    };
    for (const auto& [text, expected] : cases) {
        EXPECT_NE(error(text).find(expected), std::string::npos) << error(text);
    }
}

TEST_F(KTRScenarioReaderTest, Messages_AreOneShortLineWhateverWasFound) {
    const std::string long_ = error(withSnippet("\"language\": \"a\\nb" + std::string(100'000, 'x') + "\""));
    EXPECT_LT(long_.size(), 300u);
    EXPECT_EQ(long_.find('\n'), std::string::npos);
}

TEST_F(KTRScenarioReaderTest, Files_ThatCannotBeReadAreTold) {
    EXPECT_EQ(errorOfFile("/nowhere/at/all.json"), "/nowhere/at/all.json: there is no such file");
    EXPECT_EQ(errorOfFile(std::filesystem::temp_directory_path().string()),
              std::filesystem::temp_directory_path().string() + ": this is a folder, not a file");
}

TEST_F(KTRScenarioReaderTest, DemoScenarios_AreAllReadWithoutAWarning) {
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator(KTR_SOURCE_DIR "/resources/scenarios")) {
        if (entry.path().extension() == ".json") {
            EXPECT_EQ(errorOfFile(entry.path().string()), "no error");
            documents::DocumentWarnings warnings;
            ScenarioReader({kNow}).readFile(entry.path().string(), &warnings);
            EXPECT_TRUE(warnings.empty()) << warnings.front().text();
            ++count;
        }
    }
    EXPECT_GE(count, 8);
}

TEST(KTRLocalizedTextTest, Text_PrefersTheLanguageThenItsRelativesThenEnglishThenTheFirst) {
    LocalizedText texts;
    texts.add("ja", "japanese");
    texts.add("de-AT", "austrian");
    texts.add("en", "english");
    texts.add("de", "german");
    EXPECT_EQ(texts.text("de"), "german");
    EXPECT_EQ(texts.text("DE-at"), "austrian");
    EXPECT_EQ(texts.text("de-CH"), "austrian");
    EXPECT_EQ(texts.text("fr"), "english");
    LocalizedText one;
    one.add("ja", "japanese");
    EXPECT_EQ(one.text("fr"), "japanese");
    EXPECT_EQ(LocalizedText().text("fr"), "");
}

TEST(KTRLanguageTagTest, Form_IsGroupsOfLettersAndDigits) {
    for (const char* good : {"en", "de-CH", "zh-Hant-TW", "sr-Latn", "en-001"}) {
        EXPECT_TRUE(isLanguageTag(good)) << good;
    }
    for (const char* bad : {"", "-", "en-", "-en", "en_GB", "en--GB", "1en", "abcdefghi", "e n", "é"}) {
        EXPECT_FALSE(isLanguageTag(bad)) << bad;
    }
}

}  // namespace

}  // namespace ktr::host
