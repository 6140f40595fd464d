#include "service/ShowHideLocationCmd.h"

#include "model/KTRVAMyLocation.h"
#include "platform/base/Json.h"
#include "platform/client/KTServerInteractionController.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::LogLevel;

class ShowHideLocationCmdTest : public PlatformTest {
  protected:
    /// Sends the command and answers it.
    void answer(const Dictionary& body) {
        platform::KTServerInteractionController().sendCommand(command, nullptr);
        transport->answer(body);
        time->runPosted();
    }
    std::string body() { return platform::writeJson(command->jsonBodyDictionary()); }
    std::shared_ptr<KTRVAMyLocation> record() {
        const ServiceResult found = command->result().value();
        return found.size() == 2U ? std::get<std::shared_ptr<KTRVAMyLocation>>(found[1]) : nullptr;
    }
    std::string contextUrl() const {
        return command->contextIdentifierURL() ? command->contextIdentifierURL()->text() : "none";
    }

    static constexpr const char* kDevice =
        R"("deviceUDID":"device-1","productType":"Model 7","osVersion":"12.5",)"
        R"("buildVersion":"6.1.0-18","locale":"en-GB","countryCode":"CH","regionCode":"GB")";

    std::shared_ptr<ShowHideLocationCmd> command = platform::create<ShowHideLocationCmd>(&ShowHideLocationCmd::init);
};

TEST_F(ShowHideLocationCmdTest, PathAndHeaders) {
    EXPECT_EQ(command->path(), "/qloxservice/friends/va/showHideLocation");
    EXPECT_EQ(command->headers().size(), 4U);
}

TEST_F(ShowHideLocationCmdTest, Body_ByteForByte_PositionTravelsInTheClientContext) {
    command->setCurrentLocation(position(51.5, -0.125, 12.5));
    EXPECT_EQ(body(), std::string(R"({"clientContext":{)") + kDevice +
                          R"(,"location":{"latitude":51.5,"longitude":-0.125,"source":"assistant",)"
                          R"("horizontalAccuracy":12.5,"timestamp":1768478400000}},"prefs":{"hideLocation":"No"}})");
}

TEST_F(ShowHideLocationCmdTest, Body_Hiding_SaysYesInWords_IsKept) {
    command->setHideLocation(true);
    EXPECT_NE(body().find(R"("prefs":{"hideLocation":"Yes"}})"), std::string::npos) << body();
}

TEST_F(ShowHideLocationCmdTest, Body_UnknownPositionIsSentAsZero_IsKept) {
    EXPECT_EQ(body(), std::string(R"({"clientContext":{)") + kDevice +
                          R"(,"location":{"latitude":0,"longitude":0,"source":"assistant"}},)"
                          R"("prefs":{"hideLocation":"No"}})");
}

TEST_F(ShowHideLocationCmdTest, Body_InvalidPositionIsLeftOut) {
    command->setCurrentLocation(position(91.0, 0.0));
    EXPECT_EQ(body(), std::string(R"({"clientContext":{)") + kDevice + R"(},"prefs":{"hideLocation":"No"}})");
}

TEST_F(ShowHideLocationCmdTest, SharedClientContext_IsNotTouched) {
    command->setCurrentLocation(position(51.5, -0.125));
    command->jsonBodyDictionary();
    EXPECT_FALSE(KTRBaseCmd::staticClientContext()->contains("location"));
}

TEST_F(ShowHideLocationCmdTest, Result_IsTheAnswerThenTheRecord) {
    const Dictionary sent{{"statusCode", 200},
                          {"serverContext", Dictionary{{"minCallbackIntervalInMS", 1500}}},
                          {"myInfo", Dictionary{{"preferredEmail", "work@example.org"},
                                                {"location", Dictionary{{"latitude", 51.25}, {"longitude", -1.5}}}}}};
    answer(sent);
    const ServiceResult found = command->result().value();
    ASSERT_EQ(found.size(), 2U);
    EXPECT_EQ(std::get<Dictionary>(found[0]), sent);
    const auto mine = std::get<std::shared_ptr<KTRVAMyLocation>>(found[1]);
    EXPECT_TRUE(mine->isVisible());
    EXPECT_EQ(mine->friendEmail(), "work@example.org");
    EXPECT_EQ(mine->velaLocation()->latitude, 51.25);
    EXPECT_EQ(command->statusCode(), 200);
    EXPECT_EQ(command->minCallbackInterval(), 1.5);
}

