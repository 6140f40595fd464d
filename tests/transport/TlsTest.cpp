// Who may hear a command: only who proves to be the host.
#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

using platform::HttpFailure;

using TlsTest = TransportTest;

TEST_F(TlsTest, OnlyAGoodCertificateHearsAnything) {
    const std::pair<const char*, HttpFailure> cases[] = {
        {"good", HttpFailure::None},   {"expired", HttpFailure::Tls},    {"wrongname", HttpFailure::Tls},
        {"foreign", HttpFailure::Tls}, {"selfsigned", HttpFailure::Tls}, {"client", HttpFailure::Tls},
    };
    for (const auto& [kind, outcome] : cases) {
        serve(tls(kind), gladly());
        EXPECT_EQ(ask().failure, outcome) << kind;
        EXPECT_EQ(server->received().empty(), outcome != HttpFailure::None) << kind;
    }
}

TEST_F(TlsTest, WithoutTheDevelopmentAuthority_NothingIsTrusted) {
    serve(gladly());
    settings.certificateFiles.clear();
    EXPECT_EQ(ask().failure, HttpFailure::Tls);
    EXPECT_EQ(server->received(), "");
}

TEST_F(TlsTest, AuthorityThatCannotBeReadIsAnErrorLine) {
    const char* kLine = "certificates: /nonexistent/ca.pem: there is no such file";
    serve(gladly());
    settings.certificateFiles = {"/nonexistent/ca.pem"};
    expectErrorLine(kLine);
    EXPECT_EQ(ask().failure, HttpFailure::Tls);
    EXPECT_TRUE(log->has(platform::LogLevel::Error, kLine));
    for (const auto& line : log->lines()) {
        EXPECT_TRUE(line.text != kLine || line.category == "net") << line.category;
    }
}

TEST_F(TlsTest, Tls12And13AreSpoken) {
    for (const auto protocol : {QSsl::TlsV1_2, QSsl::TlsV1_3}) {
        auto options = tls();
        options.protocol = protocol;
        serve(options, gladly());
        EXPECT_EQ(ask().failure, HttpFailure::None);
    }
}

TEST_F(TlsTest, OlderTlsIsNot) {
    auto options = tls();
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wdeprecated-declarations"
    options.protocol = QSsl::TlsV1_1;
#pragma GCC diagnostic pop
    serve(options, gladly());
    EXPECT_NE(ask().failure, HttpFailure::None);
    EXPECT_EQ(server->received(), "");
}

TEST_F(TlsTest, Http2IsNotOffered) {
    // A server that answers no greeting hears the client's alone, where the protocols would stand that it wants to
    // speak (RFC 7301): each after its length.
    serve(TestServer::Options{}, nullptr);
    auto one = request();
    one.inactivityLimit = 0.5;
    EXPECT_NE(ask(one).failure, HttpFailure::None);
    const std::string greeting = server->received();
    ASSERT_GT(greeting.size(), 100U);
    EXPECT_EQ(greeting[0], '\x16') << "a handshake";
    EXPECT_NE(greeting.find("localhost"), std::string::npos) << "it is read as it stands";
    EXPECT_EQ(greeting.find("\x02h2"), std::string::npos);
    EXPECT_EQ(greeting.find("PRI * HTTP/2"), std::string::npos);
}

TEST_F(TlsTest, ServerWithoutTls_HearsNothing) {
    serve(TestServer::Options{}, gladly());
    auto one = request();
    one.inactivityLimit = 1.0;
    EXPECT_NE(ask(one).failure, HttpFailure::None);
    EXPECT_EQ(server->received().find("POST"), std::string::npos);
    EXPECT_EQ(server->received().find("c2VjcmV0"), std::string::npos);
}

}  // namespace
}  // namespace ktr::test
