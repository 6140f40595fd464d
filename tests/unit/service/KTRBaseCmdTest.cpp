#include "service/KTRBaseCmd.h"

#include <algorithm>
#include <thread>

#include "platform/base/Json.h"
#include "platform/client/KTServerInteractionController.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::Value;

class KTRBaseCmdTest : public PlatformTest {
  protected:
    static std::shared_ptr<KTRBaseCmd> make() { return platform::create<KTRBaseCmd>(&KTRBaseCmd::init); }
    /// A command that this answer came for.
    std::shared_ptr<KTRBaseCmd> answered(const Dictionary& answer) {
        const auto command = make();
        platform::KTServerInteractionController().sendCommand(command, nullptr);
        transport->answer(answer);
        time->runPosted();
        return command;
    }
    static std::string contextText() { return platform::writeJson(*KTRBaseCmd::staticClientContext()); }
};

TEST_F(KTRBaseCmdTest, SchemeCredentialsAndHostComeFromTheAccount) {
    const auto command = make();
    EXPECT_EQ(command->scheme(), "https");
    EXPECT_EQ(command->userName(), "person-1");
    EXPECT_EQ(command->password(), "token-1");
    EXPECT_EQ(command->host(), "service.example.org");
}

TEST_F(KTRBaseCmdTest, RememberedHostWinsUntilFlushed) {
    preferences->setValue("RedirectedHostKey", "shard.example.org:8443", "org.ktr.snippets");
    EXPECT_EQ(make()->host(), "shard.example.org:8443");
    preferences->setValue("RedirectedHostKey", std::nullopt, "org.ktr.snippets");
    EXPECT_EQ(make()->host(), "service.example.org");
}

TEST_F(KTRBaseCmdTest, WithoutAccount_NoHostAndNoCredentials) {
    accounts->account = nullptr;
    const auto command = make();
    EXPECT_EQ(command->host(), "");
    EXPECT_EQ(command->userName(), "");
    EXPECT_EQ(command->password(), "");
}

TEST_F(KTRBaseCmdTest, Headers_AsASet) {
    std::vector<platform::HttpHeaders::Field> fields;
    for (const auto& field : make()->headers()) {
        fields.push_back(field);
    }
    std::sort(fields.begin(), fields.end());
    const std::vector<platform::HttpHeaders::Field> expected = {
        {"Accept", "application/json"},
        {"Content-Type", "application/json"},
        {"X-Orcha-AuthScheme", "Forever"},
        {"X-Orcha-Seek-API-Ver", "4.0"},
    };
    EXPECT_EQ(fields, expected);
}

TEST_F(KTRBaseCmdTest, Body_HoldsTheClientContext) {
    EXPECT_EQ(platform::writeJson(make()->jsonBodyDictionary()),
              R"({"clientContext":{"deviceUDID":"device-1","productType":"Model 7","osVersion":"12.5",)"
              R"("buildVersion":"6.1.0-18","locale":"en-GB","countryCode":"CH","regionCode":"GB"}})");
}

TEST_F(KTRBaseCmdTest, ClientContext_LeavesOutWhatIsNotKnown) {
    deviceInformation->build = std::nullopt;
    deviceInformation->version = std::nullopt;
    geographicSettings->country = std::nullopt;
    EXPECT_EQ(contextText(), R"({"deviceUDID":"device-1","productType":"Model 7","locale":"en-GB","regionCode":"GB"})");
}

TEST_F(KTRBaseCmdTest, ClientContext_CanBeEmpty) {
    *deviceInformation = FakeDeviceInformation();
    deviceInformation->identifier = deviceInformation->product = deviceInformation->version = deviceInformation->build =
        std::nullopt;
    geographicSettings->country = std::nullopt;
    assistant->language = std::nullopt;
    region->country = std::nullopt;
    EXPECT_EQ(contextText(), "{}");
}

