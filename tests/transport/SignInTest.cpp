// Signing in against servers of this process: what is sent, what is kept, and the true cause when nothing is.
#include <QCoreApplication>
#include <QDeadlineTimer>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "linux/configuration/ConfigurationFile.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/SignIn.h"
#include "linux/configuration/TokenChange.h"
#include "linux/configuration/TokenFile.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

using linux_::ServiceCheck;
using linux_::SignIn;
using Outcome = SignIn::Outcome;

class SignInTest : public TransportTest {
  protected:
    void trustTheServers() {
        std::ofstream(file) << R"({"certificates": [")" << certificates->authority().toStdString()
                            << R"("], "textSize": "XL"})";
        std::filesystem::permissions(file, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    }
    SignIn::Store keyring(bool isOpen = true) {
        return [this, isOpen](const std::string& person, const std::string& host, const std::string& secret,
                              const std::atomic<bool>&, std::string& problem) {
            kept = person + "@" + host + "=" + secret;
            problem = isOpen ? "" : "locked";
            return isOpen;
        };
    }
    SignIn::Result signIn(const SignIn::Wish& wish, bool isOpen = true) {
        SignIn one(file, keyring(isOpen));
        std::optional<SignIn::Result> result;
        one.begin(wish, [&result](const SignIn::Result& got) { result = got; });
        EXPECT_FALSE(result.has_value()) << "inside the call";
        const QDeadlineTimer deadline(30000);
        while (!result && !deadline.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
        }
        return result.value_or(SignIn::Result{});
    }
    linux_::Configuration configuration() const {
        auto read = linux_::ConfigurationReader::readFile(file);
        const auto* found = std::get_if<linux_::Configuration>(&read);
        return found == nullptr ? linux_::Configuration() : *found;
    }

    TemporaryFolder folder;
    const std::filesystem::path file = std::filesystem::path(folder.path()) / "config.json";
    /// Somebody is signed in already, with a token in a file.
    void signInBefore(const std::string& host) {
        trustTheServers();
        linux_::ConfigurationFile(file).change(
            {{"account.personId", platform::Value("otto")}, {"account.host", platform::Value(host)}});
        std::ofstream(token) << "earlier\n";
        std::filesystem::permissions(token, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    }
    std::string tokenInFile() const {
        const auto read = linux_::TokenFile::read(token);
        const auto* text = std::get_if<std::string>(&read);
        return text == nullptr ? "" : *text;
    }
    std::vector<std::string> filesBesideIt() const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(file.parent_path())) {
            names.push_back(entry.path().filename().string());
        }
        std::sort(names.begin(), names.end());
        return names;
    }

    const std::filesystem::path token = file.parent_path() / "token";
    std::string kept;
};

TEST_F(SignInTest, RightSecret_IsKeptAndTheAccountWritten) {
    serve(answering(200));
    trustTheServers();
    const auto result = signIn({" https://" + server->host() + "/ ", "mara", "s3cret"});
    EXPECT_EQ(result.outcome, Outcome::Done) << result.reason;
    EXPECT_EQ(kept, "mara@" + server->host() + "=s3cret");
    const auto now = configuration();
    ASSERT_TRUE(now.account);
    EXPECT_EQ(now.account->personId, "mara");
    EXPECT_EQ(now.account->host, server->host());
    EXPECT_TRUE(now.textSize) << "the rest stays";
    std::ifstream stream(file);
    EXPECT_EQ(std::string(std::istreambuf_iterator<char>(stream), {}).find("s3cret"), std::string::npos);
    ASSERT_EQ(server->requests().size(), 1U);
    EXPECT_NE(server->requests()[0].head.find("POST /qloxservice/friends/va/getlocations "), std::string::npos);
    EXPECT_EQ(server->requests()[0].body, R"({"clientContext":{},"handles":[]})") << "nobody is shown or asked for";
}

TEST_F(SignInTest, WrongSecret_SaysSoAndKeepsNothing) {
    serve(answering(401, "", R"({"statusCode":401})"));
    trustTheServers();
    EXPECT_EQ(signIn({server->host(), "mara", "wrong"}).outcome, Outcome::Unknown);
    EXPECT_EQ(kept, "");
    EXPECT_FALSE(configuration().account);
}

