#include "linux/net/CommandExchange.h"

#include <QNetworkProxy>
#include <QNetworkRequest>

#include <algorithm>
#include <cmath>
#include <utility>
#include <variant>

#include "documents/JsonReader.h"
#include "linux/net/OneShotBody.h"

namespace ktr::linux_ {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

/// Bytes read, and buffered by the network library, at a time.
constexpr qint64 kStep = qint64{64} * 1024;
constexpr double kMillisecondsASecond = 1000.0;

int milliseconds(double seconds) {
    constexpr double kMost = 86'400'000.0;
    return static_cast<int>(std::clamp(std::ceil(seconds * kMillisecondsASecond), 1.0, kMost));
}

/// A header field that could end early would let its value write further fields.
bool isSendable(const platform::HttpHeaders::Field& field) {
    const auto isToken = [](char c) {
        return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '-' || c == '_';
    };
    const auto isText = [](char c) { return static_cast<unsigned char>(c) >= 0x20 && c != 0x7F; };
    return !field.first.empty() && std::all_of(field.first.begin(), field.first.end(), isToken) &&
           std::all_of(field.second.begin(), field.second.end(), isText);
}

bool isSuccess(int status) {
    return status >= 200 && status < 300;
}

/// The statuses that mean "elsewhere", followed or not.
bool isRedirect(int status) {
    return status == 301 || status == 302 || status == 303 || status == 307 || status == 308;
}

}  // namespace

CommandExchange::CommandExchange(const QSslConfiguration& tls, ServicePolicy policy, platform::HttpRequest request,
                                 platform::HttpTransport::Completion completion)
    : tls_(tls), policy_(std::move(policy)), request_(std::move(request)), completion_(std::move(completion)) {
    manager_.setAutoDeleteReplies(false);
    manager_.setRedirectPolicy(QNetworkRequest::ManualRedirectPolicy);
    manager_.setProxy(QNetworkProxy(QNetworkProxy::NoProxy));
    deadline_.setSingleShot(true);
    connect(&deadline_, &QTimer::timeout, this, [this] { fail(HttpFailure::Timeout); });
}

CommandExchange::~CommandExchange() {
    dropReply();
}

void CommandExchange::start() {
    const auto origin = Origin::fromText(request_.host);
    const bool sendable = origin && policy_.allows(*origin) && request_.scheme == "https" &&
                          request_.path.starts_with('/') &&
                          std::all_of(request_.headers.begin(), request_.headers.end(), isSendable);
    QUrl url(QStringLiteral("https://") + QString::fromStdString(origin ? origin->text() : "") +
                 QString::fromStdString(request_.path),
             QUrl::StrictMode);
    if (!sendable || !url.isValid() || Origin::fromUrl(url) != origin) {
        fail(HttpFailure::BadRequest);
        return;
    }
    firstOrigin_ = *origin;
    lastOrigin_ = *origin;
    deadline_.start(milliseconds(request_.deadline));
    post(url);
}

void CommandExchange::post(const QUrl& url) {
    url_ = url;
    received_.clear();
    tlsFailed_ = false;
    QNetworkRequest request(url);
    for (const auto& [name, value] : request_.headers) {
        request.setRawHeader(QByteArray::fromStdString(name), QByteArray::fromStdString(value));
    }
    request.setHeader(QNetworkRequest::ContentLengthHeader, static_cast<qlonglong>(request_.body.size()));
    // A compressed answer could be small and unfold to any size.
    request.setRawHeader("Accept-Encoding", "identity");
    request.setRawHeader("Accept-Language", "*");
    request.setRawHeader("User-Agent", "ktr");
    // A connection that has waited since the last command can break just as this one is sent, and a command is not
    // sent twice: so every command has a connection of its own.
    request.setRawHeader("Connection", "close");
    request.setSslConfiguration(tls_);
    request.setTransferTimeout(milliseconds(request_.inactivityLimit));
    request.setMaximumRedirectsAllowed(0);
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute, QNetworkRequest::ManualRedirectPolicy);
    request.setAttribute(QNetworkRequest::DoNotBufferUploadDataAttribute, true);
    request.setAttribute(QNetworkRequest::Http2AllowedAttribute, false);
    request.setAttribute(QNetworkRequest::HttpPipeliningAllowedAttribute, false);
    request.setAttribute(QNetworkRequest::CookieLoadControlAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::CookieSaveControlAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::AuthenticationReuseAttribute, QNetworkRequest::Manual);
    request.setAttribute(QNetworkRequest::CacheLoadControlAttribute, QNetworkRequest::AlwaysNetwork);
    request.setAttribute(QNetworkRequest::CacheSaveControlAttribute, false);

    auto* body = new OneShotBody(QByteArray::fromStdString(request_.body));
    reply_ = manager_.post(request, body);
    body->setParent(reply_);
    reply_->setReadBufferSize(kStep);
    connect(reply_, &QNetworkReply::sslErrors, this, [this] { tlsFailed_ = true; });
    connect(reply_, &QIODevice::readyRead, this, [this] { readSome(); });
    connect(reply_, &QNetworkReply::finished, this, [this] { replyFinished(); });
    connect(reply_, &QNetworkReply::metaDataChanged, this, [this] {
        if (reply_->header(QNetworkRequest::ContentLengthHeader).toLongLong() >
            static_cast<qlonglong>(request_.maximumBytes)) {
            fail(HttpFailure::TooLarge);
        }
    });
}

