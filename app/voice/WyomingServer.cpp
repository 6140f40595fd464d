#include "app/voice/WyomingServer.h"

#include <QPointer>
#include <utility>
#include <variant>

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

/// What is read of a peer before it is looked at, bytes.
constexpr qint64 kReadAhead = 16384;
/// So much may wait for a peer who does not read, bytes.
constexpr qint64 kMostUnread = 65536;

std::string textIn(const Dictionary& data, const char* name) {
    const Value* value = data.find(name);
    return value == nullptr || value->string() == nullptr ? std::string() : *value->string();
}

}  // namespace

/// One peer; lives as long as its socket.
struct WyomingServer::Connection : QObject {
    Connection(QTcpSocket* peer, int patience) : QObject(peer), socket(peer), timer(this) {
        timer.setSingleShot(true);
        timer.setInterval(patience);
    }
    QTcpSocket* socket;
    QTimer timer;
    WyomingFrames frames;
    int count = 0;
    bool isAsking = false;
};

WyomingServer::WyomingServer(Setup setup) : setup_(std::move(setup)) {
    server_.setMaxPendingConnections(static_cast<int>(kMostConnections));
    connect(&server_, &QTcpServer::newConnection, this, [this] { accept(); });
}

std::string WyomingServer::listen(const QHostAddress& address, quint16 port) {
    return server_.listen(address, port) ? "" : server_.errorString().toStdString();
}

void WyomingServer::accept() {
    while (QTcpSocket* const socket = server_.nextPendingConnection()) {
        if (connections_ >= kMostConnections || !setup_.peers.allows(socket->peerAddress())) {
            socket->abort();
            socket->deleteLater();
            continue;
        }
        ++connections_;
        socket->setReadBufferSize(kReadAhead);
        auto* const connection = new Connection(socket, setup_.patience);
        connect(connection, &QObject::destroyed, this, [this] { --connections_; });
        connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
        connect(socket, &QTcpSocket::readyRead, connection, [this, connection] { read(*connection); });
        connect(&connection->timer, &QTimer::timeout, connection, [connection] { close(*connection); });
        connection->timer.start();
        read(*connection);
    }
}

void WyomingServer::close(Connection& connection) {
    // What was said goes out, if it is taken at once.
    connection.socket->flush();
    connection.socket->abort();
    connection.socket->deleteLater();
}

void WyomingServer::read(Connection& connection) {
    // While a question is being answered the rest waits where it came from.
    while (!connection.isAsking && connection.socket->state() == QAbstractSocket::ConnectedState) {
        const auto next = connection.frames.next();
        if (const auto* frame = std::get_if<WyomingFrames::Frame>(&next)) {
            connection.timer.start();
            if (++connection.count > kMostFrames || !handle(connection, *frame)) {
                return close(connection);
            }
            continue;
        }
        if (std::holds_alternative<WyomingFrames::Broken>(next)) {
            return close(connection);
        }
        const QByteArray bytes = connection.socket->read(kReadAhead);
        if (bytes.isEmpty()) {
            return;
        }
        connection.frames.add({bytes.constData(), static_cast<std::size_t>(bytes.size())});
    }
}

bool WyomingServer::handle(Connection& connection, const WyomingFrames::Frame& frame) {
    if (frame.type == "describe") {
        const std::string line = WyomingFrames::line("info", information());
        connection.socket->write(line.data(), static_cast<qint64>(line.size()));
    } else if (frame.type == "transcript") {
        ask(connection, frame);
    }
    // A type of frame that is not known is passed over: the protocol grows.
    return connection.socket->bytesToWrite() <= kMostUnread;
}

void WyomingServer::ask(Connection& connection, const WyomingFrames::Frame& frame) {
    connection.isAsking = true;
    connection.timer.stop();
    const QPointer<Connection> peer(&connection);
    setup_.ask(textIn(frame.data, "text"), textIn(frame.data, "language"), [this, peer](const Said& said) {
        if (!peer) {
            return;
        }
        const std::string line =
            WyomingFrames::line(said.isUnderstood ? "handled" : "not-handled", Dictionary{{"text", said.text}});
        peer->socket->write(line.data(), static_cast<qint64>(line.size()));
        peer->isAsking = false;
        peer->timer.start();
        // Later: this may be inside the reading.
        QMetaObject::invokeMethod(
            peer, [this, peer] { read(*peer); }, Qt::QueuedConnection);
    });
}

Dictionary WyomingServer::information() const {
    const Dictionary attribution{{"name", "ktr"}, {"url", ""}};
    Dictionary model{{"name", "ktr"},
                     {"attribution", attribution},
                     {"installed", true},
                     {"description", ""},
                     {"version", setup_.version}};
    Dictionary program = model;
    model.set("languages", Value::Array(setup_.languages.begin(), setup_.languages.end()));
    program.set("description", "Where friends are");
    program.set("models", Value::Array{model});
    Dictionary information;
    for (const char* nothing : {"asr", "tts", "intent", "wake", "mic", "snd"}) {
        information.set(nothing, Value::Array());
    }
    information.set("handle", Value::Array{program});
    return information;
}

}  // namespace ktr::app