TEST_F(SignInTest, EachOtherTrouble_HasItsOwnCause) {
    trustTheServers();
    serve(answering(401, "WWW-Authenticate: Basic\r\n", "<html>Router</html>"));
    EXPECT_EQ(signIn({server->host(), "mara", "s"}).outcome, Outcome::NoService) << "a page of somebody else's";
    serve(answering(404));
    EXPECT_EQ(signIn({server->host(), "mara", "s"}).outcome, Outcome::NoService);
    serve(answering(200, "", "<html>Welcome</html>"));
    EXPECT_EQ(signIn({server->host(), "mara", "s"}).outcome, Outcome::NoService);
    serve(answering(503, "", R"({"statusCode":503})"));
    EXPECT_EQ(signIn({server->host(), "mara", "s"}).outcome, Outcome::Failing);
    serve(tls("wrongname"), answering(200));
    EXPECT_EQ(signIn({server->host(), "mara", "s"}).outcome, Outcome::NotTrusted);
    EXPECT_EQ(server->posts(), 0U) << "the secret did not leave";
    const std::string gone = server->host();
    server = nullptr;
    EXPECT_EQ(signIn({gone, "mara", "s"}).outcome, Outcome::NothingAnswers);
    EXPECT_EQ(signIn({"http://" + gone, "mara", "s"}).outcome, Outcome::BadAddress) << "never plain text";
    EXPECT_EQ(signIn({"no host at all", "mara", "s"}).outcome, Outcome::BadAddress);
    EXPECT_EQ(kept, "");
    EXPECT_FALSE(configuration().account);
}

TEST_F(SignInTest, ClosedKeyring_IsSaidAndAFileIsTheChoice) {
    serve(answering(200));
    trustTheServers();
    EXPECT_EQ(signIn({server->host(), "mara", "s3cret"}, false).outcome, Outcome::NoKeyring);
    EXPECT_FALSE(configuration().account);
    EXPECT_FALSE(std::filesystem::exists(token)) << "only where it is wished";
    const auto result = signIn({server->host(), "mara", "s3cret", SignIn::Place::File}, false);
    EXPECT_EQ(result.outcome, Outcome::Done) << result.reason;
    const auto read = linux_::TokenFile::read(token);
    ASSERT_TRUE(std::holds_alternative<std::string>(read));
    EXPECT_EQ(std::get<std::string>(read), "s3cret");
    EXPECT_TRUE(configuration().account);
}

TEST_F(SignInTest, ConfigurationThatCannotBeWritten_LeavesTheEarlierTokenToItsAccount) {
    serve(answering(200));
    signInBefore("elsewhere.example");
    std::filesystem::remove(file.string() + ".lock");
    std::filesystem::create_directory(file.string() + ".lock");
    const auto result = signIn({server->host(), "mara", "s3cret", SignIn::Place::File});
    EXPECT_EQ(result.outcome, Outcome::NotWritten);
    EXPECT_EQ(configuration().account->host, "elsewhere.example");
    EXPECT_EQ(tokenInFile(), "earlier") << "the new service's secret would be sent to the earlier one";
    EXPECT_EQ(filesBesideIt(), (std::vector<std::string>{"config.json", "config.json.lock", "token"}));
}

TEST_F(SignInTest, OtherAccount_DoesNotInheritTheTokenOfTheEarlierOne) {
    serve(answering(200));
    signInBefore("elsewhere.example");
    EXPECT_EQ(signIn({server->host(), "mara", "s3cret"}).outcome, Outcome::Done);
    EXPECT_FALSE(std::filesystem::exists(token)) << "a locked keyring would make it the new account's";
    signInBefore("elsewhere.example");
    EXPECT_EQ(signIn({server->host(), "mara", "s3cret", SignIn::Place::File}).outcome, Outcome::Done);
    EXPECT_EQ(tokenInFile(), "s3cret");
    EXPECT_EQ(filesBesideIt(), (std::vector<std::string>{"config.json", "config.json.lock", "token"}));
}

