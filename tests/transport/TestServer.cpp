#include "tests/transport/TestServer.h"

#include <QFile>
#include <QSslCertificate>
#include <QSslConfiguration>
#include <QSslKey>
#include <QTcpServer>
#include <QVariant>

#include <charconv>
#include <utility>

namespace ktr::test {

class TestServer::Listener : public QTcpServer {
  public:
    explicit Listener(TestServer& server) : server_(server) {}

  protected:
    void incomingConnection(qintptr descriptor) override {
        {
            const std::lock_guard lock(server_.mutex_);
            ++server_.connections_;
        }
        auto* socket = new QSslSocket(this);
        socket->setSocketDescriptor(descriptor);
        connect(socket, &QSslSocket::disconnected, socket, &QObject::deleteLater);
        if (server_.options_.refuses) {
            socket->abort();
            return;
        }
        connect(socket, &QSslSocket::readyRead, socket, [this, socket] { server_.arrived(*socket); });
        const auto connected = [this, socket] {
            if (server_.options_.connected) {
                server_.options_.connected(*socket);
            }
        };
        if (server_.options_.certificate.isEmpty()) {
            connected();
            return;
        }
        connect(socket, &QSslSocket::encrypted, socket, connected);
        QFile keyFile(server_.options_.key);
        keyFile.open(QIODevice::ReadOnly);
        QSslConfiguration tls = QSslConfiguration::defaultConfiguration();
        tls.setPeerVerifyMode(QSslSocket::VerifyNone);
        tls.setProtocol(server_.options_.protocol);
        tls.setPrivateKey(QSslKey(&keyFile, QSsl::Ec));
        tls.setLocalCertificateChain(QSslCertificate::fromPath(server_.options_.certificate));
        socket->setSslConfiguration(tls);
        socket->startServerEncryption();
    }

  private:
    TestServer& server_;
};

TestServer::TestServer(Options options, Behaviour behaviour)
    : options_(std::move(options)), behaviour_(std::move(behaviour)), listener_(new Listener(*this)) {
    listener_->moveToThread(&thread_);
    QObject::connect(&thread_, &QThread::finished, listener_, &QObject::deleteLater);
    thread_.start();
    QMetaObject::invokeMethod(
        listener_,
        [this] {
            listener_->listen(QHostAddress::LocalHost);
            port_ = listener_->serverPort();
        },
        Qt::BlockingQueuedConnection);
}

TestServer::~TestServer() {
    thread_.quit();
    thread_.wait();
}

void TestServer::arrived(QSslSocket& socket) {
    std::string text = socket.property("text").toByteArray().toStdString();
    const std::string more = socket.readAll().toStdString();
    text += more;
    {
        const std::lock_guard lock(mutex_);
        received_ += more;
    }
    const auto end = text.find("\r\n\r\n");
    const auto length = text.find("Content-Length: ");
    std::size_t size = 0;
    if (length != std::string::npos && length < end) {
        std::from_chars(text.data() + length + 16, text.data() + text.size(), size);
    }
    if (end == std::string::npos || text.size() < end + 4 + size) {
        socket.setProperty("text", QByteArray::fromStdString(text));
        return;
    }
    socket.setProperty("text", QByteArray::fromStdString(text.substr(end + 4 + size)));
    const Request request{text.substr(0, end + 2), text.substr(end + 4, size)};
    {
        const std::lock_guard lock(mutex_);
        requests_.push_back(request);
    }
    if (behaviour_) {
        behaviour_(socket, request);
    }
}

int TestServer::connections() const {
    const std::lock_guard lock(mutex_);
    return connections_;
}

std::string TestServer::received() const {
    const std::lock_guard lock(mutex_);
    return received_;
}

std::vector<TestServer::Request> TestServer::requests() const {
    const std::lock_guard lock(mutex_);
    return requests_;
}

std::size_t TestServer::posts() const {
    const std::string text = received();
    std::size_t count = 0;
    for (auto at = text.find("POST /"); at != std::string::npos; at = text.find("POST /", at + 1)) {
        ++count;
    }
    return count;
}

void answerWith(QSslSocket& socket, int status, const std::string& fields, const std::string& body) {
    const std::string text = "HTTP/1.1 " + std::to_string(status) + " Status\r\n" + fields +
                             "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
    socket.write(QByteArray::fromStdString(text));
    socket.disconnectFromHost();
}

}  // namespace ktr::test
