#include "linux/net/AssistantClient.h"

#include <QMetaObject>
#include <QNetworkAccessManager>
#include <QNetworkProxy>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <QPointer>
#include <QTimer>
#include <utility>

#include "linux/net/OneShotBody.h"
#include "linux/net/Origin.h"
#include "linux/net/TlsTrust.h"
#include "platform/base/Json.h"

namespace ktr::linux_ {

using platform::HttpFailure;

namespace {

constexpr int kMillisecondsASecond = 1000;
constexpr qint64 kStep = 64 * 1024;

/// Where questions go; none for a host that is none.
std::optional<QUrl> urlFor(const AssistantClient::Settings& settings) {
    const auto origin = Origin::fromText(settings.host.value_or(""));
    if (!origin) {
        return std::nullopt;
    }
    QUrl url(QStringLiteral("https://") + QString::fromStdString(origin->text()) + QStringLiteral("/assistant"),
             QUrl::StrictMode);
    return url.isValid() && Origin::fromUrl(url) == origin ? std::optional(url) : std::nullopt;
}

QNetworkRequest requestFor(const QUrl& url, const AssistantClient::Settings& settings, const QSslConfiguration& tls) {
    QNetworkRequest request(url);
    request.setRawHeader("Accept", "application/json");
    request.setRawHeader("Authorization", QByteArray::fromStdString(settings.authorization.value_or("")));
    request.setRawHeader("Connection", "close");
    // A compressed answer could be small and unfold to any size.
    request.setRawHeader("Accept-Encoding", "identity");
    request.setRawHeader("Accept-Language",
                         QByteArray::fromStdString(settings.language.empty() ? "*" : settings.language));
    request.setRawHeader("User-Agent", "ktr");
    request.setSslConfiguration(tls);
    request.setHeader(QNetworkRequest::ContentTypeHeader, QStringLiteral("application/json"));
    request.setAttribute(QNetworkRequest::DoNotBufferUploadDataAttribute, true);
    request.setAttribute(QNetworkRequest::Http2AllowedAttribute, false);
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute, QNetworkRequest::ManualRedirectPolicy);
    request.setAttribute(QNetworkRequest::CookieLoadControlAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::CookieSaveControlAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::AuthenticationReuseAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::CacheLoadControlAttribute, QNetworkRequest::AlwaysNetwork);
    request.setAttribute(QNetworkRequest::CacheSaveControlAttribute, false);
    return request;
}

}  // namespace

/// One question on its way. It deletes itself when it is over.
class AssistantClient::Exchange : public QObject {
  public:
    Exchange(QNetworkReply* reply, Completion completion) : reply_(reply), completion_(std::move(completion)) {
        reply_->setParent(this);
        reply_->setReadBufferSize(kStep);
        deadline_.setSingleShot(true);
        connect(&deadline_, &QTimer::timeout, this, [this] { finish({HttpFailure::Timeout, 0, {}}); });
        connect(reply_, &QNetworkReply::sslErrors, this, [this] { tlsFailed_ = true; });
        connect(reply_, &QIODevice::readyRead, this, [this] { readSome(); });
        connect(reply_, &QNetworkReply::finished, this, [this] { replyFinished(); });
        deadline_.start(static_cast<int>(kDeadline * kMillisecondsASecond));
    }

    void finish(Answer answer) {
        if (!completion_) {
            return;
        }
        const auto completion = std::exchange(completion_, nullptr);
        reply_->disconnect(this);
        reply_->abort();
        completion(std::move(answer));
        deleteLater();
    }

  private:
    void readSome() {
        while (completion_ && reply_->bytesAvailable() > 0) {
            const QByteArray step = reply_->read(kStep);
            if (body_.size() + static_cast<std::size_t>(step.size()) > kMaximumBytes) {
                finish({HttpFailure::TooLarge, 0, {}});
                return;
            }
            body_.append(step.constData(), static_cast<std::size_t>(step.size()));
        }
    }