TEST_F(SignInTest, PreparedToken_IsNotFoundBeforeTheConfigurationIsThatAccounts) {
    signInBefore("elsewhere.example");
    {
        linux_::TokenChange change(token);
        EXPECT_EQ(change.prepare("s3cret"), "");
        EXPECT_EQ(tokenInFile(), "earlier");
        EXPECT_EQ(change.takeAway(), "");
        EXPECT_FALSE(std::filesystem::exists(token));
    }
    EXPECT_EQ(tokenInFile(), "earlier") << "taken back";
    linux_::TokenChange change(token);
    EXPECT_EQ(change.prepare("s3cret"), "");
    EXPECT_EQ(change.takeAway(), "");
    EXPECT_EQ(change.finish(), "");
    EXPECT_EQ(tokenInFile(), "s3cret");
}

TEST_F(SignInTest, ServiceThatRedirectsToItself_IsAService) {
    serve([this](QSslSocket& socket, const TestServer::Request& request) {
        const bool isFirst = request.head.find("?again") == std::string::npos;
        isFirst ? answering(307, "Location: /qloxservice/friends/va/getlocations?again\r\n")(socket, request)
                : answering(200)(socket, request);
    });
    trustTheServers();
    EXPECT_EQ(signIn({server->host(), "mara", "s3cret"}).outcome, Outcome::Done);
    serve(answering(307, "Location: https://elsewhere.example/\r\n"));
    EXPECT_EQ(signIn({server->host(), "mara", "s3cret"}).outcome, Outcome::NoService) << "nobody else gets the secret";
}

TEST_F(SignInTest, CancelledSignIn_SaysAndKeepsNothing) {
    serve([](QSslSocket&, const TestServer::Request&) {});
    trustTheServers();
    {
        SignIn one(file, keyring());
        one.begin({server->host(), "mara", "s3cret"},
                  [](const SignIn::Result&) { FAIL() << "after it was cancelled"; });
        EXPECT_TRUE(one.isUnderWay());
        one.cancel();
        EXPECT_FALSE(one.isUnderWay());
    }
    QCoreApplication::processEvents();
    EXPECT_EQ(kept, "");
}

TEST_F(SignInTest, ClockOfTheService_IsComparedWithOurs) {
    linux_::HttpsAnswer answer;
    answer.status = 200;
    answer.body = "{}";
    answer.field = [](std::string_view name) {
        return name == "Date" ? std::string("Thu, 01 Jan 2026 00:00:00 GMT") : std::string();
    };
    // 2026-01-01 in seconds since 2001-01-01.
    constexpr double kThen = 9131.0 * 86400.0;
    const auto found = ServiceCheck::of(answer, 0.0, {kThen + 240.0});
    EXPECT_EQ(found.outcome, ServiceCheck::Outcome::Fine);
    ASSERT_TRUE(found.ahead);
    EXPECT_NEAR(*found.ahead, 240.0, 1.0);
    answer.field = [](std::string_view) { return std::string(); };
    EXPECT_FALSE(ServiceCheck::of(answer, 0.0, {kThen}).ahead);
}

TEST_F(SignInTest, Link_GoesIntoTheBodyOfOnePost_AndWhatItGivesIsKept) {
    serve(answering(200, "", R"({"statusCode":200,"person":"Mara","secret":"gkx4tv"})"));
    trustTheServers();
    SignIn::Wish wish;
    wish.link = " https://" + server->host() + "/me/in?link=4tvp0habc\n";
    const auto result = signIn(wish);
    EXPECT_EQ(result.outcome, Outcome::Done) << result.reason;
    EXPECT_EQ(kept, "Mara@" + server->host() + "=gkx4tv");
    EXPECT_EQ(configuration().account->personId, "Mara");
    EXPECT_EQ(configuration().account->host, server->host());
    ASSERT_EQ(server->requests().size(), 1U);
    EXPECT_TRUE(server->requests()[0].head.starts_with("POST /me/in HTTP/1.1")) << server->requests()[0].head;
    EXPECT_EQ(server->requests()[0].head.find("4tvp0habc"), std::string::npos) << "no address has it";
    EXPECT_EQ(server->requests()[0].head.find("Authorization"), std::string::npos);
    EXPECT_EQ(server->requests()[0].body, R"({"link":"4tvp0habc"})");
    std::ifstream stream(file);
    const std::string written(std::istreambuf_iterator<char>(stream), {});
    EXPECT_EQ(written.find("4tvp0habc"), std::string::npos);
    EXPECT_EQ(written.find("gkx4tv"), std::string::npos);
}

