#include "linux/maps/HttpsPictures.h"

#include <QMetaObject>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <QPointer>
#include <QTimer>
#include <QUrl>
#include <algorithm>
#include <deque>
#include <set>

#include "linux/maps/TileFreshness.h"
#include "linux/net/TlsTrust.h"
#include "platform/base/LogArea.h"

#ifndef KTR_VERSION
#error "KTR_VERSION is given by the build"
#endif

namespace ktr::linux_ {

namespace {

using std::chrono::seconds;

/// Requests at a time, and waiting ones: the latest matter most.
constexpr std::size_t kMostAtOnce = 2;
constexpr std::size_t kMostWaiting = 64;
constexpr std::size_t kMostStates = 4096;
constexpr int kDeadline = 20000;  // milliseconds
/// Tiles that arrive together are told of together; milliseconds.
constexpr int kGathering = 120;
/// No tile is asked for again within this, whatever the server says of its freshness.
constexpr seconds kLeastPause{60};
constexpr seconds kPauseWhenGone{3600};
constexpr int kOk = 200;
constexpr int kNotModified = 304;
constexpr int kNotFound = 404;
constexpr int kGone = 410;
constexpr int kTooMany = 429;
constexpr int kUnavailable = 503;

std::int64_t secondsNow() {
    return std::chrono::duration_cast<seconds>(std::chrono::system_clock::now().time_since_epoch()).count();
}

bool isPicture(const QByteArray& data) {
    return data.startsWith("\x89PNG\r\n\x1a\n") || data.startsWith("\xff\xd8\xff");
}

/// How long a server wants to be left alone (RFC 9110, section 10.2.3); it need not say, and is not asked to say it
/// well.
seconds retryAfter(const QByteArray& field) {
    bool isNumber = false;
    const int wanted = field.trimmed().toInt(&isNumber);
    return isNumber ? std::clamp(seconds(wanted), kLeastPause, kPauseWhenGone) : kLeastPause;
}

QUrl addressOf(const std::string& pattern, const tiles::TileKey& key) {
    QString address = QString::fromStdString(pattern);
    address.replace(QLatin1String("{z}"), QString::number(key.z));
    address.replace(QLatin1String("{x}"), QString::number(key.x));
    address.replace(QLatin1String("{y}"), QString::number(key.y));
    return QUrl(address, QUrl::StrictMode);
}

}  // namespace

/// What lives on the network thread.
class HttpsPictures::Fetcher : public QObject {
  public:
    explicit Fetcher(HttpsPictures& pictures) : pictures_(pictures), settings_(pictures.settings_) {}

    /// `known`: what is on disk already, to ask only for something newer.
    void want(const tiles::TileKey& key, std::optional<TileStore::Entry> known) {
        waiting_.push_front({key, std::move(known)});
        while (waiting_.size() > kMostWaiting) {
            ended(waiting_.back().key, seconds(0));
            waiting_.pop_back();
        }
        startNext();
    }

    /// Ends everything that is under way; nothing is told any more.
    void stop() {
        isStopped_ = true;
        waiting_.clear();
        for (const auto& reply : std::exchange(underWay_, {})) {
            reply->abort();
        }
    }

  private:
    struct Wanted {
        tiles::TileKey key;
        std::optional<TileStore::Entry> known;
    };

    void startNext() {
        while (!isStopped_ && underWay_.size() < kMostAtOnce && !waiting_.empty()) {
            Wanted wanted = std::move(waiting_.front());
            waiting_.pop_front();
            start(std::move(wanted));
        }
    }

