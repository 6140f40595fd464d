#include "server/names/StreetGrid.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <unordered_map>
#include <utility>

namespace ktr::server {

namespace {

using tiles::MapKind;
using tiles::MapTile;

constexpr double kCell = static_cast<double>(MapTile::kExtent) / 16.0;

/// Whether a feature's name is that of a street: lines that one walks or drives on, and squares by their edges.
bool isStreet(const MapTile::Feature& feature) {
    switch (feature.kind) {
        case MapKind::PierLine:
        case MapKind::Path:
        case MapKind::Service:
        case MapKind::Minor:
        case MapKind::Secondary:
        case MapKind::Major:
            return feature.shape == MapTile::Shape::Lines;
        case MapKind::Square:
            return feature.shape == MapTile::Shape::Areas;
        default:
            return false;
    }
}

bool isSmall(const MapTile::Spot& spot) {
    constexpr auto kMost = static_cast<float>(std::numeric_limits<std::int16_t>::max());
    return std::abs(spot.x) <= kMost && std::abs(spot.y) <= kMost;
}

std::int16_t whole(float coordinate) {
    return static_cast<std::int16_t>(std::lround(coordinate));
}

/// The share of a segment that lies between two values of one of its coordinates.
std::pair<double, double> shareBetween(double from, double to, double least, double most) {
    if (from == to) {
        return {0.0, 1.0};
    }
    const double one = std::clamp((least - from) / (to - from), 0.0, 1.0);
    const double other = std::clamp((most - from) / (to - from), 0.0, 1.0);
    return {std::min(one, other), std::max(one, other)};
}

}  // namespace

int StreetGrid::cellOf(double coordinate) {
    return std::clamp(static_cast<int>(std::floor(coordinate / kCell)), 0, kSide - 1);
}

StreetGrid::StreetGrid(const MapTile& tile) {
    std::unordered_map<std::string_view, std::uint32_t> numbers;
    for (const MapTile::Feature& feature : tile.features) {
        if (feature.name < 0 || !isStreet(feature)) {
            continue;
        }
        const std::string& name = tile.names[static_cast<std::size_t>(feature.name)];
        const auto [found, isNew] = numbers.emplace(name, static_cast<std::uint32_t>(names_.size()));
        if (isNew) {
            names_.push_back(name);
        }
        addFeature(tile, feature, found->second);
    }
    segments_.shrink_to_fit();
    names_.shrink_to_fit();
    sortIntoCells();
}

void StreetGrid::addFeature(const MapTile& tile, const MapTile::Feature& feature, std::uint32_t name) {
    const auto add = [&](const MapTile::Spot& from, const MapTile::Spot& to) {
        if (segments_.size() < kMostSegments && isSmall(from) && isSmall(to)) {
            segments_.push_back({whole(from.x), whole(from.y), whole(to.x), whole(to.y), name});
        }
    };
    for (std::uint32_t part = feature.firstPart; part < feature.firstPart + feature.partCount; ++part) {
        const std::uint32_t begin = tile.partBegin(part);
        const std::uint32_t end = tile.partEnds[part];
        for (std::uint32_t spot = begin; spot + 1 < end; ++spot) {
            add(tile.spots[spot], tile.spots[spot + 1]);
        }
        if (feature.shape == MapTile::Shape::Areas) {
            add(tile.spots[end - 1], tile.spots[begin]);
        }
    }
}

void StreetGrid::sortIntoCells() {
    // Of each segment the cells that it touches, row by row; what lies outside belongs to the cells at the edge.
    std::vector<std::pair<std::uint16_t, std::uint32_t>> touched;
    for (std::uint32_t number = 0; number < segments_.size() && touched.size() < kMostEntries; ++number) {
        const Segment& segment = segments_[number];
        const int lastRow = cellOf(std::max(segment.fromY, segment.toY));
        for (int row = cellOf(std::min(segment.fromY, segment.toY)); row <= lastRow; ++row) {
            const double top = row == 0 ? -std::numeric_limits<double>::infinity() : row * kCell;
            const double bottom = row == kSide - 1 ? std::numeric_limits<double>::infinity() : (row + 1) * kCell;
            const auto [begin, end] = shareBetween(segment.fromY, segment.toY, top, bottom);
            const double width = segment.toX - segment.fromX;
            const auto [left, right] = std::minmax({segment.fromX + begin * width, segment.fromX + end * width});
            const int lastColumn = cellOf(right);
            for (int column = cellOf(left); column <= lastColumn; ++column) {
                touched.emplace_back(static_cast<std::uint16_t>(row * kSide + column), number);
            }
        }
    }
    std::sort(touched.begin(), touched.end());
    ends_.assign(kCells, 0);
    entries_.reserve(touched.size());
    for (const auto& [cell, number] : touched) {
        ++ends_[cell];
        entries_.push_back(number);
    }
    for (std::size_t cell = 1; cell < kCells; ++cell) {
        ends_[cell] += ends_[cell - 1];
    }
}

double StreetGrid::distance(const Segment& segment, double x, double y) {
    const double width = segment.toX - segment.fromX;
    const double height = segment.toY - segment.fromY;
    const double length = width * width + height * height;
    const double share =
        length == 0.0 ? 0.0
                      : std::clamp(((x - segment.fromX) * width + (y - segment.fromY) * height) / length, 0.0, 1.0);
    return std::hypot(segment.fromX + share * width - x, segment.fromY + share * height - y);
}

std::optional<StreetGrid::Nearest> StreetGrid::nearest(double x, double y, double reach) const {
    if (entries_.empty()) {
        return std::nullopt;
    }
    const Segment* best = nullptr;
    double least = reach;
    for (int row = cellOf(y - reach); row <= cellOf(y + reach); ++row) {
        for (int column = cellOf(x - reach); column <= cellOf(x + reach); ++column) {
            const auto cell = static_cast<std::size_t>(row) * kSide + static_cast<std::size_t>(column);
            for (std::uint32_t entry = cell == 0 ? 0 : ends_[cell - 1]; entry < ends_[cell]; ++entry) {
                const Segment& segment = segments_[entries_[entry]];
                const double away = distance(segment, x, y);
                if (away < least || (best == nullptr && away <= least)) {
                    least = away;
                    best = &segment;
                }
            }
        }
    }
    return best == nullptr ? std::nullopt : std::optional(Nearest{names_[best->name], least});
}

std::size_t StreetGrid::bytes() const {
    std::size_t total = sizeof *this + segments_.capacity() * sizeof(Segment) +
                        (ends_.capacity() + entries_.capacity()) * sizeof(std::uint32_t) +
                        names_.capacity() * sizeof(std::string);
    for (const std::string& name : names_) {
        total += name.capacity();
    }
    return total;
}

}  // namespace ktr::server
