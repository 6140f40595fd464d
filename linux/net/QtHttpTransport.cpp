#include "linux/net/QtHttpTransport.h"

#include <QMetaObject>
#include <QPointer>
#include <QSslConfiguration>

#include <utility>
#include <vector>

#include "linux/net/CommandExchange.h"
#include "linux/net/TlsTrust.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

const char* wordsFor(HttpFailure failure) {
    switch (failure) {
        case HttpFailure::None:
            return "no failure";
        case HttpFailure::BadRequest:
            return "it cannot be sent, or not to this host";
        case HttpFailure::Network:
            return "no connection, or a broken one";
        case HttpFailure::Tls:
            return "the host could not prove who it is";
        case HttpFailure::Timeout:
            return "it took too long";
        case HttpFailure::TooLarge:
            return "the answer is too large";
        case HttpFailure::RedirectRefused:
            return "the answer is a redirect that is not followed";
        case HttpFailure::Cancelled:
            return "cancelled";
    }
    return "";
}

}  // namespace

/// What lives on the network thread.
class QtHttpTransport::Worker : public QObject {
  public:
    void send(const Settings& settings, platform::HttpRequest request, Completion completion) {
        prepare(settings);
        auto logged = [host = request.host, completion = std::move(completion)](HttpAnswer answer) {
            if (answer.failure != HttpFailure::None) {
                platform::platformLog().line("A command to %@ failed: %@", host,
                                             platform::FormatArgument(wordsFor(answer.failure)).shown());
            }
            completion(std::move(answer));
        };
        auto* exchange = new CommandExchange(tls_, policy_, std::move(request), std::move(logged));
        exchange->setParent(this);
        std::erase_if(underWay_, [](const auto& earlier) { return earlier.isNull(); });
        underWay_.emplace_back(exchange);
        exchange->start();
    }

    /// Ends everything that is under way.
    void stop() {
        for (const auto& exchange : std::exchange(underWay_, {})) {
            if (exchange) {
                exchange->fail(HttpFailure::Cancelled);
            }
        }
    }

  private:
    void prepare(const Settings& settings) {
        if (prepared_ && settings == current_) {
            return;
        }
        prepared_ = true;
        current_ = settings;
        policy_ = ServicePolicy(settings.serviceHost.value_or(""), settings.domains);
        tls_ = TlsTrust::configuration(settings.certificateFiles);
    }

    /// Those that are over are none.
    std::vector<QPointer<CommandExchange>> underWay_;
    bool prepared_ = false;
    Settings current_;
    ServicePolicy policy_{"", {}};
    QSslConfiguration tls_;
};

QtHttpTransport::QtHttpTransport(std::function<Settings()> settings)
    : settings_(std::move(settings)), worker_(new Worker) {
    worker_->moveToThread(&thread_);
    thread_.setObjectName(QStringLiteral("ktr network"));
    QObject::connect(&thread_, &QThread::finished, worker_, &QObject::deleteLater);
    thread_.start();
}

QtHttpTransport::~QtHttpTransport() {
    // Queued behind the commands that were sent, so that none of them is forgotten.
    QMetaObject::invokeMethod(
        worker_,
        [worker = worker_, thread = &thread_] {
            worker->stop();
            thread->quit();
        },
        Qt::QueuedConnection);
    thread_.wait();
}

void QtHttpTransport::send(const platform::HttpRequest& request, Completion completion) {
    QMetaObject::invokeMethod(
        worker_,
        [worker = worker_, settings = settings_(), request, completion = std::move(completion)] {
            worker->send(settings, request, completion);
        },
        Qt::QueuedConnection);
}

}  // namespace ktr::linux_
