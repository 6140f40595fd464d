// A scenario in the whole program: how long its answer takes to open, how long a screenful takes to paint wherever it
// is scrolled to, and what filling its rows costs, part by part.
#include <malloc.h>
#include <QApplication>
#include <QImage>
#include <QPainter>
#include <algorithm>
#include <cstdio>
#include <functional>

#include "bench/ScenarioHost.h"
#include "bench/ThreadTime.h"
#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/paint/QtCanvas.h"
#include "model/ContactsUtilities.h"
#include "model/KTRVALocation.h"
#include "model/KTRVAUIUtils.h"
#include "platform/assistant/VALocation.h"
#include "platform/assistant/VASnippet.h"
#include "platform/ui/Window.h"
#include "views/KTRVelaFriendView.h"

namespace {

using namespace ktr;
using bench::timed;
using namespace ktr::platform;
/// Paints a screenful at many places of the conversation, as a window that is scrolled does.
void scroll(host::Host& host, double height) {
    constexpr double kScreen = 800.0;  // points
    constexpr double kScale = 2.0;
    constexpr int kPlaces = 300;
    const linux_::Palette palette = linux_::Palette::of(linux_::ColorScheme::Light);
    const double width = host.window()->bounds().width;
    QImage image(static_cast<int>(width * kScale), static_cast<int>(kScreen * kScale),
                 QImage::Format_ARGB32_Premultiplied);
    std::vector<double> times;
    for (int i = 0; i < kPlaces; ++i) {
        const double top = std::max(0.0, height - kScreen) * i / (kPlaces - 1);
        times.push_back(timed([&] {
            image.fill(palette.window);
            QPainter painter(&image);
            painter.setRenderHint(QPainter::Antialiasing);
            painter.scale(kScale, kScale);
            painter.translate(0.0, -top);
            painter.setClipRect(QRectF(0.0, top, width, kScreen));
            linux_::QtCanvas canvas(painter, palette);
            host.window()->paint(canvas, {0.0, top, width, kScreen});
        }));
    }
    std::sort(times.begin(), times.end());
    std::printf("scroll: a screenful of %.0f x %.0f points at scale %.0f takes %.2f ms (median), %.2f ms at most\n",
                width, kScreen, kScale, times[times.size() / 2], times.back());
}

/// Fills a row for each record: the first time, and again as at a refresh.
void fillRows(const host::Scenario& scenario) {
    const auto snippet = std::dynamic_pointer_cast<VAKtrLocationSnippet>(scenario.snippet);
    if (!snippet || !snippet->locations || scenario.positions.empty()) {
        return;
    }
    const auto at = scenario.positions.front();
    PlatformLocation::Fix fix;
    fix.coordinate = at.coordinate;
    fix.horizontalAccuracy = at.accuracy;
    const auto user = std::make_shared<PlatformLocation>(fix);
    struct Source : CurrentLocationDelegate {
        std::shared_ptr<PlatformLocation> location;
        std::shared_ptr<PlatformLocation> currentLocation() const override { return location; }
    };
    const auto source = std::make_shared<Source>();
    source->location = user;
    std::vector<std::shared_ptr<KTRVALocation>> records;
    std::vector<std::shared_ptr<KTRVelaFriendView>> rows;
    for (const auto& location : *snippet->locations) {
        if (auto record = KTRVALocation::locationWithVelaLocation(location)) {
            records.push_back(record);
            auto row = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{0.0, 0.0, 400.0, 0.0});
            row->setCurrentLocationDelegate(source);
            rows.push_back(std::move(row));
        }
    }
    const auto each = [&records](const char* name, const std::function<void(KTRVALocation&)>& work) {
        const auto all = [&] { std::for_each(records.begin(), records.end(), [&](auto& record) { work(*record); }); };
        const double first = timed(all);
        const double again = timed(all);
        const auto count = static_cast<double>(records.size());
        std::printf("  %-10s %8.2f us a record, again %8.2f\n", name, 1000.0 * first / count, 1000.0 * again / count);
    };
    std::printf("updateView of %zu records:\n", records.size());
    each("contact", [](KTRVALocation& record) { ContactsUtilities::contactForEmail(record.friendEmail()); });
    each("phone", [](KTRVALocation& record) { ContactsUtilities::contactForPhone(record.friendPhone()); });
    each("name", [](KTRVALocation& record) { record.friendName(); });
    each("place", [](KTRVALocation& record) { record.friendLocation(true); });
    each("distance", [&user](KTRVALocation& record) { record.distanceFromLocation(user); });
    each("age", [](KTRVALocation& record) {
        KTRVAUIUtils::dictionaryWithAgeStringsForDate({record.velaLocation()->locationDate.value_or(0.0)});
    });
    std::size_t next = 0;
    each("whole row", [&](KTRVALocation&) {
        const auto& row = rows[next];
        row->setLocation(records[next]);
        next = (next + 1) % rows.size();
    });
}

int run(const char* file) {
    const double heapBefore = static_cast<double>(mallinfo2().uordblks);
    std::variant<host::Scenario, documents::DocumentError> read = documents::DocumentError{};
    std::printf("read: %.1f ms\n", timed([&] { read = host::ScenarioReader(Date{}).readFile(file); }));
    const auto* scenario = std::get_if<host::Scenario>(&read);
    if (scenario == nullptr) {
        std::fprintf(stderr, "%s\n", std::get<documents::DocumentError>(read).text().c_str());
        return 1;
    }
    const auto made = bench::hostFor(file, *scenario, host::Host::Time::Virtual);
    if (!made) {
        return 1;
    }
    host::Host& host = *made;
    std::optional<host::Failure> failure;
    const double added = timed([&] { failure = host.addTurn(*scenario); });
    if (failure) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return 1;
    }
    double height = 0.0;
    const double laidOut = timed([&] { height = host.layOut(400.0); });
    std::printf("open: rows made and filled %.1f ms, laid out %.1f ms\n", added, laidOut);
    const double settled = timed([&] { height = host.settle(400.0); });
    std::printf("settle: %.1f ms until nothing is due; %.0f points high\n", settled, height);
    std::printf("memory: %.1f MB\n", (static_cast<double>(mallinfo2().uordblks) - heapBefore) / 1e6);
    scroll(host, height);
    fillRows(*scenario);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    return bench::runScenario(argc, argv, run);
}
