#include "linux/maps/WorldMap.h"

#include <algorithm>
#include <cstring>
#include <variant>

#include <libdeflate.h>

#include "documents/FileReader.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

constexpr unsigned char kMagic[] = {'K', 'T', 'R', 'W', 'O', 'R', 'L', 'D', 2};
constexpr std::size_t kHeader = sizeof(kMagic) + 4;
constexpr std::size_t kMostBytes = std::size_t{16} << 20;
constexpr int kPlaceBits = 22;

}  // namespace

/// Numbers of seven bits a byte, lowest first. What is read beyond the end, or makes no sense, is nothing, and the data
/// counts as damaged.
class WorldMap::Reader {
  public:
    explicit Reader(const std::vector<unsigned char>& data) : data_(data) {}

    bool isGood() const { return good_; }
    bool isAtEnd() const { return good_ && at_ == data_.size(); }

    std::uint64_t number(std::uint64_t most) {
        std::uint64_t value = 0;
        for (unsigned shift = 0; shift < 35; shift += 7) {
            if (at_ == data_.size()) {
                break;
            }
            const unsigned char byte = data_[at_++];
            value |= static_cast<std::uint64_t>(byte & 0x7FU) << shift;
            if (byte < 0x80) {
                good_ = good_ && value <= most;
                return good_ ? value : 0;
            }
        }
        good_ = false;
        return 0;
    }
    /// How many things follow, each of at least one byte.
    std::size_t count() { return static_cast<std::size_t>(number(data_.size() - at_)); }
    std::int64_t difference() {
        const auto value = static_cast<std::int64_t>(number(std::uint64_t{1} << 26));
        return value % 2 == 0 ? value / 2 : -(value + 1) / 2;
    }
    std::string text() {
        const std::size_t length = count();
        if (!good_) {
            return {};
        }
        std::string found(data_.begin() + static_cast<std::ptrdiff_t>(at_),
                          data_.begin() + static_cast<std::ptrdiff_t>(at_ + length));
        at_ += length;
        return found;
    }
    QPointF place() {
        const double side = 1 << kPlaceBits;
        const double x = static_cast<double>(number(1U << kPlaceBits));
        return {x / side, static_cast<double>(number(1U << kPlaceBits)) / side};
    }
    double zoom() { return static_cast<double>(number(240)) / 10.0; }

    Line line(int bits) {
        Line made;
        const std::size_t points = count();
        made.points.reserve(points);
        const std::int64_t side = std::int64_t{1} << bits;
        std::int64_t x = 0;
        std::int64_t y = 0;
        for (std::size_t i = 0; i < points && good_; ++i) {
            x += difference();
            y += difference();
            good_ = good_ && x >= -side && x <= 2 * side && y >= 0 && y <= side;
            // What ends at the square's lower edge ends at the pole: no shore stands there.
            const double down = y == side ? 3.0 : static_cast<double>(y) / static_cast<double>(side);
            made.points.emplace_back(static_cast<double>(x) / static_cast<double>(side), down);
        }
        finish(made);
        return made;
    }

    std::vector<Line> lines(int bits) {
        std::vector<Line> made;
        for (std::size_t left = count(); left > 0 && good_; --left) {
            made.push_back(line(bits));
        }
        return made;
    }

  private:
    static void finish(Line& line) {
        const std::size_t points = line.points.size();
        for (std::size_t from = 0; from < points; from += Line::kStretch) {
            QPointF least = line.points[from];
            QPointF most = least;
            for (std::size_t i = from; i < std::min(points, from + Line::kStretch); ++i) {
                const QPointF& point = line.points[i];
                least = {std::min(least.x(), point.x()), std::min(least.y(), point.y())};
                most = {std::max(most.x(), point.x()), std::max(most.y(), point.y())};
            }
            line.stretches.emplace_back(least, most);
        }
        if (points == 0) {
            return;
        }
        QPointF least = line.stretches.front().topLeft();
        QPointF most = line.stretches.front().bottomRight();
        for (const QRectF& stretch : line.stretches) {
            least = {std::min(least.x(), stretch.left()), std::min(least.y(), stretch.top())};
            most = {std::max(most.x(), stretch.right()), std::max(most.y(), stretch.bottom())};
        }
        line.bounds = QRectF(least, most);
    }