void CommandExchange::readSome() {
    while (reply_ != nullptr && reply_->bytesAvailable() > 0) {
        const QByteArray step = reply_->read(kStep);
        if (step.isEmpty()) {
            return;
        }
        if (static_cast<std::size_t>(received_.size()) + static_cast<std::size_t>(step.size()) >
            request_.maximumBytes) {
            fail(HttpFailure::TooLarge);
            return;
        }
        received_ += step;
    }
}

HttpFailure CommandExchange::failureOf(const QNetworkReply& reply) const {
    const auto error = reply.error();
    if (error == QNetworkReply::NoError) {
        return HttpFailure::None;
    }
    if (tlsFailed_ || error == QNetworkReply::SslHandshakeFailedError) {
        return HttpFailure::Tls;
    }
    if (error == QNetworkReply::OperationCanceledError || error == QNetworkReply::TimeoutError) {
        // Nobody but the inactivity limit cancels a reply that is still listened to.
        return HttpFailure::Timeout;
    }
    // The library calls an answer with such a status an error; to us it is an answer. Not that a request would have
    // had to be sent again.
    const int status = reply.attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    if (error == QNetworkReply::ContentReSendError && isRedirect(status)) {
        // It gets ready to send the body again before anybody has decided that it is sent anywhere.
        return HttpFailure::None;
    }
    const bool ofStatus = (error >= QNetworkReply::ContentAccessDenied && error <= QNetworkReply::UnknownContentError &&
                           error != QNetworkReply::ContentReSendError) ||
                          error == QNetworkReply::ProtocolInvalidOperationError ||
                          error >= QNetworkReply::InternalServerError;
    return status >= 400 && ofStatus ? HttpFailure::None : HttpFailure::Network;
}

void CommandExchange::replyFinished() {
    if (const HttpFailure failure = failureOf(*reply_); failure != HttpFailure::None) {
        fail(failure);
        return;
    }
    readSome();
    if (reply_ == nullptr) {
        return;
    }
    HttpAnswer answer;
    answer.status = reply_->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    if (isRedirect(answer.status)) {
        followRedirect();
        return;
    }
    if (isSuccess(answer.status)) {
        auto read = documents::JsonReader::read({received_.constData(), static_cast<std::size_t>(received_.size())});
        if (auto* value = std::get_if<platform::Value>(&read)) {
            answer.json = std::move(*value);
        }
    }
    finish(std::move(answer));
}

void CommandExchange::followRedirect() {
    const int status = reply_->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    const QUrl location(QString::fromUtf8(reply_->rawHeader("Location")), QUrl::StrictMode);
    // The other redirects would make a GET of the command.
    const bool keepsCommand = status == 307 || status == 308;
    QUrl target = url_.resolved(location);
    target.setFragment(QString());
    const auto origin = Origin::fromUrl(target);
    if (!keepsCommand || !location.isValid() || location.isEmpty() || redirects_ >= kMostRedirects || !origin ||
        !policy_.allows(*origin)) {
        fail(HttpFailure::RedirectRefused);
        return;
    }
    ++redirects_;
    lastOrigin_ = *origin;
    dropReply();
    post(target);
}

void CommandExchange::dropReply() {
    if (QNetworkReply* reply = std::exchange(reply_, nullptr)) {
        reply->disconnect(this);
        reply->abort();
        reply->deleteLater();
    }
}

void CommandExchange::fail(HttpFailure failure) {
    HttpAnswer answer;
    answer.failure = failure;
    finish(std::move(answer));
}

void CommandExchange::finish(HttpAnswer answer) {
    if (!completion_) {
        return;
    }
    deadline_.stop();
    dropReply();
    if (lastOrigin_ != firstOrigin_) {
        answer.redirectedHost = lastOrigin_.text();
    }
    const auto completion = std::exchange(completion_, nullptr);
    completion(std::move(answer));
    deleteLater();
}

}  // namespace ktr::linux_