TEST_F(ShowHideLocationCmdTest, Result_Hiding_GivesAHiddenRecord) {
    command->setHideLocation(true);
    answer(Dictionary{{"myInfo", Dictionary{}}});
    EXPECT_FALSE(record()->isVisible());
}

TEST_F(ShowHideLocationCmdTest, Result_PreferredEmailGoesIntoTheContext) {
    answer(Dictionary{{"serverContext", Dictionary{{"a", "b"}}},
                      {"myInfo", Dictionary{{"preferredEmail", "work@example.org"}}}});
    record();
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?a=b&preferredEmail=work%40example.org&");
    EXPECT_TRUE(
        log->has(LogLevel::Default, "serverContextDictionary: {\"a\":\"b\",\"preferredEmail\":\"work@example.org\"}"))
        << ::testing::PrintToString(log->texts());
}

TEST_F(ShowHideLocationCmdTest, Result_WithoutContext_PreferredEmailAloneMakesOne) {
    answer(Dictionary{{"myInfo", Dictionary{{"preferredEmail", "a@b.example"}}}});
    record();
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?preferredEmail=a%40b.example&");
}

TEST_F(ShowHideLocationCmdTest, Result_ContextOfMyInfoIsNotTheAnswersContext) {
    answer(Dictionary{{"myInfo", Dictionary{{"serverContext", Dictionary{{"inner", "1"}}}}}});
    record();
    EXPECT_EQ(contextUrl(), "none");
}

TEST_F(ShowHideLocationCmdTest, Result_WithoutMyInfo_RecordKnowsTheHandleAlone) {
    for (const platform::Value& info : {platform::Value(), platform::Value("text"), platform::Value(7)}) {
        answer(Dictionary{{"serverContext", Dictionary{{"a", "b"}}}, {"myInfo", info}});
        const auto mine = record();
        ASSERT_NE(mine, nullptr);
        EXPECT_EQ(mine->friendEmail(), "ann@example.org");
        EXPECT_FALSE(mine->hasCoordinate());
        EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?a=b&");
    }
    answer(Dictionary{});
    EXPECT_NE(record(), nullptr);
    EXPECT_EQ(contextUrl(), "none");
}

TEST_F(ShowHideLocationCmdTest, Result_PreferredEmailThatIsNoTextIsNone) {
    answer(Dictionary{{"myInfo", Dictionary{{"preferredEmail", 5}}}});
    EXPECT_EQ(record()->friendEmail(), "ann@example.org");
    answer(Dictionary{{"myInfo", Dictionary{{"preferredEmail", ""}}}});
    EXPECT_EQ(record()->friendEmail(), std::nullopt) << "an empty address counts as given";
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?preferredEmail=&");
}

TEST_F(ShowHideLocationCmdTest, Result_WithoutAnswer_IsEmpty) {
    EXPECT_EQ(command->result().value().size(), 0U);
    EXPECT_EQ(contextUrl(), "none");
    platform::KTServerInteractionController().sendCommand(command, nullptr);
    transport->answer({platform::HttpFailure::None, 200, std::nullopt, {}});
    time->runPosted();
    EXPECT_EQ(command->result().value().size(), 0U);
    EXPECT_EQ(command->minCallbackInterval(), 0.0);
}

TEST_F(ShowHideLocationCmdTest, Result_IsMadeAnewAtEveryCall_AndLogged) {
    answer(Dictionary{{"myInfo", Dictionary{}}});
    log->clear();
    EXPECT_NE(record(), record());
    int lines = 0;
    for (const auto& line : log->lines()) {
        lines += line.format == "visibility_response: %@" && line.text == "visibility_response: ({\"myInfo\":{}})";
    }
    EXPECT_EQ(lines, 2) << ::testing::PrintToString(log->texts());
}

}  // namespace
}  // namespace ktr::test
