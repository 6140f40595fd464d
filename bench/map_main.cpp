// A map of 400 x 219 points at scale 2 from a file of tiles, of vectors or of pictures: the first picture, the same
// again, a glide, and what of it the main thread does.
//   ktr-map-bench FILE LATITUDE LONGITUDE [ZOOM]
//   ktr-map-bench --pictures OUT.mbtiles FILE LATITUDE LONGITUDE    makes a file of pictures from one of vectors
#include <QApplication>
#include <QImage>
#include <QPainter>
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "bench/MapGlide.h"
#include "bench/PictureMap.h"
#include "bench/ThreadTime.h"
#include "linux/maps/MapDrawer.h"
#include "linux/maps/MbtilesPictures.h"
#include "linux/maps/PictureGround.h"
#include "linux/maps/ThreadedMapSource.h"
#include "linux/maps/VectorGround.h"
#include "linux/paint/FontSetup.h"
#include "linux/paint/QtImage.h"
#include "platform/base/VirtualTime.h"

namespace {

using namespace ktr;
using bench::computed;
using namespace ktr::linux_;

constexpr int kRounds = 41;

double median(int rounds, const std::function<void(int)>& work) {
    std::vector<double> times;
    for (int round = 0; round < rounds; ++round) {
        const double begin = computed();
        work(round);
        times.push_back(computed() - begin);
    }
    std::sort(times.begin(), times.end());
    return times[times.size() / 2];
}

platform::MapPictureRequest request(const platform::Coordinate& centre, double zoom) {
    platform::MapPictureRequest made;
    made.viewport = {centre, zoom, {400.0, 219.0}};
    made.scale = 2.0;
    return made;
}

/// Two points to the east with each step.
platform::MapPictureRequest glide(platform::MapPictureRequest from, int step) {
    from.viewport.centre = from.viewport.coordinateAt({200.0 + 2.0 * step, 109.5});
    return from;
}

void benchMainThread(const platform::MapPictureRequest& wanted, const std::shared_ptr<MapGround>& ground) {
    // The worker's turn is the main thread's here, and is taken off again.
    const auto time = std::make_shared<platform::VirtualTime>(platform::Date{0.0});
    ThreadedMapSource source(time, {ground});
    QImage screen(800, 438, QImage::Format_RGB32);
    const auto show = [&](const platform::MapPicture& picture) {
        QPainter painter(&screen);
        painter.scale(2.0, 2.0);
        dynamic_cast<const QtImage&>(*picture.image)
            .draw(painter, QRectF(0.0, 0.0, 400.0, 219.0), Palette::of(ColorScheme::Light));
    };
    source.requestPicture(wanted, show);
    time->runPosted();
    const double kept = median(kRounds, [&](int) {
        source.requestPicture(wanted, show);
        time->runPosted();
    });
    std::printf("main thread: a kept picture asked for, answered and painted: %.3f ms\n", kept);
}

std::shared_ptr<MapGround> groundOf(const char* file, bool isPictures) {
    if (isPictures) {
        return std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(file));
    }
    return std::make_shared<VectorGround>(file);
}

int benchFile(const char* file, const platform::Coordinate& centre, double zoom) {
    const auto wanted = request(centre, zoom);
    const auto draw = [](const platform::MapPictureRequest& asked, const std::shared_ptr<MapGround>& ground) {
        return MapDrawer::draw(asked, {ground}, {});
    };
    bool isPictures = false;
    auto ground = groundOf(file, isPictures);
    double begin = computed();
    auto first = draw(wanted, ground);
    if (!first || first->attribution.empty()) {
        isPictures = true;
        ground = groundOf(file, isPictures);
        begin = computed();
        first = draw(wanted, ground);
    }
    const double cold = computed() - begin;
    if (!first || first->attribution.empty()) {
        std::fprintf(stderr, "%s shows nothing there\n", file);
        return 1;
    }
    std::printf("%s, %.2f metres a point, %s\n", isPictures ? "pictures" : "vectors", wanted.viewport.metresPerPoint(),
                first->attribution.c_str());
    std::printf("first picture (file, fonts, tiles, names): %.1f ms\n", cold);
    std::printf("first picture of a new file: %.1f ms\n",
                median(kRounds, [&](int) { draw(wanted, groundOf(file, isPictures)); }));
    std::printf("tiles and names known: %.1f ms\n", median(kRounds, [&](int) { draw(wanted, ground); }));
    std::printf("two points on, each time: %.1f ms\n",
                median(kRounds, [&](int round) { draw(glide(wanted, round), ground); }));
    benchMainThread(wanted, ground);
    const auto walk = ktr::bench::MapGlide::make(ground, centre);
    if (!walk) {
        std::fprintf(stderr, "the program's resources are missing\n");
        return 1;
    }
    const auto figures = walk->measure();
    std::printf(
        "gliding after a friend: %.2f ms a frame (%.2f at most); of a whole glide %.1f ms on the main thread, "
        "%.1f ms on the worker\n",
        figures.frame, figures.worst, figures.mainThread, figures.grounds);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    const bool makesPictures = argc == 6 && std::strcmp(argv[1], "--pictures") == 0;
    if (!makesPictures && argc != 4 && argc != 5) {
        std::fprintf(stderr,
                     "usage: ktr-map-bench FILE LATITUDE LONGITUDE [ZOOM]\n"
                     "       ktr-map-bench --pictures OUT.mbtiles FILE LATITUDE LONGITUDE\n");
        return 2;
    }
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    FontSetup::prepare(FontSetup::Mode::Pinned);
    const QApplication application(argc, argv);
    FontSetup::load(FontSetup::Mode::Pinned);
    char** const place = argv + (makesPictures ? 4 : 2);
    const platform::Coordinate centre{std::atof(place[0]), std::atof(place[1])};
    if (makesPictures) {
        const bool isWritten = ktr::bench::PictureMap::write(argv[2], std::make_shared<VectorGround>(argv[3]), centre);
        std::fprintf(stderr, "%s %s\n", argv[2], isWritten ? "is written" : "cannot be written");
        return isWritten ? 0 : 1;
    }
    return benchFile(argv[1], centre, argc > 4 ? std::atof(argv[4]) : 15.5);
}