    QNetworkRequest requestFor(const Wanted& wanted) {
        if (!manager_) {
            manager_ = new QNetworkAccessManager(this);
            tls_ = TlsTrust::configuration(settings_.certificateFiles);
        }
        QNetworkRequest request(addressOf(settings_.url, wanted.key));
        request.setSslConfiguration(tls_);
        request.setAttribute(QNetworkRequest::RedirectPolicyAttribute, QNetworkRequest::ManualRedirectPolicy);
        request.setAttribute(QNetworkRequest::CookieLoadControlAttribute, QNetworkRequest::Manual);
        request.setAttribute(QNetworkRequest::CookieSaveControlAttribute, QNetworkRequest::Manual);
        request.setAttribute(QNetworkRequest::AuthenticationReuseAttribute, QNetworkRequest::Manual);
        request.setRawHeader("User-Agent", "ktr/" KTR_VERSION);
        request.setRawHeader("Accept", "image/png, image/jpeg");
        request.setRawHeader("Accept-Encoding", "identity");
        // Qt would name the system's language.
        request.setRawHeader("Accept-Language", "*");
        if (wanted.known && !wanted.known->etag.empty()) {
            request.setRawHeader("If-None-Match", QByteArray::fromStdString(wanted.known->etag));
        }
        if (wanted.known && !wanted.known->modified.empty()) {
            request.setRawHeader("If-Modified-Since", QByteArray::fromStdString(wanted.known->modified));
        }
        return request;
    }

    void start(Wanted wanted) {
        const auto now = std::chrono::steady_clock::now();
        if (now < notBefore_) {
            ended(wanted.key, std::chrono::ceil<seconds>(notBefore_ - now));
            return;
        }
        const QNetworkRequest request = requestFor(wanted);
        if (request.url().scheme() != QLatin1String("https")) {
            ended(wanted.key, kPauseWhenGone);
            return;
        }
        QNetworkReply* reply = manager_->get(request);
        underWay_.insert(reply);
        reply->setReadBufferSize(static_cast<qint64>(TileStore::kLargestTile) + 1);
        auto* deadline = new QTimer(reply);
        deadline->setSingleShot(true);
        connect(deadline, &QTimer::timeout, reply, &QNetworkReply::abort);
        deadline->start(kDeadline);
        connect(reply, &QNetworkReply::readyRead, reply, [reply] {
            if (reply->bytesAvailable() > static_cast<qint64>(TileStore::kLargestTile)) {
                reply->abort();
            }
        });
        connect(reply, &QNetworkReply::finished, this, [this, reply, wanted = std::move(wanted)] {
            reply->deleteLater();
            underWay_.erase(reply);
            if (!isStopped_) {
                finished(*reply, wanted);
                startNext();
            }
        });
    }

    void finished(QNetworkReply& reply, const Wanted& wanted) {
        const int status = reply.attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
        const auto field = [&](const char* name) { return reply.rawHeader(name).toStdString(); };
        const auto freshness = TileFreshness::of(field("Cache-Control"), field("Age"), field("Expires"), secondsNow());
        if (reply.error() == QNetworkReply::NoError && status == kNotModified && wanted.known) {
            TileStore::Entry entry = *wanted.known;
            entry.expires = freshness.expires;
            pictures_.store_->save(wanted.key, entry);
            ended(wanted.key, kLeastPause);
            return;
        }
        if (status == kNotFound || status == kGone) {
            ended(wanted.key, kPauseWhenGone, true);
            gather();
            return;
        }
        if (status == kTooMany || status == kUnavailable) {
            notBefore_ = std::chrono::steady_clock::now() + retryAfter(reply.rawHeader("Retry-After"));
        }
        const QByteArray data = reply.error() == QNetworkReply::NoError ? reply.readAll() : QByteArray();
        if (status != kOk || !isPicture(data)) {
            report(status != 0 && status != kOk ? "the server answered " + std::to_string(status)
                   : data.isEmpty()             ? reply.errorString().toStdString()
                                                : "the answer is no picture");
            ended(wanted.key, kLeastPause);
            return;
        }
        reported_.clear();
        arrived(wanted, data, {{}, freshness.expires, field("ETag"), field("Last-Modified")}, freshness.isStored);
    }