TEST_F(KTRBaseCmdTest, ClientContext_IsReadAndLoggedOnce) {
    const auto lines = [this] {
        const auto texts = log->texts(platform::LogLevel::Default);
        return std::count_if(texts.begin(), texts.end(), [](const std::string& text) {
            return text.starts_with("KTRVela: static client context: {");
        });
    };
    EXPECT_EQ(lines(), 0);
    const auto context = KTRBaseCmd::staticClientContext();
    assistant->language = "de-CH";
    EXPECT_EQ(KTRBaseCmd::staticClientContext(), context);
    make()->jsonBodyDictionary();
    EXPECT_EQ(lines(), 1);
}

TEST_F(KTRBaseCmdTest, ClientContext_OfACommandsBodyOnAnotherThread_IsTheOneOfTheMainThread) {
    const auto command = make();
    std::shared_ptr<const Dictionary> context;
    std::string body;
    std::thread([&] {
        context = KTRBaseCmd::staticClientContext();
        body = platform::writeJson(command->jsonBodyDictionary());
    }).join();
    EXPECT_EQ(context, KTRBaseCmd::staticClientContext());
    EXPECT_NE(body.find("device-1"), std::string::npos);
}

TEST_F(KTRBaseCmdTest, ClientContext_BelongsToThePlatform) {
    KTRBaseCmd::staticClientContext();
    platform->dropShared();
    assistant->language = "de-CH";
    EXPECT_NE(contextText().find("de-CH"), std::string::npos);
}

TEST_F(KTRBaseCmdTest, StatusCode_IsRecordedByEveryReading) {
    EXPECT_EQ(make()->statusCode(), std::nullopt);
    const auto command = answered({{"statusCode", "416"}});
    EXPECT_EQ(command->statusCode(), std::nullopt);
    EXPECT_EQ(*command->jsonResponseDictionary(), (Dictionary{{"statusCode", "416"}}));
    EXPECT_EQ(command->statusCode(), 416);
    command->setStatusCode(7);
    command->minCallbackInterval();
    EXPECT_EQ(command->statusCode(), 416);
}

TEST_F(KTRBaseCmdTest, StatusCode_MissingOrNullIsNone) {
    for (const Dictionary& answer : {Dictionary{}, Dictionary{{"statusCode", nullptr}}}) {
        const auto command = answered(answer);
        command->setStatusCode(7);
        command->jsonResponseDictionary();
        EXPECT_EQ(command->statusCode(), std::nullopt);
    }
}

TEST_F(KTRBaseCmdTest, MinCallbackInterval) {
    const auto interval = [this](const Value& milliseconds) {
        return answered({{"serverContext", Dictionary{{"minCallbackIntervalInMS", milliseconds}}}})
            ->minCallbackInterval();
    };
    EXPECT_EQ(interval(30000), 30.0);
    EXPECT_EQ(interval(1500), 1.5);
    EXPECT_EQ(interval(-1000), -1.0);
    EXPECT_EQ(interval(0.5), 0.0005);
    EXPECT_EQ(interval("2500"), 2.5);
    EXPECT_EQ(interval(nullptr), 0.0);
    EXPECT_EQ(interval(Value::Array{}), 0.0);
}

TEST_F(KTRBaseCmdTest, MinCallbackInterval_IsZeroWithoutTheMember) {
    EXPECT_EQ(make()->minCallbackInterval(), 0.0);
    EXPECT_EQ(answered({})->minCallbackInterval(), 0.0);
    EXPECT_EQ(answered({{"serverContext", nullptr}})->minCallbackInterval(), 0.0);
    EXPECT_EQ(answered({{"serverContext", "text"}})->minCallbackInterval(), 0.0);
    EXPECT_EQ(answered({{"serverContext", Dictionary{{"clientId", "c"}}}})->minCallbackInterval(), 0.0);
}

TEST_F(KTRBaseCmdTest, TheBaseHasNoResult) {
    EXPECT_EQ(answered({})->result(), std::nullopt);
}

}  // namespace
}  // namespace ktr::test