    const std::vector<unsigned char>& data_;
    std::size_t at_ = 0;
    bool good_ = true;
};

std::shared_ptr<const WorldMap> WorldMap::read(const std::filesystem::path& file, std::string& reason) {
    const auto read = documents::FileReader::read(file, {kMostBytes, {}});
    if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
        reason = error->reason;
        return nullptr;
    }
    const auto& data = std::get<std::string>(read);
    return parse({data.begin(), data.end()}, reason);
}

std::shared_ptr<const WorldMap> WorldMap::readOrReport(const std::filesystem::path& file, std::string_view missing) {
    std::string reason;
    auto map = read(file, reason);
    if (!map) {
        platform::areaLog(platform::LogArea::Maps)
            .write(
                platform::LogLevel::Error,
                "The built-in map %@ cannot be used: %@. %@; it comes with ktr: install it again, or name the folder "
                "that has maps/world.bin in KTR_RESOURCES",
                platform::FormatArgument(file.string()).shown(), platform::FormatArgument(reason).shown(),
                platform::FormatArgument(missing).shown());
    }
    return map;
}

std::shared_ptr<const WorldMap> WorldMap::parse(const std::vector<unsigned char>& data, std::string& reason) {
    if (data.size() < kHeader || std::memcmp(data.data(), kMagic, sizeof(kMagic)) != 0) {
        reason = "it is no map of the world";
        return nullptr;
    }
    std::size_t size = 0;
    for (std::size_t i = 0; i < 4; ++i) {
        size |= static_cast<std::size_t>(data[sizeof(kMagic) + i]) << (8 * i);
    }
    reason = "it is damaged";
    if (size > kMostBytes) {
        return nullptr;
    }
    std::vector<unsigned char> plain(size);
    const std::unique_ptr<libdeflate_decompressor, decltype(&libdeflate_free_decompressor)> inflate(
        libdeflate_alloc_decompressor(), &libdeflate_free_decompressor);
    if (!inflate || libdeflate_zlib_decompress(inflate.get(), data.data() + kHeader, data.size() - kHeader,
                                               plain.data(), plain.size(), nullptr) != LIBDEFLATE_SUCCESS) {
        return nullptr;
    }
    Reader reader(plain);
    auto map = std::make_shared<WorldMap>();
    for (std::size_t levels = reader.count(); levels > 0 && reader.isGood(); --levels) {
        Level& level = map->levels_.emplace_back();
        level.zoom = reader.zoom();
        const int bits = static_cast<int>(reader.number(kPlaceBits));
        level.shores = reader.lines(bits);
        level.borders = reader.lines(bits);
    }
    for (std::size_t count = reader.count(); count > 0 && reader.isGood(); --count) {
        Country& country = map->countries_.emplace_back();
        country.middle = reader.place();
        country.number = static_cast<int>(reader.number(999));
        country.zoom = reader.zoom();
        country.name = reader.text();
    }
    for (std::size_t count = reader.count(); count > 0 && reader.isGood(); --count) {
        Town& town = map->towns_.emplace_back();
        town.place = reader.place();
        town.zoom = reader.zoom();
        town.isCapital = reader.number(1) == 1;
        town.name = reader.text();
        town.zone = reader.text();
    }
    Outline& outline = map->outline_;
    for (auto* lines : {&outline.coasts, &outline.borders, &outline.cityBorders, &outline.foreignShores}) {
        *lines = reader.lines(kPlaceBits);
    }
    if (!reader.isAtEnd() || map->levels_.empty()) {
        return nullptr;
    }
    reason.clear();
    return map;
}

const WorldMap::Level& WorldMap::levelFor(double zoom) const {
    const auto enough =
        std::find_if(levels_.begin(), levels_.end(), [&](const Level& level) { return level.zoom >= zoom; });
    return enough == levels_.end() ? levels_.back() : *enough;
}

}  // namespace ktr::linux_
