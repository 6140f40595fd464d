#include "linux/maps/HttpsPictures.h"

#include <QObject>
#include <QTimer>
#include <QUrl>
#include <algorithm>
#include <deque>
#include <string_view>
#include <utility>

#include "documents/HttpTime.h"
#include "linux/maps/TileFreshness.h"
#include "linux/net/TroubleLine.h"

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
constexpr double kDeadline = 20.0;  // seconds
/// Tiles that arrive together are reported together; milliseconds.
constexpr int kGathering = 120;
/// No tile is asked for again within this, whatever the server says of its freshness.
constexpr seconds kLeastPause{60};
constexpr seconds kPauseWhenGone{3600};
/// After the server could not be reached or broke off, it is left alone for so long, and each time for twice as long.
constexpr seconds kFirstPauseWhenAway{2};
constexpr seconds kLongestPauseWhenAway{300};
constexpr int kOk = 200;
constexpr int kNotModified = 304;
constexpr int kNotFound = 404;
constexpr int kGone = 410;
constexpr int kTooMany = 429;
constexpr int kUnavailable = 503;

std::int64_t secondsNow() {
    return std::chrono::duration_cast<seconds>(std::chrono::system_clock::now().time_since_epoch()).count();
}

bool isPicture(std::string_view data) {
    return data.starts_with("\x89PNG\r\n\x1a\n") || data.starts_with("\xff\xd8\xff");
}

