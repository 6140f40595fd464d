#include "bench/PictureMap.h"

#include <sqlite3.h>

#include <QBuffer>
#include <QByteArray>
#include <algorithm>
#include <cmath>

#include "linux/maps/MapDrawer.h"
#include "platform/map/Mercator.h"

namespace ktr::bench {

namespace {

constexpr int kCoarsest = 12;
constexpr int kFinest = 17;
constexpr double kSide = 256.0;
/// Tiles to each side of the middle one: at the finest level a picture with room to glide in.
constexpr int kAround = 8;

struct Row {
    int level, column, row;
};

bool insert(sqlite3* database, const Row& at, const QByteArray& data) {
    sqlite3_stmt* statement = nullptr;
    sqlite3_prepare_v2(database, "INSERT INTO tiles VALUES (?1, ?2, ?3, ?4)", -1, &statement, nullptr);
    sqlite3_bind_int(statement, 1, at.level);
    sqlite3_bind_int(statement, 2, at.column);
    sqlite3_bind_int(statement, 3, (1 << at.level) - 1 - at.row);
    sqlite3_bind_blob(statement, 4, data.constData(), static_cast<int>(data.size()), SQLITE_STATIC);
    const bool isDone = sqlite3_step(statement) == SQLITE_DONE;
    sqlite3_finalize(statement);
    return isDone;
}

QByteArray drawn(const std::shared_ptr<linux_::MapGround>& ground, const Row& at) {
    const double count = std::exp2(at.level);
    platform::MapPictureRequest request;
    request.viewport.centre = platform::mercatorCoordinate({(at.column + 0.5) / count, (at.row + 0.5) / count});
    request.viewport.zoom = at.level;
    request.viewport.size = {kSide, kSide};
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    if (const auto picture = linux_::MapDrawer::draw(request, {ground}, {})) {
        picture->whole().save(&buffer, "PNG");
    }
    return data;
}

}  // namespace

bool PictureMap::write(const std::string& path, const std::shared_ptr<linux_::MapGround>& ground,
                       const platform::Coordinate& centre) {
    sqlite3* database = nullptr;
    sqlite3_open(path.c_str(), &database);
    bool isGood = sqlite3_exec(database,
                               "PRAGMA synchronous=OFF; BEGIN; CREATE TABLE metadata (name TEXT, value TEXT);"
                               "INSERT INTO metadata VALUES ('format', 'png'), ('attribution', 'Drawn for the bench');"
                               "CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER,"
                               " tile_data BLOB);"
                               "CREATE UNIQUE INDEX tile_index ON tiles (zoom_level, tile_column, tile_row)",
                               nullptr, nullptr, nullptr) == SQLITE_OK;
    for (int level = kCoarsest; level <= kFinest && isGood; ++level) {
        const double count = std::exp2(level);
        const platform::Point middle = platform::mercatorPoint(centre);
        const int x = static_cast<int>(middle.x * count);
        const int y = static_cast<int>(middle.y * count);
        for (int column = x - kAround; column <= x + kAround && isGood; ++column) {
            for (int row = y - kAround; row <= y + kAround && isGood; ++row) {
                isGood = insert(database, {level, column, row}, drawn(ground, {level, column, row}));
            }
        }
    }
    isGood = isGood && sqlite3_exec(database, "COMMIT", nullptr, nullptr, nullptr) == SQLITE_OK;
    sqlite3_close(database);
    return isGood;
}

}  // namespace ktr::bench
