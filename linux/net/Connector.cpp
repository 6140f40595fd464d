#include "linux/net/Connector.h"

#include <QNetworkProxy>
#include <algorithm>
#include <deque>
#include <utility>

namespace ktr::linux_ {

namespace {

/// In the resolver's order, but one of the other family after each of the first: when one family leads nowhere, the
/// other is tried second.
std::vector<QHostAddress> interleaved(const QList<QHostAddress>& found) {
    std::deque<QHostAddress> first;
    std::deque<QHostAddress> second;
    for (const QHostAddress& address : found) {
        (address.protocol() == found.front().protocol() ? first : second).push_back(address);
    }
    std::vector<QHostAddress> mixed;
    while (!first.empty() || !second.empty()) {
        for (auto* family : {&first, &second}) {
            if (!family->empty()) {
                mixed.push_back(family->front());
                family->pop_front();
            }
        }
    }
    mixed.resize(std::min(mixed.size(), Connector::kMostAddresses));
    return mixed;
}

std::string wordsFor(QAbstractSocket::SocketError error) {
    switch (error) {
        case QAbstractSocket::ConnectionRefusedError:
            return "the host refuses connections";
        case QAbstractSocket::SocketTimeoutError:
            return "the host does not answer";
        case QAbstractSocket::NetworkError:
            return "there is no way to the host";
        case QAbstractSocket::SocketResourceError:
            return "too many files are open";
        default:
            return "no connection came about";
    }
}

}  // namespace

Connector::Connector(Connected connected, Failed failed)
    : connected_(std::move(connected)), failed_(std::move(failed)), start_(this) {
    start_.setSingleShot(true);
    start_.setInterval(kStart);
    connect(&start_, &QTimer::timeout, this, [this] { tryNext(); });
}

Connector::~Connector() {
    QHostInfo::abortHostLookup(lookup_);
    for (QSslSocket* socket : underWay_) {
        socket->disconnect(this);
        socket->abort();
    }
}

void Connector::start(const std::string& host, int port) {
    port_ = static_cast<quint16>(port);
    lookup_ =
        QHostInfo::lookupHost(QString::fromStdString(host), this, [this](const QHostInfo& info) { resolved(info); });
}

void Connector::resolved(const QHostInfo& info) {
    lookup_ = -1;
    if (info.error() != QHostInfo::NoError || info.addresses().isEmpty()) {
        return fail("the host's name is not known");
    }
    waiting_ = interleaved(info.addresses());
    std::reverse(waiting_.begin(), waiting_.end());
    tryNext();
}

void Connector::tryNext() {
    start_.stop();
    if (waiting_.empty()) {
        return;
    }
    const QHostAddress address = waiting_.back();
    waiting_.pop_back();
    auto* socket = new QSslSocket(this);
    underWay_.push_back(socket);
    socket->setProxy(QNetworkProxy(QNetworkProxy::NoProxy));
    connect(socket, &QAbstractSocket::connected, this, [this, socket] {
        start_.stop();
        waiting_.clear();
        std::erase(underWay_, socket);
        for (QSslSocket* other : std::exchange(underWay_, {})) {
            other->disconnect(this);
            other->abort();
            other->deleteLater();
        }
        socket->disconnect(this);
        socket->setParent(nullptr);
        // The receiver may end this object.
        const auto connected = std::move(connected_);
        connected(socket);
    });
    // Some attempts fail while they are begun, such as without a descriptor for the socket: whoever is told may end
    // this object and the socket with it, so that the socket has to come to its end first.
    connect(
        socket, &QAbstractSocket::errorOccurred, this, [this, socket] { attemptFailed(socket); }, Qt::QueuedConnection);
    start_.start();
    socket->connectToHost(address, port_);
}

void Connector::attemptFailed(QSslSocket* socket) {
    if (std::erase(underWay_, socket) == 0) {
        return;
    }
    const std::string reason = wordsFor(socket->error());
    socket->disconnect(this);
    socket->deleteLater();
    if (!waiting_.empty()) {
        tryNext();
    } else if (underWay_.empty()) {
        fail(reason);
    }
}

void Connector::fail(const std::string& reason) {
    const auto failed = std::move(failed_);
    failed(reason);
}

}  // namespace ktr::linux_
