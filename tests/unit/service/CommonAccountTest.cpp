#include "platform/base/MainLoop.h"
#include "platform/client/KTServerInteractionController.h"
#include "service/Common.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::LogLevel;

class CommonAccountTest : public PlatformTest {
  protected:
    static std::shared_ptr<Common> common() { return Common::sharedInstance(); }
    std::string remembered() const { return preferences->value("RedirectedHostKey", "org.ktr.snippets").value_or(""); }

    /// A command that was sent to `from` and has been served by `to`.
    void redirect(const std::string& from, const std::string& to) {
        const auto command = platform::create<platform::KTJSONCommand>(&platform::KTJSONCommand::init);
        command->setHost(from);
        platform::KTServerInteractionController().sendCommand(command, nullptr);
        transport->answer({platform::HttpFailure::None, 200, platform::Dictionary(), to});
    }
};

TEST_F(CommonAccountTest, AccountIsLoadedAtCreationAndNotAgain) {
    EXPECT_EQ(accounts->asked, 0);
    EXPECT_TRUE(common()->accountInfoLoaded());
    EXPECT_EQ(accounts->asked, 1);
    EXPECT_EQ(common()->personID(), "person-1");
    EXPECT_EQ(common()->username(), "ann@example.org");
    EXPECT_EQ(common()->appToken(), "token-1");
    EXPECT_EQ(common()->ktrHost(), "service.example.org");
    EXPECT_TRUE(common()->hasKTRUser());
    EXPECT_FALSE(common()->tokenIsNotAccessible());
    EXPECT_FALSE(common()->isRenewingAccountCredentials());
    accounts->account->person = "person-2";
    EXPECT_EQ(common()->personID(), "person-1");
    EXPECT_EQ(accounts->asked, 1);
}

TEST_F(CommonAccountTest, WithoutAccount_EveryLazyAccessorTriesAgain) {
    accounts->account = nullptr;
    const auto context = common();
    EXPECT_EQ(accounts->asked, 1);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(context->personID(), "");
    }
    EXPECT_EQ(accounts->asked, 4);
    EXPECT_EQ(context->username(), "");
    EXPECT_EQ(context->appToken(), "");
    EXPECT_TRUE(context->tokenIsNotAccessible());
    EXPECT_FALSE(context->hasKTRUser());
    EXPECT_EQ(accounts->asked, 8);
    EXPECT_EQ(context->ktrHost(), "");
    EXPECT_EQ(accounts->asked, 8);
}

TEST_F(CommonAccountTest, AccountThatComesLaterIsNoticed) {
    const auto account = std::exchange(accounts->account, nullptr);
    EXPECT_FALSE(common()->hasKTRUser());
    accounts->account = account;
    EXPECT_EQ(common()->ktrHost(), "");
    EXPECT_TRUE(common()->hasKTRUser());
    EXPECT_EQ(common()->ktrHost(), "service.example.org");
}

TEST_F(CommonAccountTest, AccountWithoutPersonIdentifierIsNone) {
    accounts->account->person = std::nullopt;
    EXPECT_FALSE(common()->hasKTRUser());
    EXPECT_EQ(common()->username(), "");
    EXPECT_EQ(common()->ktrHost(), "");
}

TEST_F(CommonAccountTest, LosingTheAccount_OnlyClearsTheMark) {
    const auto context = common();
    accounts->account = nullptr;
    context->loadAccountInfo();
    EXPECT_FALSE(context->hasKTRUser());
    EXPECT_EQ(context->personID(), "person-1");
    EXPECT_TRUE(context->accountInfoLoaded());
}

TEST_F(CommonAccountTest, TokenThatCannotBeRead) {
    accounts->account->token = std::nullopt;
    EXPECT_TRUE(common()->hasKTRUser());
    EXPECT_TRUE(common()->tokenIsNotAccessible());
    EXPECT_EQ(common()->appToken(), "");
    EXPECT_TRUE(common()->accountInfoLoaded());
}

TEST_F(CommonAccountTest, ClearedAccountIsReadAgainOnDemand) {
    common()->clearKTRAccount();
    EXPECT_EQ(common()->ktrHost(), "");
    EXPECT_FALSE(common()->accountInfoLoaded());
    EXPECT_EQ(common()->personID(), "person-1");
    EXPECT_EQ(accounts->asked, 2);
}

