#include "bench/Scene.h"
#include "bench/ThreadTime.h"

#include <malloc.h>
#include <QGuiApplication>
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <functional>
#include <iterator>
#include <string>

namespace ktr::bench {

namespace {

/// The median time of as many calls as fit into the budget, five at least.
double median(
    double budget, const std::function<void()>& work, const std::function<void()>& after = [] {}) {
    std::vector<double> times;
    const double begin = computed();
    while (times.size() < 5 || computed() - begin < budget) {
        const double start = computed();
        work();
        times.push_back(computed() - start);
        after();
    }
    std::nth_element(times.begin(), times.begin() + static_cast<std::ptrdiff_t>(times.size() / 2), times.end());
    return times[times.size() / 2];
}

/// Resident memory, kilobytes (Linux, /proc).
long residentKilobytes() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("VmRSS:", 0) == 0) {
            return std::atol(line.c_str() + 6);
        }
    }
    return 0;
}

/// With large blocks, which the C library maps by themselves or not, as it has learnt.
long heapKilobytes() {
    const auto known = mallinfo2();
    return static_cast<long>((known.uordblks + known.hblkhd) / 1024);
}

QImage imageFor(const Scene& scene, const RowsFile& file) {
    return QImage(static_cast<int>(file.width * file.scale), static_cast<int>(scene.height() * file.scale),
                  QImage::Format_ARGB32_Premultiplied);
}

int writePicture(Scene& scene, const RowsFile& file, const char* path) {
    scene.build(file, file.friends.size(), file.width);
    if (!scene.write(QString::fromLocal8Bit(path), file.scale)) {
        std::fprintf(stderr, "%s: cannot be written\n", path);
        return 1;
    }
    return 0;
}

int measure(Scene& scene, const RowsFile& file, double budget) {
    const std::size_t count = file.friends.size();
    scene.build(file, std::min<std::size_t>(count, 1), file.width);
    scene.clear();
    const long residentBefore = residentKilobytes();
    const long heapBefore = heapKilobytes();
    scene.build(file, count, file.width);
    const long residentAfter = residentKilobytes();
    const long heapAfter = heapKilobytes();
    scene.clear();

    const double build = median(
        budget, [&] { scene.build(file, count, file.width); }, [&] { scene.clear(); });
    scene.build(file, count, file.width);
    bool next = false;
    const double update = median(budget, [&] { scene.updateAll(next = !next); });
    scene.updateAll(false);
    const double one = median(budget, [&] { scene.updateOne(count / 2, next = !next); });
    double width = file.width;
    const double resize = median(budget, [&] {
        width = width < file.width ? file.width : file.width - 40.0;
        scene.resize(width);
    });
    scene.resize(file.width);
    QImage image = imageFor(scene, file);
    const double paint = median(budget, [&] { scene.paint(image, file.scale); });
    std::printf(
        "RESULT build_ms=%.4f update_ms=%.4f update1_ms=%.4f resize_ms=%.4f paint_ms=%.4f rss_before_kb=%ld "
        "rss_after_kb=%ld heap_before_kb=%ld heap_after_kb=%ld\n",
        build, update, one, resize, paint, residentBefore, residentAfter, heapBefore, heapAfter);
    return 0;
}

/// Texts that are set to what they were.
int measureUnchanged(Scene& scene, const RowsFile& file, double budget) {
    scene.build(file, file.friends.size(), file.width);
    std::printf("RESULT unchanged_ms=%.4f\n", median(budget, [&] { scene.updateAll(false); }));
    return 0;
}

/// Names that were never shaped before, the first of them aside: these load the fonts.
int measureLabels(Scene& scene, const RowsFile& file, std::size_t batch) {
    std::vector<double> times;
    for (std::size_t first = 0; first + batch <= file.friends.size(); first += batch) {
        const double start = computed();
        for (std::size_t i = first; i < first + batch; ++i) {
            scene.shapeName(file.friends[i].now.name);
        }
        times.push_back((computed() - start) * 1000.0 / static_cast<double>(batch));
    }
    if (times.size() < 2) {
        std::fprintf(stderr, "at least %zu friends are needed\n", 2 * batch);
        return 1;
    }
    std::sort(times.begin() + 1, times.end());
    std::printf("RESULT label_us=%.4f\n", times[1 + (times.size() - 1) / 2]);
    return 0;
}

}  // namespace

int runBenchProgram(int argc, char** argv, Scene& scene) {
    const char* json = nullptr;
    const char* png = nullptr;
    const char* budget = nullptr;
    const char* unchanged = nullptr;
    const char* labels = nullptr;
    for (int i = 1; i + 1 < argc; i += 2) {
        if (std::strcmp(argv[i], "--json") == 0) {
            json = argv[i + 1];
        } else if (std::strcmp(argv[i], "--png") == 0) {
            png = argv[i + 1];
        } else if (std::strcmp(argv[i], "--bench") == 0) {
            budget = argv[i + 1];
        } else if (std::strcmp(argv[i], "--unchanged") == 0) {
            unchanged = argv[i + 1];
        } else if (std::strcmp(argv[i], "--labels") == 0) {
            labels = argv[i + 1];
        }
    }
    const char* const given[] = {png, budget, unchanged, labels};
    const auto tasks =
        std::count_if(std::begin(given), std::end(given), [](const char* one) { return one != nullptr; });
    if (json == nullptr || tasks != 1) {
        std::fprintf(stderr,
                     "usage: %s --json FILE --png FILE     draws the rows of a file\n"
                     "       %s --json FILE --bench MS     measures, about MS milliseconds a figure, prints one line\n"
                     "       %s --json FILE --unchanged MS     the same for texts that are set to what they were\n"
                     "       %s --json FILE --labels COUNT     shapes the names alone, so many at a time\n",
                     argv[0], argv[0], argv[0], argv[0]);
        return 2;
    }
    qputenv("QT_QPA_PLATFORM", "offscreen");
    const QGuiApplication application(argc, argv);
    const auto file = readRowsFile(json);
    if (!file) {
        return 1;
    }
    if (file->friends.empty()) {
        std::fprintf(stderr, "%s: no friends\n", json);
        return 1;
    }
    if (png != nullptr) {
        return writePicture(scene, *file, png);
    }
    if (labels != nullptr) {
        return measureLabels(scene, *file, static_cast<std::size_t>(std::max(1, std::atoi(labels))));
    }
    return budget != nullptr ? measure(scene, *file, std::atof(budget))
                             : measureUnchanged(scene, *file, std::atof(unchanged));
}

}  // namespace ktr::bench
