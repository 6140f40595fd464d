#pragma once

#include <QCoreApplication>

#include <chrono>
#include <future>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "linux/net/QtHttpTransport.h"
#include "tests/support/PlatformTest.h"
#include "tests/transport/TestCertificates.h"
#include "tests/transport/TestServer.h"

namespace ktr::test {

/// The real transport against servers of this process.
class TransportTest : public PlatformTest {
  protected:
    class Setting;

    /// Why an exchange failed is an error line; TroubleTest looks at them.
    void TearDown() override {
        http.reset();
        for (const auto& text : log->texts(platform::LogLevel::Error)) {
            if (text.starts_with("A command to ") || text.starts_with("Tiles from ") ||
                text.starts_with("The assistant at ")) {
                expectErrorLine(text);
            }
        }
        PlatformTest::TearDown();
    }

    static TestServer::Options tls(const char* kind = "good") {
        TestServer::Options options;
        options.certificate = certificates->certificate(kind);
        options.key = certificates->key();
        return options;
    }
    static TestServer::Behaviour answering(int status, const std::string& fields = "", const std::string& body = "{}") {
        return [=](QSslSocket& socket, const TestServer::Request&) { answerWith(socket, status, fields, body); };
    }
    /// A server that hears everything and answers gladly; nobody may talk to it.
    static TestServer::Behaviour gladly() { return answering(200, "", R"({"canary":true})"); }

    /// Writes the piece again and again, as fast as it is taken.
    static void pour(QSslSocket& socket, const QByteArray& piece) {
        const auto more = [&socket, piece] {
            while (socket.isOpen() && socket.bytesToWrite() + socket.encryptedBytesToWrite() < 1'000'000) {
                socket.write(piece);
            }
        };
        QObject::connect(&socket, &QSslSocket::encryptedBytesWritten, &socket, more);
        more();
    }

    void serve(TestServer::Behaviour behaviour) { serve(tls(), std::move(behaviour)); }
    void serve(TestServer::Options options, TestServer::Behaviour behaviour) {
        server = std::make_unique<TestServer>(std::move(options), std::move(behaviour));
        settings.serviceHost = server->host();
        settings.certificateFiles = {certificates->authority().toStdString()};
    }

    platform::HttpRequest request() const {
        platform::HttpRequest made;
        made.scheme = "https";
        made.host = server->host();
        made.path = "/qloxservice/friends/va/getlocations";
        made.headers = {
            {"Content-Type", "application/json"}, {"X-Custom", "custom-1"}, {"Authorization", "Basic c2VjcmV0"}};
        made.body = R"({"private":"body-1"})";
        return made;
    }
    std::future<platform::HttpAnswer> start(const platform::HttpRequest& request) {
        if (!http) {
            http = std::make_unique<linux_::QtHttpTransport>([this] { return settings; });
        }
        auto promise = std::make_shared<std::promise<platform::HttpAnswer>>();
        http->send(request, [promise](platform::HttpAnswer answer) { promise->set_value(std::move(answer)); });
        return promise->get_future();
    }
    platform::HttpAnswer ask(const platform::HttpRequest& request) {
        auto answer = start(request);
        if (answer.wait_for(std::chrono::seconds(60)) != std::future_status::ready) {
            ADD_FAILURE() << "no answer";
            return {platform::HttpFailure::Cancelled, 0, {}, {}};
        }
        return answer.get();
    }
    platform::HttpAnswer ask() { return ask(request()); }

    /// As long as tests run.
    static inline std::unique_ptr<TestCertificates> certificates;
    linux_::QtHttpTransport::Settings settings;
    std::unique_ptr<TestServer> server;
    std::unique_ptr<linux_::QtHttpTransport> http;
};

}  // namespace ktr::test
