#pragma once

#include <QObject>
#include <QSslConfiguration>
#include <QSslSocket>
#include <QTimer>
#include <QUrl>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "linux/net/AnswerParser.h"
#include "linux/net/Connector.h"
#include "linux/net/Origin.h"
#include "platform/client/HttpHeaders.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// What is asked over HTTPS.
struct HttpsRequest {
    std::string method = "GET";
    QUrl url;
    /// Asked in place of the URL's when that one cannot be reached, or cannot prove who it is, before a byte of the
    /// request has left.
    std::optional<Origin> fallback;
    /// "Host", "Content-Length", "Connection" and "Accept-Encoding" are set by the exchange.
    platform::HttpHeaders fields;
    std::string body;
    double deadline = 30.0;         ///< seconds for everything together, names, redirects and all
    double inactivityLimit = 15.0;  ///< seconds without a byte in either direction
    std::size_t maximumBytes = std::size_t{8} * 1024 * 1024;  ///< of the answer's body
    /// Gets the body of an answer with status 200 as it comes, instead of the answer; none: nobody does. On the network
    /// thread; a false ends the exchange.
    std::function<bool(std::string)> piece;
    /// Who may be sent the same request when an answer says so (307, 308); none: no redirect is followed.
    std::function<bool(const Origin&)> mayFollow;
};

/// What came of it.
struct HttpsAnswer {
    platform::HttpFailure failure = platform::HttpFailure::None;
    /// Of a failure: what is wrong, in words for a log line, without anything private.
    std::string reason;
    int status = 0;  ///< of a failed redirect too
    std::string body;
    /// Who was asked last.
    Origin origin;
    /// Whether that is the fallback, or a host that the fallback led to.
    bool fromFallback = false;
    /// Whether a byte of the request may have left.
    bool hasLeft = false;
    /// The value of a field of the header; empty without one, and with a failure.
    std::function<std::string(std::string_view name)> field = [](std::string_view) { return std::string(); };
};

/// One request and its answer over HTTPS, HTTP/1.1: everything that this program says over the network goes this way.
///
/// Sent once: a request is written to one connection of its own, after the other side has proven who it is, and never
/// again, whatever becomes of it; only where an allowed redirect says so, once more there. Bounded: each part of an
/// answer (AnswerParser), the time without a byte, and the time in all. Connections are made directly; proxies are not
/// used.
///
/// Lives on the network thread, and deletes itself once it has called its completion, exactly once.
class HttpsExchange : public QObject {
  public:
    using Completion = std::function<void(HttpsAnswer)>;
    static constexpr int kMostRedirects = 5;

    HttpsExchange(const QSslConfiguration& tls, HttpsRequest request, Completion completion);
    ~HttpsExchange() override;

    /// What cannot be sent fails inside the call.
    void start();
    /// Fails, unless there is an outcome already. Nothing is sent or read any more.
    void cancel() { fail(platform::HttpFailure::Cancelled, "cancelled"); }

  private:
    /// Why it cannot be sent; empty when it can.
    std::string objection() const;
    void goTo(const QUrl& url);
    void connected(QSslSocket* socket);
    void write();
    void readSome();
    void connectionEnded();
    void answerEnded();
    void followRedirect();
    /// This hop has failed: the fallback is asked if it may be.
    void failHop(platform::HttpFailure failure, const std::string& reason);
    void fail(platform::HttpFailure failure, const std::string& reason);
    void finish(HttpsAnswer answer);
    void dropConnection();
    void heard() { inactivity_.start(); }

    QSslConfiguration tls_;
    HttpsRequest request_;
    Completion completion_;
    QUrl url_;
    Origin origin_;
    std::unique_ptr<Connector> connector_;
    QSslSocket* socket_ = nullptr;
    std::unique_ptr<AnswerParser> parser_;
    std::string tlsTrouble_;
    int redirects_ = 0;
    bool hasLeft_ = false;
    bool hasHeard_ = false;  ///< a byte of this hop's answer
    bool fromFallback_ = false;
    QTimer deadline_;
    QTimer inactivity_;
};

}  // namespace ktr::linux_
