#include "linux/net/HttpsExchange.h"

#include <QSslError>
#include <algorithm>
#include <cmath>
#include <utility>

#include "linux/net/TlsTrust.h"

namespace ktr::linux_ {

using platform::HttpFailure;

namespace {

constexpr qint64 kStep = qint64{64} * 1024;
constexpr double kMillisecondsASecond = 1000.0;

int milliseconds(double seconds) {
    constexpr double kMost = 86'400'000.0;
    return static_cast<int>(std::clamp(std::ceil(seconds * kMillisecondsASecond), 1.0, kMost));
}

bool isToken(const std::string& text) {
    return !text.empty() && std::all_of(text.begin(), text.end(), [](char c) {
        return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '-' || c == '_';
    });
}

/// A header field that could end early would let its value write further fields.
bool isSendable(const platform::HttpHeaders::Field& field) {
    return isToken(field.first) && std::all_of(field.second.begin(), field.second.end(), [](char c) {
               return static_cast<unsigned char>(c) >= 0x20 && c != 0x7F;
           });
}

/// The statuses that mean "elsewhere", followed or not.
bool isRedirect(int status) {
    return status == 301 || status == 302 || status == 303 || status == 307 || status == 308;
}

/// Path and query as they stand in a request line.
std::string targetOf(const QUrl& url) {
    QByteArray target = url.path(QUrl::FullyEncoded).toLatin1();
    if (target.isEmpty()) {
        target = "/";
    }
    if (url.hasQuery()) {
        target += '?' + url.query(QUrl::FullyEncoded).toLatin1();
    }
    return target.toStdString();
}

}  // namespace

HttpsExchange::HttpsExchange(const QSslConfiguration& tls, HttpsRequest request, Completion completion)
    : tls_(tls), request_(std::move(request)), completion_(std::move(completion)) {
    deadline_.setSingleShot(true);
    connect(&deadline_, &QTimer::timeout, this, [this] { fail(HttpFailure::Timeout, "it took too long"); });
    inactivity_.setSingleShot(true);
    inactivity_.setInterval(milliseconds(request_.inactivityLimit));
    connect(&inactivity_, &QTimer::timeout, this, [this] {
        failHop(HttpFailure::Timeout, hasLeft_ ? "no answer came in time" : "no connection came about in time");
    });
}

HttpsExchange::~HttpsExchange() {
    dropConnection();
}

std::string HttpsExchange::objection() const {
    if (!Origin::fromUrl(request_.url)) {
        return "there is no host to ask, or its address is none";
    }
    const bool isWhole = isToken(request_.method) && targetOf(request_.url).starts_with('/') &&
                         std::all_of(request_.fields.begin(), request_.fields.end(), isSendable);
    return isWhole ? "" : "it cannot be written as a request";
}

void HttpsExchange::start() {
    if (const std::string reason = objection(); !reason.empty()) {
        fail(HttpFailure::BadRequest, reason);
        return;
    }
    deadline_.start(milliseconds(request_.deadline));
    goTo(request_.url);
}

void HttpsExchange::goTo(const QUrl& url) {
    dropConnection();
    url_ = url;
    origin_ = Origin::fromUrl(url).value_or(Origin{});
    tlsTrouble_.clear();
    parser_ = std::make_unique<AnswerParser>(request_.maximumBytes);
    hasHeard_ = false;
    connector_ = std::make_unique<Connector>([this](QSslSocket* socket) { connected(socket); },
                                             [this](const std::string& why) { failHop(HttpFailure::Network, why); });
    heard();
    connector_->start(origin_.host, origin_.port);
}

void HttpsExchange::connected(QSslSocket* socket) {
    socket_ = socket;
    socket_->setParent(this);
    heard();
    connect(socket_, &QSslSocket::sslErrors, this,
            [this](const QList<QSslError>& errors) { tlsTrouble_ = TlsTrust::reasonOf(errors); });
    connect(socket_, &QSslSocket::encrypted, this, [this] { write(); });
    connect(socket_, &QSslSocket::encryptedBytesWritten, this, [this] { heard(); });
    connect(socket_, &QIODevice::readyRead, this, [this] { readSome(); });
    connect(socket_, &QAbstractSocket::errorOccurred, this, [this] { connectionEnded(); });
    socket_->setSslConfiguration(tls_);
    socket_->setPeerVerifyName(QString::fromStdString(origin_.host));
    socket_->startClientEncryption();
}

void HttpsExchange::write() {
    heard();
    if (!TlsTrust::isFor(socket_->peerCertificate(), origin_)) {
        // The library also takes a name in the subject for one.
        failHop(HttpFailure::Tls, "its certificate is for other names");
        return;
    }
    auto fields = request_.fields;
    fields.set("Host", origin_.text());
    // A connection that has waited since the last request can break just as this one is sent, and nothing is sent
    // twice.
    fields.set("Connection", "close");
    // A compressed answer could be small and unfold to any size.
    fields.set("Accept-Encoding", "identity");
    if (!request_.body.empty() || request_.method != "GET") {
        fields.set("Content-Length", std::to_string(request_.body.size()));
    }
    std::string text = request_.method + " " + targetOf(url_) + " HTTP/1.1\r\n";
    for (const auto& [name, value] : fields) {
        text.append(name).append(": ").append(value).append("\r\n");
    }
    text += "\r\n" + request_.body;
    hasLeft_ = true;
    socket_->write(text.data(), static_cast<qint64>(text.size()));
}

void HttpsExchange::readSome() {
    heard();
    while (socket_ != nullptr && socket_->bytesAvailable() > 0) {
        const QByteArray step = socket_->read(kStep);
        if (step.isEmpty()) {
            return;
        }
        hasHeard_ = true;
        const auto state = parser_->feed({step.constData(), static_cast<std::size_t>(step.size())});
        if (request_.piece) {
            if (std::string piece = parser_->takePiece(); !piece.empty() && !request_.piece(std::move(piece))) {
                fail(HttpFailure::BadAnswer, "the answer is of no use");
                return;
            }
        }
        if (state != AnswerParser::State::Incomplete) {
            answerEnded();
            return;
        }
    }
}

void HttpsExchange::connectionEnded() {
    const auto error = socket_->error();
    if (error == QAbstractSocket::SslHandshakeFailedError || !tlsTrouble_.empty()) {
        failHop(HttpFailure::Tls, tlsTrouble_.empty() ? "the encryption could not be agreed on" : tlsTrouble_);
        return;
    }
    if (!hasLeft_) {
        failHop(HttpFailure::Network, "the connection broke before anything was sent");
        return;
    }
    if (error != QAbstractSocket::RemoteHostClosedError) {
        failHop(HttpFailure::Network, "the connection broke");
        return;
    }
    readSome();
    if (socket_ != nullptr) {
        parser_->end();
        answerEnded();
    }
}

void HttpsExchange::answerEnded() {
    if (parser_->state() != AnswerParser::State::Whole) {
        const bool isTooLarge = parser_->state() == AnswerParser::State::TooLarge;
        const auto failure = isTooLarge  ? HttpFailure::TooLarge
                             : hasHeard_ ? HttpFailure::BadAnswer
                                         : HttpFailure::Network;
        failHop(failure, parser_->trouble());
        return;
    }
    if (isRedirect(parser_->status())) {
        followRedirect();
        return;
    }
    HttpsAnswer answer;
    answer.status = parser_->status();
    answer.body = parser_->takeBody();
    answer.field = [parser = std::shared_ptr<AnswerParser>(std::move(parser_))](std::string_view name) {
        return parser->field(name);
    };
    finish(std::move(answer));
}

void HttpsExchange::followRedirect() {
    const int status = parser_->status();
    const QUrl location(QString::fromUtf8(QByteArray::fromStdString(parser_->field("Location"))), QUrl::StrictMode);
    // The other redirects would make a GET of the request.
    const bool keepsRequest = status == 307 || status == 308;
    QUrl target = url_.resolved(location);
    target.setFragment(QString());
    const auto origin = Origin::fromUrl(target);
    if (!keepsRequest || !location.isValid() || location.isEmpty() || redirects_ >= kMostRedirects || !origin ||
        !request_.mayFollow || !request_.mayFollow(*origin)) {
        HttpsAnswer answer;
        answer.failure = HttpFailure::RedirectRefused;
        answer.reason = "the answer is a redirect that is not followed";
        answer.status = status;
        finish(std::move(answer));
        return;
    }
    ++redirects_;
    goTo(target);
}

void HttpsExchange::failHop(HttpFailure failure, const std::string& reason) {
    if (hasLeft_ || fromFallback_ || !request_.fallback || *request_.fallback == origin_) {
        fail(failure, reason);
        return;
    }
    fromFallback_ = true;
    QUrl url = url_;
    url.setHost(QString::fromStdString(request_.fallback->host));
    url.setPort(request_.fallback->port);
    goTo(url);
}

void HttpsExchange::fail(HttpFailure failure, const std::string& reason) {
    HttpsAnswer answer;
    answer.failure = failure;
    answer.reason = reason;
    finish(std::move(answer));
}

void HttpsExchange::dropConnection() {
    connector_.reset();
    if (QSslSocket* socket = std::exchange(socket_, nullptr)) {
        socket->disconnect(this);
        socket->abort();
        socket->deleteLater();
    }
}

void HttpsExchange::finish(HttpsAnswer answer) {
    if (!completion_) {
        return;
    }
    deadline_.stop();
    inactivity_.stop();
    dropConnection();
    answer.origin = origin_;
    answer.fromFallback = fromFallback_;
    answer.hasLeft = hasLeft_;
    const auto completion = std::exchange(completion_, nullptr);
    completion(std::move(answer));
    deleteLater();
}

}  // namespace ktr::linux_
