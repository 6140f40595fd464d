#include "linux/maps/ThreadedMapSource.h"

#include <algorithm>
#include <cstddef>
#include <deque>
#include <exception>
#include <list>
#include <map>
#include <optional>
#include <utility>

#include "linux/maps/MapDrawer.h"
#include "linux/maps/MapStyle.h"
#include "linux/paint/RasterImage.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// Pictures kept: some 20 of a window's cards at scale 2.
constexpr std::size_t kMostBytes = std::size_t{32} << 20;

/// Nothing thrown leaves a worker: without memory the map is one pixel.
std::optional<MapDrawer::Result> drawSafely(const platform::MapPictureRequest& request,
                                            const ThreadedMapSource::Grounds& grounds, const std::stop_token& token) {
    try {
        return MapDrawer::draw(request, grounds, token);
    } catch (const std::exception& error) {
        platform::areaLog(platform::LogArea::Maps).line("A map cannot be drawn: %@", std::string(error.what()));
        MapDrawer::Result empty;
        empty.pixels = QImage(1, 1, QImage::Format_RGB32);
        empty.pixels.fill(MapStyle::of(request.isDark, request.isHighContrast).land);
        return empty;
    }
}

}  // namespace

/// Main thread; a drawing gets copies of what it needs.
class ThreadedMapSource::Core : public std::enable_shared_from_this<Core> {
  public:
    Core(std::shared_ptr<platform::MainLoop> mainLoop, Grounds grounds)
        : mainLoop_(std::move(mainLoop)), grounds_(std::move(grounds)) {}

    void listen();
    void setGrounds(Grounds grounds);
    int add(const platform::MapPictureRequest& request, Completion completion);
    void remove(int id);
    std::shared_ptr<void> observe(std::function<void()> changed);
    void close();

  private:
    struct Waiting {
        int id = 0;
        Completion completion;
    };
    struct Job {
        platform::MapPictureRequest request;
        std::vector<Waiting> waiting;
        std::stop_source stop;
        int generation = 0;  ///< of the grounds that it is drawn from, once it is running
    };
    struct Kept {
        platform::MapPictureRequest request;
        platform::MapPicture picture;
        std::size_t bytes = 0;
    };

    const platform::MapPicture* kept(const platform::MapPictureRequest& request);
    void keep(const platform::MapPictureRequest& request, const platform::MapPicture& picture, std::size_t bytes);
    void answer(const Waiting& waiting, const platform::MapPicture& picture);
    void startNext();
    void finished(std::optional<MapDrawer::Result> result);
    void deliver(const Job& job, const MapDrawer::Result& result);
    void changed();

    std::shared_ptr<platform::MainLoop> mainLoop_;
    Grounds grounds_;
    /// Grows when what was drawn before no longer holds.
    int generation_ = 0;
    int lastId_ = 0;
    std::deque<Job> queue_;
    std::optional<Job> running_;
    /// Answers posted and not yet called.
    std::map<int, std::pair<Completion, platform::MapPicture>> answers_;
    std::list<Kept> kept_;  ///< latest used first
    std::size_t keptBytes_ = 0;
    std::map<int, std::function<void()>> observers_;
    bool closed_ = false;
};

void ThreadedMapSource::Core::listen() {
    for (const auto& ground : grounds_) {
        ground->setChangeHandler([weak = weak_from_this(), loop = std::weak_ptr(mainLoop_)] {
            const auto mainLoop = loop.lock();
            if (!mainLoop) {
                return;
            }
            mainLoop->post([weak] {
                if (const auto core = weak.lock()) {
                    core->changed();
                }
            });
        });
    }
}

void ThreadedMapSource::Core::setGrounds(Grounds grounds) {
    grounds_ = std::move(grounds);
    listen();
    if (running_) {
        running_->stop.request_stop();
    }
    changed();
}

void ThreadedMapSource::Core::changed() {
    ++generation_;
    kept_.clear();
    keptBytes_ = 0;
    // An observer may ask, cancel and stop observing.
    std::vector<int> ids;
    for (const auto& [id, observer] : observers_) {
        ids.push_back(id);
    }
    for (const int id : ids) {
        const auto found = observers_.find(id);
        if (found != observers_.end()) {
            const auto observer = found->second;
            observer();
        }
    }
}

int ThreadedMapSource::Core::add(const platform::MapPictureRequest& request, Completion completion) {
    const int id = ++lastId_;
    if (const auto* picture = kept(request)) {
        answer({id, std::move(completion)}, *picture);
        return id;
    }
    const auto same = [&](const Job& job) { return job.request == request; };
    if (running_ && same(*running_) && running_->generation == generation_ && !running_->stop.stop_requested()) {
        running_->waiting.push_back({id, std::move(completion)});
        return id;
    }
    const auto queued = std::find_if(queue_.begin(), queue_.end(), same);
    if (queued != queue_.end()) {
        queued->waiting.push_back({id, std::move(completion)});
        return id;
    }
    Job job;
    job.request = request;
    job.waiting.push_back({id, std::move(completion)});
    queue_.push_back(std::move(job));
    startNext();
    return id;
}

void ThreadedMapSource::Core::remove(int id) {
    answers_.erase(id);
    const auto leave = [&](Job& job) {
        return std::erase_if(job.waiting, [&](const Waiting& waiting) { return waiting.id == id; }) > 0;
    };
    if (running_ && leave(*running_) && running_->waiting.empty()) {
        running_->stop.request_stop();
    }
    for (auto& job : queue_) {
        leave(job);
    }
    std::erase_if(queue_, [](const Job& job) { return job.waiting.empty(); });
}

