#include "linux/configuration/ConfiguredAccountStore.h"

#include "linux/device/Buses.h"
#include "platform/client/KTJSONCommand.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RedactedLogSink.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::ConfiguredAccountStore;

class ConfiguredAccountStoreTest : public PlatformTest {
  protected:
    ConfiguredAccountStore store() {
        return ConfiguredAccountStore(folder.path() / "config.json",
                                      [this](const auto& question, std::string& problem) {
                                          asked.push_back(question.person + " " + question.host);
                                          seconds = question.seconds;
                                          problem = secretProblem;
                                          return secret;
                                      });
    }
    /// Whether anything differs from before.
    static bool load(ConfiguredAccountStore& store) {
        store.read();
        return store.take();
    }
    std::string onlyError() {
        const auto errors = log->texts(platform::LogLevel::Error);
        EXPECT_EQ(errors.size(), 1U);
        for (const std::string& line : errors) {
            expectErrorLine(line);
        }
        return errors.empty() ? "" : errors.front();
    }

    TemporaryFolder folder;
    std::optional<std::string> secret;
    std::string secretProblem;
    std::vector<std::string> asked;
    double seconds = 0.0;
};

TEST_F(ConfiguredAccountStoreTest, NoFile_NobodyIsSignedIn) {
    auto signedIn = store();
    EXPECT_FALSE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount(), nullptr);
    EXPECT_TRUE(asked.empty());
}

TEST_F(ConfiguredAccountStoreTest, WhatIsRead_CountsOnceItIsTaken) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "a.example"}})");
    secret = "token of a";
    auto signedIn = store();
    load(signedIn);
    const auto before = signedIn.deviceOwnerAccount();
    folder.write("config.json", R"({"account": {"personId": "7", "host": "b.example"}})");
    signedIn.read();
    // A command that is made now has the first host's token.
    EXPECT_EQ(signedIn.configuration().account->host, "a.example");
    EXPECT_EQ(signedIn.deviceOwnerAccount(), before);
    EXPECT_TRUE(signedIn.take());
    EXPECT_EQ(signedIn.configuration().account->host, "b.example");
    EXPECT_EQ(signedIn.deviceOwnerAccount()->hostNameOfType(0), "b.example");
    EXPECT_FALSE(signedIn.take()) << "nothing was read since";
}

TEST_F(ConfiguredAccountStoreTest, SecretService_GoesBeforeTheFile) {
    folder.write("config.json", R"({"account": {"personId": "7", "userName": "ann", "host": "f.example"}})");
    folder.write("token", "from the file\n");
    secret = "from the keyring";
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_FALSE(load(signedIn)) << "nothing changed";
    const auto account = signedIn.deviceOwnerAccount();
    ASSERT_NE(account, nullptr);
    EXPECT_EQ(account->personIdentifier(), "7");
    EXPECT_EQ(account->userName(), "ann");
    EXPECT_EQ(account->hostNameOfType(0), "f.example");
    EXPECT_EQ(account->hostNameOfType(1), std::nullopt);
    EXPECT_EQ(account->tokenOfType(0), "from the keyring");
    EXPECT_EQ(account->tokenOfType(1), std::nullopt);
    EXPECT_EQ(asked.front(), "7 f.example");
    secret = std::nullopt;
    EXPECT_TRUE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount()->tokenOfType(0), "from the file");
    EXPECT_EQ(account->tokenOfType(0), "from the keyring") << "what was handed out does not change";
}

TEST_F(ConfiguredAccountStoreTest, SecretService_IsWaitedForShortly_WhereAFileHasAToken) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    secret = "from the keyring";
    auto first = store();
    load(first);
    EXPECT_EQ(seconds, linux_::Buses::kSecretAlone);
    folder.write("token", "from the file\n");
    auto second = store();
    load(second);
    EXPECT_EQ(seconds, linux_::Buses::kSecretBesideAFile);
    EXPECT_LT(seconds, 5.0);
}

