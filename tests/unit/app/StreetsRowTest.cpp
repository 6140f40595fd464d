// Where a map has no streets: the line under the card and on the friend's page of a live window, and where it leads.
// KTR_GALLERY names a folder for pictures.
#include "app/window/friend/StreetsRow.h"

#include <QApplication>
#include <QBuffer>
#include <QDeadlineTimer>
#include <QImage>
#include <QKeyEvent>
#include <algorithm>
#include <cmath>
#include <filesystem>
#include <memory>
#include <numbers>

#include "app/AddedMaps.h"
#include "app/window/friend/FriendPage.h"
#include "app/window/settings/SettingsPage.h"
#include "tests/support/maps/MbtilesWriter.h"
#include "tests/unit/app/LiveWindowFixture.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

/// East of Berlin, where no map that comes along has streets.
constexpr platform::Coordinate kNearBerlin{52.42, 13.95};
/// So far from any town that a map begins as far out as maps do.
constexpr platform::Coordinate kDesert{23.5, 10.5};
constexpr QRgb kMagenta = qRgb(255, 0, 255);

std::string annAt(const platform::Coordinate& place) {
    return R"({"question": "Where is Ann?", "sentence": "Ann is far away.", "clock": "2026-05-16T17:44:00+01:00",
    "snippet": {"kind": "VAKtrLocationSnippet", "searchContext": "ktrServerContext://serverContext?clientId=demo&",
    "locations": [{"friend": {"data": "ann@harbour.example", "object": {"fullName": "Ann Marsh", "firstName": "Ann",
     "emails": [{"emailAddress": "ann@harbour.example"}]}}, "accuracy": 30, "ageSeconds": 300, "city": "Grünheide",
     "latitude": )" +
           std::to_string(place.latitude) + R"(, "longitude": )" + std::to_string(place.longitude) + "}]}}";
}

class StreetsRowTest : public LiveWindowFixture {
  protected:
    void open(QSize size = {400, 780}, const std::string& members = R"(, "language": "en-GB")") {
        openWindow(size, members);
        addTurn(annAt(where));
    }
    void openAnn() const { host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example")); }
    std::shared_ptr<host::StreetsLine> line() const { return host->conversation()->turns().back()->streets(); }
    bool isOffered() const { return line() && !line()->hidden(); }
    FriendPage* friendPage() const { return dynamic_cast<FriendPage*>(window->pages().current()); }
    SettingsPage* settingsPage() const { return dynamic_cast<SettingsPage*>(window->pages().current()); }
    void key(int code) const {
        QKeyEvent event(QEvent::KeyPress, code, Qt::NoModifier);
        QApplication::sendEvent(&window->conversation(), &event);
    }
    /// A file with a map around Ann, all of one colour, from this level on.
    std::filesystem::path region(int coarsest = 9) const {
        const auto path = folder.path() / "region.mbtiles";
        QImage tile(256, 256, QImage::Format_RGB32);
        tile.fill(kMagenta);
        QByteArray png;
        QBuffer buffer(&png);
        buffer.open(QIODevice::WriteOnly);
        tile.save(&buffer, "PNG");
        test::MbtilesWriter writer(path.string());
        writer.makeTables();
        writer.putMetadata("format", "png");
        const auto corner = [this](double side) {
            return std::to_string(where.longitude + side) + "," + std::to_string(where.latitude + side * 0.4);
        };
        writer.putMetadata("bounds", corner(-0.5) + "," + corner(0.5));
        for (int level = coarsest; level <= 14; ++level) {
            const int count = 1 << level;
            const double latitude = where.latitude * std::numbers::pi / 180.0;
            const int x = static_cast<int>((where.longitude / 360.0 + 0.5) * count);
            const int y = static_cast<int>((0.5 - std::asinh(std::tan(latitude)) / (2.0 * std::numbers::pi)) * count);
            for (int dx = -3; dx <= 3; ++dx) {
                for (int dy = -3; dy <= 3; ++dy) {
                    writer.putTile({level, x + dx, y + dy}, png.toStdString());
                }
            }
        }
        return path;
    }
    /// How many pixels of what a widget shows are of the added map.
    static int pixelsOfTheMap(QWidget& widget) {
        const QImage picture = widget.grab().toImage().convertToFormat(QImage::Format_RGB32);
        int count = 0;
        for (int y = 0; y < picture.height(); ++y) {
            const auto* row = reinterpret_cast<const QRgb*>(picture.constScanLine(y));
            count += static_cast<int>(std::count(row, row + picture.width(), kMagenta));
        }
        return count;
    }

    platform::Coordinate where = kNearBerlin;
};

}  // namespace

TEST_F(StreetsRowTest, UnderACard_AKeyLeadsToWhereAMapIsAdded_AndTheMapTakesTheLineAway) {
    open();
    ASSERT_TRUE(eventually([this] { return isOffered(); }));
    keepPicture(*window, "streets-line");
    EXPECT_EQ(pixelsOfTheMap(*window), 0);
    auto& rows = window->conversation();
    EXPECT_TRUE(rows.focusRow(line()->action().get()));
    keepPicture(*window, "streets-line-focus");
    key(Qt::Key_Return);
    ASSERT_NE(settingsPage(), nullptr);
    auto* const adds = dynamic_cast<ListRow*>(settingsPage()->maps().rows().back());
    ASSERT_NE(adds, nullptr);
    QApplication::processEvents();
    EXPECT_TRUE(adds->hasFocus()) << "where a map is added";
    EXPECT_TRUE(adds->visibleRegion().contains(adds->rect().center())) << "and it is seen";
    keepPicture(*window, "streets-settings");
    settingsPage()->addMap(QString::fromStdString(region().string()));
    ASSERT_TRUE(eventually([this] { return settingsPage()->maps().rows().size() == 3; }));
    window->pages().back();
    EXPECT_TRUE(eventually([this] { return !isOffered() && pixelsOfTheMap(*window) > 10000; }));
    keepPicture(*window, "streets-line-gone");
}

TEST_F(StreetsRowTest, OnAFriendsPage_TheSameIsOffered_AndTheWayBackLeadsThere) {
    open();
    openAnn();
    ASSERT_NE(friendPage(), nullptr);
    auto& sheet = friendPage()->sheet();
    ASSERT_TRUE(eventually([&] { return sheet.streets().isVisible(); }));
    const FriendPage* const page = friendPage();
    keepPicture(*window, "streets-row");
    EXPECT_EQ(sheet.streets().action().words(), QStringLiteral("Get streets"));
    EXPECT_GE(sheet.streets().action().shape().height(), 44);
    EXPECT_LE(sheet.streets().geometry().bottom(), sheet.height());
    sheet.streets().action().press();
    ASSERT_NE(settingsPage(), nullptr);
    window->pages().back();
    ASSERT_EQ(friendPage(), page);
}

/// Also where the map begins farther out than anybody looks for streets, and where the new one has none from there.
TEST_F(StreetsRowTest, OnAFriendsPage_TheRowGoesOnceThereAreStreets_WhichAreShown) {
    for (const auto& [place, coarsest] : {std::pair(kNearBerlin, 9), std::pair(kDesert, 9), std::pair(kDesert, 13)}) {
        where = place;
        open();
        openAnn();
        ASSERT_NE(friendPage(), nullptr);
        auto& sheet = friendPage()->sheet();
        FriendMap& map = friendPage()->map();
        const auto across = [&map] { return map.shown().size.width * map.shown().metresPerPoint(); };
        ASSERT_TRUE(eventually([&] { return sheet.streets().isVisible() && across() > 10000.0; })) << place.latitude;
        const auto added = AddedMaps::add(region(coarsest).string());
        ASSERT_FALSE(std::holds_alternative<AddedMaps::Problem>(added)) << std::get<AddedMaps::Problem>(added).why;
        EXPECT_TRUE(eventually([&] { return !sheet.streets().isVisible(); })) << place.latitude;
        EXPECT_TRUE(eventually([&] { return across() < 2000.0 && pixelsOfTheMap(*window) > 10000; }));
        keepPicture(*window, "streets-row-gone-" + std::to_string(coarsest));
        std::filesystem::remove_all(folder.path() / "data");
        std::filesystem::remove(folder.path() / "region.mbtiles");
    }
}

TEST_F(StreetsRowTest, OnAFriendsPage_LookingElsewhereChangesNothingOfWhatIsSaidOfThePlace) {
    open();
    openAnn();
    auto& sheet = friendPage()->sheet();
    ASSERT_TRUE(eventually([&] { return sheet.streets().isVisible(); }));
    // So far out that nobody misses streets.
    for (int i = 0; i < 20; ++i) {
        friendPage()->map().step(false);
    }
    ASSERT_TRUE(eventually([&] { return friendPage()->map().isCoarsest(); }));
    const QDeadlineTimer drawn(1000);
    eventually([&] { return drawn.hasExpired(); });
    EXPECT_TRUE(sheet.streets().isVisible());
}

TEST_F(StreetsRowTest, EveryShapeAndLanguage_CutsNothing) {
    struct Case {
        QSize size;
        const char* name;
        const char* members;
    };
    for (const Case& one :
         {Case{{320, 640}, "de-320", R"(, "language": "de")"}, Case{{400, 700}, "ar", R"(, "language": "ar")"},
          Case{{320, 640}, "ja-dark", R"(, "language": "ja", "colors": "dark")"},
          Case{{320, 780}, "ax3", R"(, "language": "en-GB", "textSize": "AX3")"},
          Case{{900, 420}, "low-wide", R"(, "language": "en-GB")"},
          Case{{1600, 900}, "wide-dark", R"(, "language": "de", "colors": "dark")"},
          Case{{400, 700}, "contrast", R"(, "language": "en-GB", "colors": "high-contrast")"}}) {
        open(one.size, one.members);
        ASSERT_TRUE(eventually([this] { return isOffered(); })) << one.name;
        keepPicture(*window, std::string("streets-line-") + one.name);
        const auto words = line()->subviews().front()->frameInRoot();
        const auto action = line()->action()->frameInRoot();
        const auto whole = line()->frameInRoot();
        for (const auto& part : {words, action}) {
            EXPECT_GE(part.x, whole.x) << one.name;
            EXPECT_LE(part.maxX(), whole.maxX()) << one.name;
            EXPECT_GE(part.y, whole.y) << one.name;
            EXPECT_LE(part.maxY(), whole.maxY()) << one.name;
        }
        EXPECT_FALSE(words.intersects(action)) << one.name;
        openAnn();
        ASSERT_NE(friendPage(), nullptr);
        auto& streets = friendPage()->sheet().streets();
        ASSERT_TRUE(eventually([&] { return !streets.isHidden(); })) << one.name;
        QApplication::processEvents();
        const auto shapeOf = [](const Block& block) { return block.shape().translated(block.pos()); };
        EXPECT_FALSE(shapeOf(*streets.findChild<Words*>()).intersects(shapeOf(streets.action()))) << one.name;
        EXPECT_TRUE(streets.rect().contains(shapeOf(streets.action()))) << one.name;
        keepPicture(*window, std::string("streets-row-") + one.name);
    }
}

}  // namespace ktr::app