    void arrived(const Wanted& wanted, const QByteArray& data, TileStore::Entry entry, bool isStored) {
        entry.data.assign(data.begin(), data.end());
        const bool isNew = !wanted.known || wanted.known->data != entry.data;
        if (isStored) {
            pictures_.store_->save(wanted.key, entry);
        }
        {
            const std::lock_guard lock(pictures_.mutex_);
            State& state = pictures_.states_[wanted.key];
            state.unstored = isStored ? std::nullopt : std::optional(entry.data);
            state.version += isNew ? 1U : 0U;
        }
        ended(wanted.key, kLeastPause);
        if (isNew) {
            gather();
        }
    }

    void ended(const tiles::TileKey& key, seconds pause, bool isGone = false) {
        const std::lock_guard lock(pictures_.mutex_);
        State& state = pictures_.states_[key];
        state.isUnderWay = false;
        state.isGone = isGone;
        state.notBefore = std::chrono::steady_clock::now() + pause;
    }

    /// Says so once, until a tile arrives again.
    void report(const std::string& reason) {
        if (reason != reported_) {
            const std::string host = QUrl(addressOf(settings_.url, {})).host().toStdString();
            platform::areaLog(platform::LogArea::Maps).line("Tiles from %@ cannot be fetched: %@", host, reason);
            reported_ = reason;
        }
    }

    void gather() {
        if (isGathering_) {
            return;
        }
        isGathering_ = true;
        QTimer::singleShot(kGathering, this, [this] {
            isGathering_ = false;
            std::function<void()> changed;
            {
                const std::lock_guard lock(pictures_.mutex_);
                changed = pictures_.changed_;
            }
            if (changed && !isStopped_) {
                changed();
            }
        });
    }

    HttpsPictures& pictures_;
    const Settings& settings_;
    QNetworkAccessManager* manager_ = nullptr;
    QSslConfiguration tls_;
    std::deque<Wanted> waiting_;  ///< the latest first
    std::set<QNetworkReply*> underWay_;
    std::string reported_;
    /// The server has asked to be left alone until then.
    std::chrono::steady_clock::time_point notBefore_;
    bool isGathering_ = false;
    bool isStopped_ = false;
};

HttpsPictures::HttpsPictures(Settings settings)
    : settings_(std::move(settings)),
      store_(std::make_shared<TileStore>(settings_.cacheFolder, settings_.url, settings_.cacheBytes)),
      fetcher_(new Fetcher(*this)) {
    fetcher_->moveToThread(&thread_);
    thread_.setObjectName(QStringLiteral("ktr tiles"));
    QObject::connect(&thread_, &QThread::finished, fetcher_, &QObject::deleteLater);
    thread_.start();
}

HttpsPictures::~HttpsPictures() {
    QMetaObject::invokeMethod(
        fetcher_,
        [fetcher = fetcher_, thread = &thread_] {
            fetcher->stop();
            thread->quit();
        },
        Qt::QueuedConnection);
    thread_.wait();
}

void HttpsPictures::setChangeHandler(std::function<void()> changed) {
    const std::lock_guard lock(mutex_);
    changed_ = std::move(changed);
}

TilePictures::Answer HttpsPictures::tile(const tiles::TileKey& key, bool isWanted) {
    Answer answer;
    std::optional<TileStore::Entry> known = store_->load(key);
    const std::lock_guard lock(mutex_);
    if (states_.size() > kMostStates) {
        std::erase_if(states_, [](const auto& state) { return !state.second.isUnderWay; });
    }
    State& state = states_[key];
    answer.version = state.version;
    if (known) {
        answer.data = known->data;
    } else if (state.unstored) {
        answer.data = state.unstored;
    }
    const bool isFresh = (known && known->expires > secondsNow()) || std::chrono::steady_clock::now() < state.notBefore;
    if (isWanted && !state.isUnderWay && !isFresh) {
        state.isUnderWay = true;
        state.isGone = false;
        QMetaObject::invokeMethod(
            fetcher_, [fetcher = fetcher_, key, known = std::move(known)] { fetcher->want(key, known); },
            Qt::QueuedConnection);
    }
    answer.isComing = isWanted && !answer.data && !state.isGone;
    return answer;
}

}  // namespace ktr::linux_