std::shared_ptr<void> ThreadedMapSource::Core::observe(std::function<void()> changed) {
    const int id = ++lastId_;
    observers_[id] = std::move(changed);
    return {nullptr, [weak = weak_from_this(), id](void*) {
                if (const auto core = weak.lock()) {
                    core->observers_.erase(id);
                }
            }};
}

void ThreadedMapSource::Core::close() {
    closed_ = true;
    queue_.clear();
    answers_.clear();
    observers_.clear();
    if (running_) {
        running_->waiting.clear();
        running_->stop.request_stop();
    }
}

const platform::MapPicture* ThreadedMapSource::Core::kept(const platform::MapPictureRequest& request) {
    const auto found =
        std::find_if(kept_.begin(), kept_.end(), [&](const Kept& entry) { return entry.request == request; });
    if (found == kept_.end()) {
        return nullptr;
    }
    kept_.splice(kept_.begin(), kept_, found);
    return &kept_.front().picture;
}

void ThreadedMapSource::Core::keep(const platform::MapPictureRequest& request, const platform::MapPicture& picture,
                                   std::size_t bytes) {
    kept_.push_front({request, picture, bytes});
    keptBytes_ += bytes;
    while (keptBytes_ > kMostBytes && !kept_.empty()) {
        keptBytes_ -= kept_.back().bytes;
        kept_.pop_back();
    }
}

void ThreadedMapSource::Core::answer(const Waiting& waiting, const platform::MapPicture& picture) {
    answers_[waiting.id] = {waiting.completion, picture};
    mainLoop_->post([weak = weak_from_this(), id = waiting.id] {
        const auto core = weak.lock();
        if (!core) {
            return;
        }
        const auto found = core->answers_.find(id);
        if (found == core->answers_.end()) {
            return;
        }
        const auto [completion, answered] = std::move(found->second);
        core->answers_.erase(found);
        completion(answered);
    });
}

void ThreadedMapSource::Core::startNext() {
    if (closed_ || running_ || queue_.empty()) {
        return;
    }
    running_ = std::move(queue_.front());
    queue_.pop_front();
    running_->generation = generation_;
    // The grounds live until the drawing is done; the result finds its way back if anybody is still there.
    mainLoop_->runInBackground([weak = weak_from_this(), loop = std::weak_ptr(mainLoop_), grounds = grounds_,
                                request = running_->request, token = running_->stop.get_token()]() mutable {
        auto result = std::make_shared<std::optional<MapDrawer::Result>>(drawSafely(request, grounds, token));
        if (const auto mainLoop = loop.lock()) {
            // Grounds end on the main thread, where they began.
            mainLoop->post([weak, result, ended = std::move(grounds)] {
                if (const auto core = weak.lock()) {
                    core->finished(std::move(*result));
                }
            });
        }
    });
}

void ThreadedMapSource::Core::finished(std::optional<MapDrawer::Result> result) {
    Job job = std::move(*running_);
    running_.reset();
    if (result) {
        deliver(job, *result);
    } else if (!job.waiting.empty()) {
        // Stopped because the grounds changed: draw it from the new ones.
        job.stop = std::stop_source();
        queue_.push_front(std::move(job));
    }
    startNext();
}

void ThreadedMapSource::Core::deliver(const Job& job, const MapDrawer::Result& result) {
    platform::MapPicture picture;
    picture.viewport = job.request.viewport;
    if (job.request.beyond == platform::MapPictureRequest::Beyond::Widen && result.coarseZoom) {
        picture.viewport.zoom = *result.coarseZoom;
    }
    picture.image = std::make_shared<RasterImage>(result.pixels, job.request.viewport.size);
    if (!result.labels.isNull()) {
        picture.labels = std::make_shared<RasterImage>(result.labels, job.request.viewport.size);
    }
    picture.attribution = result.attribution;
    picture.isComplete = result.isComplete;
    picture.hasStreets = result.hasStreets;
    picture.coarseZoom = result.coarseZoom;
    if (job.generation == generation_) {
        keep(job.request, picture, static_cast<std::size_t>(result.pixels.sizeInBytes() + result.labels.sizeInBytes()));
    }
    for (const auto& waiting : job.waiting) {
        answer(waiting, picture);
    }
}

ThreadedMapSource::ThreadedMapSource(std::shared_ptr<platform::MainLoop> mainLoop, Grounds grounds,
                                     std::shared_ptr<const MainlandArea> gcj02)
    : core_(std::make_shared<Core>(std::move(mainLoop), std::move(grounds))), gcj02_(std::move(gcj02)) {
    core_->listen();
}

ThreadedMapSource::~ThreadedMapSource() {
    core_->close();
}

int ThreadedMapSource::requestPicture(const platform::MapPictureRequest& request, Completion completion) {
    platform::MapPictureRequest dense = request;
    dense.scale *= density_;
    return core_->add(dense, std::move(completion));
}

void ThreadedMapSource::cancel(int request) {
    core_->remove(request);
}

std::shared_ptr<void> ThreadedMapSource::observeChanges(std::function<void()> changed) {
    return core_->observe(std::move(changed));
}

void ThreadedMapSource::setGrounds(Grounds grounds) {
    core_->setGrounds(std::move(grounds));
}

}  // namespace ktr::linux_
