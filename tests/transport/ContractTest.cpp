// The real transport keeps the contract that its double keeps.
#include <QTimer>

#include <atomic>

#include "tests/contract/HttpTransportContract.h"
#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

enum class End { None, Answer, Break };

/// A server that holds every command until it is told how to end it.
struct HoldingServer {
    explicit HoldingServer(const TestServer::Options& options)
        : server(options, [this](QSslSocket& socket, const TestServer::Request&) {
              auto* look = new QTimer(&socket);
              QObject::connect(look, &QTimer::timeout, &socket, [this, &socket, look] {
                  if (end == End::Answer) {
                      look->stop();
                      answerWith(socket, 200, "", R"({"a":1})");
                  } else if (end == End::Break) {
                      look->stop();
                      socket.abort();
                  }
              });
              look->start(1);
          }) {}

    std::atomic<End> end = End::None;
    TestServer server;
};

/// What tests need that are no fixtures of this suite.
class ContractSetting : public TransportTest {
  public:
    static HttpTransportUnderTest make() {
        const auto holding = std::make_shared<HoldingServer>(tls());
        linux_::QtHttpTransport::Settings settings;
        settings.serviceHost = holding->server.host();
        settings.certificateFiles = {certificates->authority().toStdString()};
        platform::HttpRequest request;
        request.scheme = "https";
        request.host = holding->server.host();
        request.path = "/x";
        request.body = "{}";
        return {std::make_shared<linux_::QtHttpTransport>([settings] { return settings; }), request,
                [holding](bool breaksOff) { holding->end = breaksOff ? End::Break : End::Answer; }};
    }

  private:
    void TestBody() override {}
};

INSTANTIATE_TEST_SUITE_P(Real, HttpTransportContract,
                         ::testing::Values(HttpTransportCase{"QtHttpTransport", &ContractSetting::make}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace
}  // namespace ktr::test
