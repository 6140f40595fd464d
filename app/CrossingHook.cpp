#include "app/CrossingHook.h"

#include <QCoreApplication>
#include <QDateTime>
#include <QMessageAuthenticationCode>
#include <QTimer>
#include <QUrl>
#include <utility>

#include "platform/base/Json.h"

namespace ktr::app {

using platform::Dictionary;

namespace {

constexpr double kDeadline = 15.0;  // seconds
constexpr int kPause = 5000;        // milliseconds; more with each attempt

}  // namespace

std::string CrossingHook::objection(const std::string& url) {
    const QUrl parsed(QString::fromStdString(url), QUrl::StrictMode);
    if (!parsed.isValid() || parsed.scheme() != QLatin1String("https") || parsed.host().isEmpty()) {
        return "expected an address that begins with https://";
    }
    return parsed.userInfo().isEmpty() ? "" : "expected an address without a name or password: the signature says who";
}

std::string CrossingHook::signature(const std::string& key, std::int64_t seconds, const std::string& body) {
    const std::string time = std::to_string(seconds);
    const QByteArray hash = QMessageAuthenticationCode::hash(
        QByteArray::fromStdString(time + "." + body), QByteArray::fromStdString(key), QCryptographicHash::Sha256);
    return "t=" + time + ",v1=" + hash.toHex().toStdString();
}

std::string CrossingHook::body(const Crossing& crossing) {
    return platform::writeJson(Dictionary{{"id", std::to_string(crossing.number)},
                                          {"name", crossing.name},
                                          {"handle", crossing.handle},
                                          {"trigger", crossing.arrives ? "OnArrival" : "OnDeparture"},
                                          {"place", crossing.place},
                                          {"timestamp", crossing.time * 1000}});
}

void CrossingHook::attempt(const Crossing& crossing, int number, std::function<void()> done) {
    linux_::HttpsRequest request;
    request.method = "POST";
    request.url = QUrl(QString::fromStdString(setup_.url), QUrl::StrictMode);
    request.body = body(crossing);
    request.fields = {{"Content-Type", "application/json"},
                      {"User-Agent", "ktr"},
                      {"Ktr-Event", std::to_string(crossing.number)},
                      {"Ktr-Signature", signature(setup_.key, QDateTime::currentSecsSinceEpoch(), request.body)}};
    request.deadline = kDeadline;
    const auto ended = [this, crossing, number, done = std::move(done)](bool isTaken) {
        if (isTaken || number >= kAttempts) {
            if (!isTaken) {
                setup_.tell("the hook did not take a crossing; it is not tried again");
            }
            return done();
        }
        QTimer::singleShot(kPause * number, qApp,
                           [this, crossing, number, done] { attempt(crossing, number + 1, done); });
    };
    client_.send(std::move(request), setup_.certificateFiles, [ended](const linux_::HttpsAnswer& answer) {
        const bool isTaken =
            answer.failure == platform::HttpFailure::None && answer.status >= 200 && answer.status < 300;
        QMetaObject::invokeMethod(
            qApp, [ended, isTaken] { ended(isTaken); }, Qt::QueuedConnection);
    });
}

}  // namespace ktr::app