TEST_F(ConfiguredAccountStoreTest, DomainsThatAllowNobody_AreSaidOnce_Readably) {
    const auto said = std::make_shared<RedactedLogSink>();
    platform->logSink = said;
    secret = "from the keyring";
    const auto configure = [this](const std::string& domains) {
        folder.write("config.json",
                     R"({"account": {"personId": "7", "host": "f.example", "domains": )" + domains + "}}");
    };
    const auto line = [](const std::string& entry) {
        return "The entry \"" + entry +
               "\" of account.domains allows nobody: it is no host, or a domain in which anybody can have a name";
    };
    configure(R"(["co.uk", "127.0.0.1", "what is this"])");
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_EQ(said->texts(), (std::vector{line("co.uk"), line("what is this")}));
    EXPECT_FALSE(load(signedIn));
    EXPECT_EQ(said->texts().size(), 2U) << "nothing changed";
    configure(R"(["127.0.0.1"])");
    EXPECT_TRUE(load(signedIn));
    configure(R"(["org"])");
    EXPECT_TRUE(load(signedIn));
    EXPECT_EQ(said->texts().size(), 3U);
    EXPECT_EQ(said->texts().back(), line("org"));
}

TEST_F(ConfiguredAccountStoreTest, TokenAndWhatIsSentOfIt_AreKnownAsSecrets) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    secret = "first-t0ken";
    const auto known = std::make_shared<linux_::KnownSecrets>();
    auto signedIn = store();
    signedIn.setKnownSecrets(known);
    EXPECT_TRUE(load(signedIn));
    secret = "second-t0ken";
    EXPECT_TRUE(load(signedIn));
    const auto header = *platform::basicAuthorization("7", "second-t0ken");
    EXPECT_EQ(known->without("first-t0ken second-t0ken " + header), "<hidden> <hidden> Basic <hidden>");
}

TEST_F(ConfiguredAccountStoreTest, ConfigurationThatOthersMayWrite_IsRefusedWithTheRemedy) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "thief.example"}})", 0666);
    folder.write("token", "s3cret\n");
    auto signedIn = store();
    EXPECT_FALSE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount(), nullptr);
    EXPECT_NE(onlyError().find("config.json: others may write it (mode 0666); forbid it with: chmod go-w"),
              std::string::npos);
}

TEST_F(ConfiguredAccountStoreTest, SecretWithItsLineEnd_IsTheTokenWithout) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    secret = "s3cret\n";
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount()->tokenOfType(0), "s3cret");
    EXPECT_EQ(signedIn.problem(), "");
}

TEST_F(ConfiguredAccountStoreTest, SecretThatNoHeaderCanHold_IsRefusedWithoutItsText) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    folder.write("token", "from the file\n");
    secret = "s3cret\nsecond";
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount()->tokenOfType(0), std::nullopt);
    EXPECT_EQ(onlyError(), "the Secret Service's secret is refused: expected one line of at most 16 KiB");
}

TEST_F(ConfiguredAccountStoreTest, NamedTokenFile_IsTheOnlySource) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example", "tokenFile": "t"}})");
    folder.write("t", "mine", 0644);
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_TRUE(asked.empty());
    EXPECT_EQ(signedIn.deviceOwnerAccount()->tokenOfType(0), std::nullopt);
    EXPECT_NE(signedIn.problem().find("mode 0644"), std::string::npos);
    EXPECT_EQ(onlyError(), signedIn.problem());
}

TEST_F(ConfiguredAccountStoreTest, NoTokenAnywhere_SaysWhereItLooked) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    secretProblem = "no bus";
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    EXPECT_NE(signedIn.deviceOwnerAccount(), nullptr);
    EXPECT_NE(onlyError().find("the Secret Service has none (no bus), and "), std::string::npos);
}

TEST_F(ConfiguredAccountStoreTest, BrokenConfiguration_LeavesWhatWasRead) {
    folder.write("config.json", R"({"account": {"personId": "7", "host": "f.example"}})");
    secret = "s";
    auto signedIn = store();
    EXPECT_TRUE(load(signedIn));
    folder.write("config.json", R"({"account": )");
    EXPECT_FALSE(load(signedIn));
    EXPECT_EQ(signedIn.deviceOwnerAccount()->personIdentifier(), "7");
    EXPECT_NE(onlyError().find("config.json:1:"), std::string::npos);
}

}  // namespace ktr::test
