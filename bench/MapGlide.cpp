#include "bench/MapGlide.h"

#include <QImage>
#include <QPainter>
#include <algorithm>
#include <utility>
#include <variant>

#include "app/Options.h"
#include "bench/ThreadTime.h"
#include "host/Environment.h"
#include "linux/maps/ThreadedMapSource.h"
#include "linux/paint/QtCanvas.h"
#include "platform/base/Object.h"
#include "platform/base/Platform.h"

namespace ktr::bench {

using namespace platform;

namespace {

constexpr double kWidth = 400.0;  // points
constexpr double kHeight = 219.0;
constexpr double kScale = 2.0;
constexpr double kFrame = 1.0 / 60.0;  // seconds
constexpr int kFrames = 30;            // of one glide
constexpr int kWalks = 21;
constexpr double kStep = 0.0006;  // degrees: some 60 metres
constexpr CoordinateSpan kSpan{0.004, 0.004};

/// Notes how long another ground takes: with virtual time the worker's turn is this thread's.
class TimedGround final : public linux_::MapGround {
  public:
    TimedGround(std::shared_ptr<linux_::MapGround> ground, std::shared_ptr<double> total)
        : ground_(std::move(ground)), total_(std::move(total)) {}
    linux_::MapDrawn draw(const linux_::MapDrawing& drawing) override {
        const double start = computed();
        auto drawn = ground_->draw(drawing);
        *total_ += computed() - start;
        return drawn;
    }

  private:
    std::shared_ptr<linux_::MapGround> ground_;
    std::shared_ptr<double> total_;
};

double median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

}  // namespace

std::unique_ptr<MapGlide> MapGlide::make(std::shared_ptr<linux_::MapGround> ground, const Coordinate& start) {
    app::Options options;
    options.scale = kScale;
    const auto settings = host::HostSettings::decide(options, {}, {});
    if (!std::holds_alternative<host::HostSettings>(settings)) {
        return nullptr;
    }
    auto environment = host::Environment::make(std::get<host::HostSettings>(settings), true);
    if (!std::holds_alternative<host::Environment>(environment)) {
        return nullptr;
    }
    auto& made = std::get<host::Environment>(environment);
    std::unique_ptr<MapGlide> glide(new MapGlide);
    glide->time_ = made.virtualTime;
    glide->start_ = start;
    made.platform->maps = std::make_shared<linux_::ThreadedMapSource>(
        made.virtualTime,
        linux_::ThreadedMapSource::Grounds{std::make_shared<TimedGround>(std::move(ground), glide->groundTime_)});
    Platform::install(made.platform);
    glide->window_ = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, kWidth, kHeight});
    glide->map_ = create<PlatformMapView>(&PlatformMapView::initWithFrame, Rect{0.0, 0.0, kWidth, kHeight});
    glide->window_->addSubview(glide->map_);
    glide->delegate_ = KTRVAMapDelegate::sharedInstance();
    glide->map_->setDelegate(glide->delegate_);
    glide->friend_ = std::make_shared<KTRVAMapAnnotation>();
    glide->standAt(start, false);
    glide->map_->addAnnotation(glide->friend_);
    return glide;
}

MapGlide::~MapGlide() {
    friend_ = nullptr;
    map_ = nullptr;
    window_ = nullptr;
    delegate_ = nullptr;
    Platform::install(nullptr);
}

void MapGlide::standAt(const Coordinate& place, bool animated) {
    const auto location = std::make_shared<VALocation>();
    location->latitude = place.latitude;
    location->longitude = place.longitude;
    friend_->setLocation(location);
    if (circle_) {
        map_->removeOverlay(circle_);
    }
    circle_ = std::make_shared<KTAccuracyOverlay>(place, 25.0);
    map_->addOverlay(circle_);
    map_->setRegion({place, kSpan}, animated);
}

MapGlide::Figures MapGlide::measure() {
    const linux_::Palette palette = linux_::Palette::of(linux_::ColorScheme::Light);
    QImage screen(static_cast<int>(kWidth * kScale), static_cast<int>(kHeight * kScale),
                  QImage::Format_ARGB32_Premultiplied);
    std::vector<double> frames;
    std::vector<double> mainThreads;
    std::vector<double> grounds;
    time_->runPosted();
    for (int walk = 0; walk < kWalks; ++walk) {
        const double side = walk % 2 == 0 ? 1.0 : 0.0;
        *groundTime_ = 0.0;
        double before = computed();
        standAt({start_.latitude + kStep * side, start_.longitude + kStep * walk}, true);
        double mainThread = computed() - before;
        for (int frame = 0; frame < kFrames; ++frame) {
            const double ground = *groundTime_;
            before = computed();
            time_->advance(kFrame);
            window_->layoutIfNeeded();
            QPainter painter(&screen);
            painter.setRenderHints(QPainter::Antialiasing | QPainter::SmoothPixmapTransform);
            painter.scale(kScale, kScale);
            linux_::QtCanvas canvas(painter, palette);
            window_->paint(canvas, {0.0, 0.0, kWidth, kHeight});
            painter.end();
            const double took = computed() - before - (*groundTime_ - ground);
            frames.push_back(took);
            mainThread += took;
        }
        time_->advance(1.0);  // at rest
        mainThreads.push_back(mainThread);
        grounds.push_back(*groundTime_);
    }
    return {median(frames), *std::max_element(frames.begin(), frames.end()), median(mainThreads), median(grounds)};
}

}  // namespace ktr::bench