    void replyFinished() {
        const int status = reply_->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
        const auto error = reply_->error();
        if (tlsFailed_ || error == QNetworkReply::SslHandshakeFailedError) {
            return finish({HttpFailure::Tls, 0, {}});
        }
        if (status >= 300 && status < 400) {
            return finish({HttpFailure::RedirectRefused, status, {}});
        }
        // The library calls an answer of such a status an error; to us it is an answer.
        if (error != QNetworkReply::NoError && status < 400) {
            return finish({HttpFailure::Network, status, {}});
        }
        readSome();
        if (completion_) {
            finish({HttpFailure::None, status, status < 300 ? std::move(body_) : std::string()});
        }
    }

    QNetworkReply* reply_;
    Completion completion_;
    QTimer deadline_;
    std::string body_;
    bool tlsFailed_ = false;
};

/// What lives on the network thread.
class AssistantClient::Worker : public QObject {
  public:
    void ask(const Settings& settings, const std::string& question, Completion completion) {
        const auto url = urlFor(settings);
        if (!url || !settings.authorization) {
            completion({HttpFailure::BadRequest, 0, {}});
            return;
        }
        if (!manager_) {
            manager_ = new QNetworkAccessManager(this);
            manager_->setRedirectPolicy(QNetworkRequest::ManualRedirectPolicy);
            manager_->setProxy(QNetworkProxy(QNetworkProxy::NoProxy));
        }
        if (settings.certificateFiles != trusted_ || !prepared_) {
            trusted_ = settings.certificateFiles;
            tls_ = TlsTrust::configuration(trusted_);
            prepared_ = true;
            // A connection that waits was checked against the trust of before.
            manager_->clearConnectionCache();
        }
        // A question may be a wish: it goes once.
        auto* body = new OneShotBody(QByteArray::fromStdString(platform::writeJson({{"question", question}})));
        QNetworkRequest request = requestFor(*url, settings, tls_);
        request.setHeader(QNetworkRequest::ContentLengthHeader, body->bytesAvailable());
        QNetworkReply* reply = manager_->post(request, body);
        body->setParent(reply);
        auto* exchange = new Exchange(reply, std::move(completion));
        exchange->setParent(this);
    }

    /// Ends everything that is under way.
    void stop() {
        for (Exchange* exchange : exchanges()) {
            exchange->finish({HttpFailure::Cancelled, 0, {}});
        }
    }

  private:
    std::vector<Exchange*> exchanges() const {
        std::vector<Exchange*> found;
        for (QObject* child : children()) {
            if (auto* exchange = dynamic_cast<Exchange*>(child)) {
                found.push_back(exchange);
            }
        }
        return found;
    }

    QNetworkAccessManager* manager_ = nullptr;
    bool prepared_ = false;
    std::vector<std::string> trusted_;
    QSslConfiguration tls_;
};

AssistantClient::AssistantClient(std::function<Settings()> settings)
    : settings_(std::move(settings)), worker_(new Worker) {
    worker_->moveToThread(&thread_);
    thread_.setObjectName(QStringLiteral("ktr assistant"));
    QObject::connect(&thread_, &QThread::finished, worker_, &QObject::deleteLater);
    thread_.start();
}

AssistantClient::~AssistantClient() {
    // Queued behind the questions that were asked, so that none of them is forgotten.
    QMetaObject::invokeMethod(
        worker_,
        [worker = worker_, thread = &thread_] {
            worker->stop();
            thread->quit();
        },
        Qt::QueuedConnection);
    thread_.wait();
}

void AssistantClient::ask(const std::string& question, Completion completion) {
    QMetaObject::invokeMethod(
        worker_,
        [worker = worker_, settings = settings_(), question, completion = std::move(completion)]() mutable {
            worker->ask(settings, question, std::move(completion));
        },
        Qt::QueuedConnection);
}

}  // namespace ktr::linux_
