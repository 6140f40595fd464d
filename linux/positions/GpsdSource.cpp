#include "linux/positions/GpsdSource.h"

#include <QTcpSocket>
#include <algorithm>
#include <cmath>
#include <string>
#include <variant>

#include "documents/IsoTime.h"
#include "documents/JsonReader.h"
#include "linux/device/SystemClock.h"

namespace ktr::linux_ {

namespace {

constexpr qint64 kLongestLine = qint64{64} * 1024;
/// What a receiver that estimates no error is trusted with, metres.
constexpr double kUnknownAccuracy = 50.0;
/// A report with latitude and longitude; 1 means no fix.
constexpr int kFix2D = 2;
constexpr int kFix3D = 3;

/// NaN where there is none.
double number(const platform::Dictionary& report, const char* name) {
    const auto* value = report.find(name);
    return value != nullptr ? value->number().value_or(std::nan("")) : std::nan("");
}

std::string text(const platform::Dictionary& report, const char* name) {
    const auto* value = report.find(name);
    const auto* text = value != nullptr ? value->string() : nullptr;
    return text != nullptr ? *text : "";
}

double firstNumber(const platform::Dictionary& report, std::initializer_list<const char*> names, double otherwise) {
    for (const char* name : names) {
        if (const double value = number(report, name); !std::isnan(value)) {
            return value;
        }
    }
    return otherwise;
}

}  // namespace

GpsdSource::GpsdSource(QString host, quint16 port, std::shared_ptr<platform::MainLoop> mainLoop)
    : host_(std::move(host)), port_(port), retry_(std::move(mainLoop), [this] { connectToGpsd(); }) {}

GpsdSource::~GpsdSource() {
    GpsdSource::stop();
}

std::optional<platform::PlatformLocation::Fix> GpsdSource::fixOf(const QByteArray& line) {
    const auto read = documents::JsonReader::read({line.constData(), static_cast<std::size_t>(line.size())});
    const auto* value = std::get_if<platform::Value>(&read);
    const auto* object = value != nullptr ? value->dictionary() : nullptr;
    if (object == nullptr) {
        return std::nullopt;
    }
    const platform::Dictionary& report = *object;
    const double mode = firstNumber(report, {"mode"}, 0.0);
    if (text(report, "class") != "TPV" || mode < kFix2D) {
        return std::nullopt;
    }
    platform::PlatformLocation::Fix fix;
    fix.coordinate = {number(report, "lat"), number(report, "lon")};
    if (!platform::isValid(fix.coordinate)) {
        return std::nullopt;
    }
    // eph is one error for both directions; older receivers tell one each.
    const double eachWay = std::max(firstNumber(report, {"epx"}, -1.0), firstNumber(report, {"epy"}, -1.0));
    fix.horizontalAccuracy = firstNumber(report, {"eph"}, eachWay >= 0.0 ? eachWay : kUnknownAccuracy);
    fix.verticalAccuracy = -1.0;
    if (mode >= kFix3D) {
        fix.altitude = firstNumber(report, {"altMSL", "alt", "altHAE"}, 0.0);
        const bool known = !std::isnan(firstNumber(report, {"altMSL", "alt", "altHAE"}, std::nan("")));
        fix.verticalAccuracy = known ? firstNumber(report, {"epv"}, kUnknownAccuracy) : -1.0;
    }
    fix.course = firstNumber(report, {"track"}, -1.0);
    fix.speed = firstNumber(report, {"speed"}, -1.0);
    const auto time = documents::parseIsoTime(text(report, "time"));
    fix.timestamp = time ? time->date : SystemClock().now();
    return fix;
}

void GpsdSource::start(double) {
    if (!started_) {
        started_ = true;
        connectToGpsd();
    }
}

void GpsdSource::stop() {
    started_ = false;
    retry_.cancel();
    if (socket_) {
        // Not deleted at once: this may be a call from one of its signals.
        socket_->disconnect();
        socket_->abort();
        socket_.release()->deleteLater();
    }
}

void GpsdSource::connectToGpsd() {
    if (!started_) {
        return;
    }
    socket_ = std::make_unique<QTcpSocket>();
    QTcpSocket* socket = socket_.get();
    QObject::connect(socket, &QTcpSocket::connected, socket,
                     [socket] { socket->write("?WATCH={\"enable\":true,\"json\":true};\n"); });
    QObject::connect(socket, &QTcpSocket::readyRead, socket, [this] { read(); });
    // Comes after a connection's end and after one that never was alike.
    QObject::connect(socket, &QTcpSocket::stateChanged, socket, [this](QAbstractSocket::SocketState state) {
        if (state == QAbstractSocket::UnconnectedState) {
            lost();
        }
    });
    socket->setReadBufferSize(4 * kLongestLine);
    socket->connectToHost(host_, port_);
}

void GpsdSource::lost() {
    if (socket_) {
        socket_->disconnect();
        socket_.release()->deleteLater();
    }
    if (started_) {
        retry_.later();
    }
}

void GpsdSource::read() {
    while (socket_ && socket_->canReadLine()) {
        const QByteArray line = socket_->readLine(kLongestLine);
        if (const auto fix = fixOf(line)) {
            retry_.succeeded();
            tell(*fix);
        }
    }
    if (socket_ && socket_->bytesAvailable() >= kLongestLine && !socket_->canReadLine()) {
        // No gpsd speaks like that. The signals tell of the loss.
        socket_->abort();
    }
}

}  // namespace ktr::linux_