/// How long a server that is busy is left alone; it need not say, and is not asked to say it well.
seconds pauseWhenBusy(const std::string& retryAfter) {
    const platform::Date now{static_cast<double>(secondsNow()) - platform::kSecondsFrom1970ToReferenceDate};
    return std::clamp(documents::parseRetryAfter(retryAfter, now).value_or(kLeastPause), kLeastPause, kPauseWhenGone);
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
    explicit Fetcher(HttpsPictures& pictures)
        : pictures_(pictures), settings_(pictures.settings_), client_(pictures.thread_) {}

    /// `known`: what is on disk already, to ask only for something newer.
    void want(const tiles::TileKey& key, std::optional<TileStore::Entry> known) {
        waiting_.push_front({key, std::move(known)});
        while (waiting_.size() > kMostWaiting) {
            ended(waiting_.back().key, seconds(0));
            waiting_.pop_back();
        }
        startNext();
    }

  private:
    struct Wanted {
        tiles::TileKey key;
        std::optional<TileStore::Entry> known;
    };

    void startNext() {
        while (underWay_ < kMostAtOnce && !waiting_.empty()) {
            Wanted wanted = std::move(waiting_.front());
            waiting_.pop_front();
            start(std::move(wanted));
        }
    }

    HttpsRequest requestFor(const Wanted& wanted) const {
        HttpsRequest request;
        request.url = addressOf(settings_.url, wanted.key);
        request.fields = {
            {"User-Agent", "ktr/" KTR_VERSION}, {"Accept", "image/png, image/jpeg"}, {"Accept-Language", "*"}};
        if (wanted.known && !wanted.known->etag.empty()) {
            request.fields.set("If-None-Match", wanted.known->etag);
        }
        if (wanted.known && !wanted.known->modified.empty()) {
            request.fields.set("If-Modified-Since", wanted.known->modified);
        }
        request.deadline = kDeadline;
        request.inactivityLimit = kDeadline;
        request.maximumBytes = TileStore::kLargestTile;
        return request;
    }

    void start(Wanted wanted) {
        const auto now = std::chrono::steady_clock::now();
        if (now < notBefore_) {
            ended(wanted.key, std::chrono::ceil<seconds>(notBefore_ - now));
            return;
        }
        ++underWay_;
        HttpsRequest request = requestFor(wanted);
        client_.send(std::move(request), settings_.certificateFiles,
                     [this, wanted = std::move(wanted)](const HttpsAnswer& answer) {
                         --underWay_;
                         if (answer.failure != platform::HttpFailure::Cancelled) {
                             finished(answer, wanted);
                             startNext();
                         }
                     });
    }

    void finished(const HttpsAnswer& answer, const Wanted& wanted) {
        const bool isAnswer = answer.failure == platform::HttpFailure::None;
        pauseAfter(answer);
        if (!isAnswer && answer.status == 0) {
            trouble_.say(host(), answer.reason);
            ended(wanted.key, std::max(kLeastPause, std::chrono::ceil<seconds>(awayFor_)));
            return;
        }
        const auto freshness = TileFreshness::of(answer.field("Cache-Control"), answer.field("Age"),
                                                 answer.field("Expires"), secondsNow());
        if (answer.status == kNotModified && wanted.known) {
            TileStore::Entry entry = *wanted.known;
            entry.expires = freshness.expires;
            pictures_.store_->save(wanted.key, entry);
            ended(wanted.key, kLeastPause);
            return;
        }
        if (answer.status == kNotFound || answer.status == kGone) {
            ended(wanted.key, kPauseWhenGone, true);
            gather();
            return;
        }
        if (answer.status != kOk || !isPicture(answer.body)) {
            trouble_.say(host(), answer.status != kOk ? "the server answered " + std::to_string(answer.status)
                                                      : "the answer is no picture");
            ended(wanted.key, kLeastPause);
            return;
        }
        trouble_.clear(host());
        arrived(wanted, answer.body, {{}, freshness.expires, answer.field("ETag"), answer.field("Last-Modified")},
                freshness.isStored);
    }

    /// How long the server is left alone after this.
    void pauseAfter(const HttpsAnswer& answer) {
        const auto now = std::chrono::steady_clock::now();
        if (answer.status == kTooMany || answer.status == kUnavailable) {
            notBefore_ = now + pauseWhenBusy(answer.field("Retry-After"));
        }
        const bool isAway =
            answer.failure == platform::HttpFailure::Network || answer.failure == platform::HttpFailure::BadAnswer ||
            answer.failure == platform::HttpFailure::Tls || answer.failure == platform::HttpFailure::Timeout;
        if (!isAway) {
            awayFor_ = seconds(0);
            return;
        }
        // Two that were under way together have met one trouble.
        if (now >= notBefore_) {
            awayFor_ = std::clamp(awayFor_ * 2, kFirstPauseWhenAway, kLongestPauseWhenAway);
            notBefore_ = now + awayFor_;
        }
    }

    std::string host() const { return addressOf(settings_.url, {}).host().toStdString(); }

    void arrived(const Wanted& wanted, const std::string& data, TileStore::Entry entry, bool isStored) {
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
            if (changed) {
                changed();
            }
        });
    }

    HttpsPictures& pictures_;
    const Settings& settings_;
    std::deque<Wanted> waiting_;  ///< the latest first
    std::size_t underWay_ = 0;
    TroubleLine trouble_{platform::LogArea::Maps, "Tiles from %@ cannot be fetched: %@"};
    /// The server is left alone until then.
    std::chrono::steady_clock::time_point notBefore_;
    seconds awayFor_{0};
    bool isGathering_ = false;
    /// Goes first: what it ends still looks at the others.
    HttpsClient client_;
};

HttpsPictures::HttpsPictures(Settings settings, std::shared_ptr<NetworkThread> thread)
    : settings_(std::move(settings)),
      store_(std::make_shared<TileStore>(settings_.cacheFolder, settings_.url, settings_.cacheBytes)),
      thread_(thread ? std::move(thread) : std::make_shared<NetworkThread>()),
      fetcher_(new Fetcher(*this)) {
    thread_->take(*fetcher_);
}

HttpsPictures::~HttpsPictures() {
    // Behind what was asked for.
    thread_->run([this] { delete fetcher_; });
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
        thread_->post([fetcher = fetcher_, key, known = std::move(known)] { fetcher->want(key, known); });
    }
    answer.isComing = isWanted && !answer.data && !state.isGone;
    return answer;
}

}  // namespace ktr::linux_
