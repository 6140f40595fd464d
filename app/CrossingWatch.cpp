#include "app/CrossingWatch.h"

#include <QCoreApplication>
#include <QPointer>
#include <QTimer>
#include <QUrl>
#include <algorithm>
#include <charconv>
#include <utility>

#include "documents/AtomicFile.h"
#include "documents/FileReader.h"
#include "linux/net/ServicePolicy.h"
#include "platform/base/Json.h"

namespace ktr::app {

using platform::Dictionary;

namespace {

constexpr const char* kPath = "/qloxservice/friends/va/events";
/// A stream ends by itself once a day; the service shows three times a minute that it is there.
constexpr double kLongest = 86400.0;
constexpr double kSilence = 60.0;
constexpr double kAcknowledging = 15.0;
constexpr std::size_t kMostBytes = std::size_t{1} << 30;
constexpr std::size_t kMostOfJournal = 64;
constexpr int kSignedOut = 401;

linux_::HttpsRequest requestFor(const CrossingWatch::Account& account) {
    linux_::HttpsRequest request;
    request.url = QUrl(QStringLiteral("https://") + QString::fromStdString(account.host + kPath), QUrl::StrictMode);
    request.fields = {{"User-Agent", "ktr"}, {"Authorization", account.authorization}};
    request.mayFollow = [policy = linux_::ServicePolicy(account.host, account.domains)](const linux_::Origin& origin) {
        return policy.allows(origin);
    };
    return request;
}

}  // namespace

CrossingWatch::CrossingWatch(Setup setup) : setup_(std::move(setup)) {
    readJournal();
}

void CrossingWatch::readJournal() {
    documents::FileReader::Terms terms;
    terms.most = kMostOfJournal;
    const auto read = documents::FileReader::read(setup_.journal, terms);
    if (const auto* text = std::get_if<std::string>(&read)) {
        const auto [end, error] = std::from_chars(text->data(), text->data() + text->size(), heard_);
        if (error != std::errc() || heard_ < 0) {
            heard_ = 0;
            setup_.tell(setup_.journal.string() + ": expected the number of the last crossing that was told");
        }
    } else if (const auto& error = std::get<documents::FileReader::Error>(read); !error.isMissing) {
        setup_.tell(setup_.journal.string() + ": " + error.reason);
    }
}

CrossingWatch::~CrossingWatch() = default;

void CrossingWatch::start() {
    listen();
}

void CrossingWatch::listen() {
    linux_::HttpsRequest request = requestFor(setup_.account);
    request.fields.set("Accept", "text/event-stream");
    // What waits here has been heard, too.
    const std::int64_t last = waiting_.empty() ? heard_ : waiting_.back().number;
    if (last > 0) {
        request.fields.set("Last-Event-ID", std::to_string(last));
    }
    request.deadline = kLongest;
    request.inactivityLimit = kSilence;
    request.maximumBytes = kMostBytes;
    const QPointer<CrossingWatch> self(this);
    const auto parser = std::make_shared<linux_::EventStreamParser>();
    isEnough_ = std::make_shared<std::atomic<bool>>(false);
    request.piece = [self, parser, isEnough = isEnough_](const std::string& piece) {
        auto events = parser->feed(piece);
        QMetaObject::invokeMethod(
            qApp,
            [self, events = std::move(events)]() mutable {
                if (self) {
                    self->take(events);
                }
            },
            Qt::QueuedConnection);
        return !parser->isBroken() && !*isEnough;
    };
    client_.send(std::move(request), setup_.account.certificateFiles, [self](linux_::HttpsAnswer answer) {
        QMetaObject::invokeMethod(
            qApp,
            [self, answer = std::move(answer)] {
                if (self) {
                    self->ended(answer);
                }
            },
            Qt::QueuedConnection);
    });
}

void CrossingWatch::ended(const linux_::HttpsAnswer& answer) {
    const bool isWell = *isEnough_ || (answer.failure == platform::HttpFailure::None && answer.status == 200);
    const std::string trouble = isWell                        ? ""
                                : answer.status == kSignedOut ? "the service does not take the credentials"
                                : answer.failure == platform::HttpFailure::None
                                    ? "the service answers with the status " + std::to_string(answer.status)
                                    : "the service cannot be heard: " + answer.reason;
    if (!trouble.empty() && trouble != trouble_) {
        setup_.tell(trouble);
    }
    trouble_ = trouble;
    listenLater(std::exchange(pause_, std::min(pause_ * 2.0, kLastPause)));
}

void CrossingWatch::listenLater(double pause) {
    QTimer::singleShot(static_cast<int>(pause * 1000.0), this,
                       [this] { waiting_.size() < kMostWaiting ? listen() : listenLater(kFirstPause); });
}

void CrossingWatch::take(const std::vector<linux_::StreamEvent>& events) {
    pause_ = kFirstPause;
    trouble_.clear();
    for (const linux_::StreamEvent& event : events) {
        const auto crossing = event.type == "crossing" ? Crossing::read(event.data) : std::nullopt;
        const std::int64_t last = waiting_.empty() ? heard_ : waiting_.back().number;
        // Whatever else this stream still says comes again with the next: nothing in between is passed over.
        if (*isEnough_ || waiting_.size() >= kMostWaiting) {
            *isEnough_ = true;
            break;
        }
        if (crossing && crossing->number > last) {
            waiting_.push_back(*crossing);
        }
    }
    handOnNext();
}

void CrossingWatch::handOnNext() {
    if (isBusy_ || waiting_.empty()) {
        return;
    }
    isBusy_ = true;
    const QPointer<CrossingWatch> self(this);
    setup_.handOn(waiting_.front(), [self, number = waiting_.front().number] {
        if (self) {
            self->handedOn(number);
        }
    });
}

void CrossingWatch::handedOn(std::int64_t number) {
    heard_ = number;
    if (const std::string complaint = documents::AtomicFile::write(setup_.journal, std::to_string(number) + "\n");
        !complaint.empty()) {
        setup_.tell(complaint);
    }
    waiting_.pop_front();
    isBusy_ = false;
    acknowledge();
    // Not inside the call that handed it on.
    QTimer::singleShot(0, this, [this] { handOnNext(); });
}

void CrossingWatch::acknowledge() {
    linux_::HttpsRequest request = requestFor(setup_.account);
    request.method = "POST";
    request.fields.set("Content-Type", "application/json");
    request.fields.set("X-Orcha-Seek-API-Ver", "4.0");
    request.fields.set("X-Orcha-AuthScheme", "Forever");
    request.body = platform::writeJson(Dictionary{{"clientContext", Dictionary()}, {"heard", std::to_string(heard_)}});
    request.deadline = kAcknowledging;
    // Lost, it is said with the next one, or with the next stream.
    client_.send(std::move(request), setup_.account.certificateFiles, [](const linux_::HttpsAnswer&) {});
}

}  // namespace ktr::app
