#pragma once

#include <QByteArray>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QObject>
#include <QSslConfiguration>
#include <QTimer>
#include <QUrl>

#include "linux/net/ServicePolicy.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// One command on its way: a POST, and where an allowed redirect points another host, a POST there, until there is an
/// answer, a failure, or the time is over. It deletes itself once it has called its completion, exactly once. It lives
/// on the network thread. Its connections are its own: what was proven to one command, or said to it, is not another's.
class CommandExchange : public QObject {
  public:
    /// Hops that are followed.
    static constexpr int kMostRedirects = 5;

    CommandExchange(const QSslConfiguration& tls, ServicePolicy policy, platform::HttpRequest request,
                    platform::HttpTransport::Completion completion);
    ~CommandExchange() override;

    /// Sends the first POST; what cannot be sent fails inside the call.
    void start();
    /// Fails, unless there is an outcome already. Nothing is sent or read any more.
    void fail(platform::HttpFailure failure);

  private:
    void post(const QUrl& url);
    void readSome();
    void replyFinished();
    /// What the network library's outcome is to us.
    platform::HttpFailure failureOf(const QNetworkReply& reply) const;
    void followRedirect();
    void finish(platform::HttpAnswer answer);
    void dropReply();

    QNetworkAccessManager manager_;
    QSslConfiguration tls_;
    ServicePolicy policy_;
    platform::HttpRequest request_;
    platform::HttpTransport::Completion completion_;
    Origin firstOrigin_;
    Origin lastOrigin_;
    QUrl url_;
    int redirects_ = 0;
    QTimer deadline_;
    QNetworkReply* reply_ = nullptr;
    bool tlsFailed_ = false;
    QByteArray received_;
};

}  // namespace ktr::linux_