TEST_F(CommonAccountTest, OsVersion_KeepsTwoComponents) {
    const std::pair<std::optional<std::string>, std::optional<std::string>> cases[] = {
        {"17.2.1", "17.2"}, {"18", "18"}, {"18.0.1", "18.0"}, {"12.5", "12.5"},
        {"17.", "17."},     {"", ""},     {".", "."},         {std::nullopt, std::nullopt},
    };
    for (const auto& [version, shown] : cases) {
        deviceInformation->version = version;
        EXPECT_EQ(std::make_shared<Common>()->osVersion(), shown) << version.value_or("none");
    }
}

TEST_F(CommonAccountTest, OsVersion_IsReadOnce) {
    EXPECT_EQ(common()->osVersion(), "12.5");
    deviceInformation->version = "13.1";
    EXPECT_EQ(common()->osVersion(), "12.5");
}

TEST_F(CommonAccountTest, OtherDeviceFactsAreReadEveryTime) {
    EXPECT_EQ(common()->deviceUDID(), "device-1");
    EXPECT_EQ(common()->productType(), "Model 7");
    EXPECT_EQ(common()->buildVersion(), "6.1.0-18");
    deviceInformation->build = std::nullopt;
    EXPECT_EQ(common()->buildVersion(), std::nullopt);
}

TEST_F(CommonAccountTest, LockStates) {
    const std::pair<int, bool> cases[] = {{0, false}, {1, true},  {2, true},  {3, false},
                                          {4, true},  {5, false}, {-1, false}};
    for (const auto& [state, locked] : cases) {
        deviceLock->state = state;
        log->clear();
        EXPECT_EQ(common()->isLocked(), locked) << state;
        EXPECT_TRUE(log->has(LogLevel::Default, locked ? "Locked state is 1" : "Locked state is 0"));
    }
}

TEST_F(CommonAccountTest, Redirect_IsRememberedAndSynchronized) {
    EXPECT_EQ(common()->redirectedHost(), "");
    redirect("service.example.org", "shard.example.org:8443");
    EXPECT_EQ(remembered(), "shard.example.org:8443");
    EXPECT_EQ(common()->redirectedHost(), "shard.example.org:8443");
    EXPECT_EQ(preferences->synchronized, std::vector<std::string>{"org.ktr.snippets"});
    EXPECT_TRUE(log->has(LogLevel::Info, "REDIRECT: service.example.org -> shard.example.org:8443"));
}

TEST_F(CommonAccountTest, Redirect_OfSomethingElseIsIgnored) {
    const auto command = platform::create<platform::KTJSONCommand>(&platform::KTJSONCommand::init);
    common()->redirected({platform::kKTCommandRedirectedNotification, command});
    common()->redirected({platform::kKTCommandRedirectedNotification, common()});
    common()->redirected({platform::kKTCommandRedirectedNotification, nullptr});
    EXPECT_EQ(remembered(), "");
    EXPECT_TRUE(preferences->synchronized.empty());
}

TEST_F(CommonAccountTest, FlushRedirection_Removes) {
    common();
    redirect("service.example.org", "shard.example.org");
    common()->flushRedirection();
    EXPECT_EQ(common()->redirectedHost(), "");
    EXPECT_TRUE(preferences->values.empty());
    EXPECT_EQ(preferences->synchronized.size(), 2U);
}

TEST_F(CommonAccountTest, Teardown_StopsListening) {
    common();
    const auto before = platform->notificationCenter->observerCount();
    EXPECT_GE(before, 1U);
    platform->dropShared();
    EXPECT_EQ(platform->notificationCenter->observerCount(), before - 1);
}

TEST_F(CommonAccountTest, RestrictionsAreHandedOnUnchanged) {
    EXPECT_FALSE(common()->isAppRestricted());
    EXPECT_TRUE(common()->isKTRAllowed());
    restrictions->restricted = true;
    restrictions->allowed = false;
    EXPECT_TRUE(common()->isAppRestricted());
    EXPECT_FALSE(common()->isKTRAllowed());
}

TEST_F(CommonAccountTest, TheTokenIsNeverLogged) {
    common()->appToken();
    redirect("service.example.org", "shard.example.org");
    for (const std::string& line : log->texts()) {
        EXPECT_EQ(line.find("token-1"), std::string::npos) << line;
    }
}

}  // namespace
}  // namespace ktr::test