TEST_F(SignInTest, SpentLink_AndWhatIsNone_KeepNothing) {
    serve(answering(403, "", R"({"statusCode":403,"message":"the link was used before"})"));
    trustTheServers();
    SignIn::Wish wish;
    wish.link = "https://" + server->host() + "/me/in?link=4tvp0habc";
    EXPECT_EQ(signIn(wish).outcome, Outcome::Unknown);
    serve(answering(200, "", R"({"statusCode":200})"));
    wish.link = "https://" + server->host() + "/me/in?link=4tvp0habc";
    EXPECT_EQ(signIn(wish).outcome, Outcome::NoService) << "an answer that gives nothing";
    for (const char* none :
         {"http://brin.example/me/in?link=abc", "https://brin.example/me/in", "brin.example/me/in?link=a",
          "https://brin.example/me/in?link=", "https://brin.example/me/in?link=a%20b",
          "https://mara@brin.example/me/in?link=abc", "https://brin.example/in?link=abc"}) {
        wish.link = none;
        EXPECT_EQ(signIn(wish).outcome, Outcome::BadAddress) << none;
    }
    EXPECT_EQ(kept, "");
    EXPECT_FALSE(configuration().account);
}

TEST_F(SignInTest, LinkThatWasSpent_IsNotAskedForAgain_WhenOnlyTheKeyringSaidNo) {
    serve(answering(200, "", R"({"statusCode":200,"person":"Mara","secret":"gkx4tv"})"));
    trustTheServers();
    SignIn one(file, keyring(false));
    SignIn::Wish wish;
    wish.link = "https://" + server->host() + "/me/in?link=4tvp0habc";
    std::optional<SignIn::Result> result;
    const auto run = [&] {
        result.reset();
        one.begin(wish, [&result](const SignIn::Result& got) { result = got; });
        const QDeadlineTimer deadline(30000);
        while (!result && !deadline.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
        }
        return result.value_or(SignIn::Result{}).outcome;
    };
    EXPECT_EQ(run(), Outcome::NoKeyring);
    wish.place = SignIn::Place::File;
    EXPECT_EQ(run(), Outcome::Done);
    EXPECT_EQ(tokenInFile(), "gkx4tv");
    EXPECT_EQ(server->posts(), 1U) << "the service gives it once";
}

// The service gives the secret once. Whoever stops while its answer is on the way, and presses again, has it still.
TEST_F(SignInTest, LinkThatWasSpentForSomebodyWhoGaveUp_SignsInAtTheNextTry) {
    bool isSpent = false;
    const auto once = answering(200, "", R"({"statusCode":200,"person":"Mara","secret":"gkx4tv"})");
    const auto spent = answering(403, "", R"({"statusCode":403,"message":"the link was used before"})");
    serve([&](QSslSocket& socket, const TestServer::Request& request) {
        (std::exchange(isSpent, true) ? spent : once)(socket, request);
    });
    trustTheServers();
    SignIn one(file, keyring());
    SignIn::Wish wish;
    wish.link = "https://" + server->host() + "/me/in?link=4tvp0habc";
    one.begin(wish, [](const SignIn::Result&) { FAIL() << "after it was cancelled"; });
    const QDeadlineTimer deadline(30000);
    while (server->posts() == 0 && !deadline.hasExpired()) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents, 5);
    }
    one.cancel();
    std::optional<SignIn::Result> result;
    one.begin(wish, [&result](const SignIn::Result& got) { result = got; });
    while (!result && !deadline.hasExpired()) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
    }
    ASSERT_TRUE(result);
    EXPECT_EQ(result->outcome, Outcome::Done) << result->reason;
    EXPECT_EQ(kept, "Mara@" + server->host() + "=gkx4tv");
}

}  // namespace
}  // namespace ktr::test
