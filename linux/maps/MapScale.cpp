#include "linux/maps/MapScale.h"

#include <algorithm>
#include <array>

namespace ktr::linux_ {

namespace {

struct Row {
    double metres;
    MapScale::Width major, secondary, minor;
    double path;
};

/// From the farthest to the nearest. A casing as wide as its fill is not seen.
constexpr std::array<Row, 9> kRows = {{{600.0, {0.7, 0.7}, {0.0, 0.0}, {0.0, 0.0}, 0.0},
                                       {100.0, {1.4, 2.0}, {0.7, 0.7}, {0.0, 0.0}, 0.0},
                                       {25.0, {2.6, 3.6}, {1.4, 2.2}, {0.6, 0.6}, 0.0},
                                       {12.0, {3.8, 5.0}, {2.4, 3.4}, {1.1, 1.1}, 0.0},
                                       {6.0, {5.8, 7.6}, {4.2, 5.6}, {2.2, 3.0}, 0.0},
                                       {4.0, {7.6, 9.6}, {5.9, 7.4}, {4.0, 5.1}, 1.0},
                                       {2.2, {9.5, 12.0}, {7.4, 9.2}, {5.0, 6.4}, 1.2},
                                       {1.2, {15.0, 19.0}, {12.0, 15.0}, {8.0, 10.0}, 1.2},
                                       {0.9, {18.0, 23.0}, {14.0, 17.5}, {9.5, 12.0}, 1.4}}};
/// A service road is this much of a minor one.
constexpr double kServiceShare = 0.55;
/// Below this a line is not worth its noise; points.
constexpr double kThinnest = 0.3;
constexpr double kFarthestService = 6.0;
constexpr double kFarthestPath = 4.0;

/// Reads a column of the table between its rows.
double between(double metres, double (*column)(const Row&)) {
    if (metres >= kRows.front().metres) {
        return column(kRows.front());
    }
    for (std::size_t next = 1; next < kRows.size(); ++next) {
        const Row& far = kRows[next - 1];
        const Row& near = kRows[next];
        if (metres >= near.metres) {
            const double share = (metres - near.metres) / (far.metres - near.metres);
            return column(near) + (column(far) - column(near)) * share;
        }
    }
    return column(kRows.back());
}

}  // namespace

MapScale::Width MapScale::road(tiles::MapKind kind) const {
    Width width;
    switch (kind) {
        case tiles::MapKind::Major:
            width = {between(metres_, [](const Row& row) { return row.major.fill; }),
                     between(metres_, [](const Row& row) { return row.major.casing; })};
            break;
        case tiles::MapKind::Secondary:
            width = {between(metres_, [](const Row& row) { return row.secondary.fill; }),
                     between(metres_, [](const Row& row) { return row.secondary.casing; })};
            break;
        case tiles::MapKind::Minor:
        case tiles::MapKind::Service:
            width = {between(metres_, [](const Row& row) { return row.minor.fill; }),
                     between(metres_, [](const Row& row) { return row.minor.casing; })};
            break;
        case tiles::MapKind::Path:
            return {metres_ <= kFarthestPath ? between(metres_, [](const Row& row) { return row.path; }) : 0.0, 0.0};
        default:
            return {};
    }
    if (kind == tiles::MapKind::Service) {
        const double edge = width.casing - width.fill;
        width.fill = metres_ <= kFarthestService ? width.fill * kServiceShare : 0.0;
        width.casing = width.fill + edge;
    }
    if (width.fill < kThinnest) {
        return {};
    }
    if (width.casing < width.fill + 0.1) {
        width.casing = 0.0;
    }
    return width;
}

double MapScale::waterLine(double metres) const {
    if (metres < 5.0 && metres_ > 12.0) {
        return 0.0;
    }
    const double thinnest = metres < 5.0 ? 0.8 : 1.4;
    return std::clamp(metres / metres_, metres_ > 100.0 ? 0.6 : thinnest, 14.0);
}

double MapScale::lineFactor() const {
    return std::clamp(0.45 + 0.55 * (25.0 - metres_) / 19.0, 0.45, 1.0);
}

bool MapScale::showsNames(tiles::MapKind kind) const {
    switch (kind) {
        case tiles::MapKind::WaterName:
        case tiles::MapKind::Water:
        case tiles::MapKind::Place:
        case tiles::MapKind::BoundaryName:
            return true;
        case tiles::MapKind::WaterLine:
            return metres_ <= 25.0;
        case tiles::MapKind::Major:
            return metres_ <= 12.0;
        case tiles::MapKind::Secondary:
            return metres_ <= 6.0;
        case tiles::MapKind::Park:
        case tiles::MapKind::ParkName:
            return metres_ <= 4.0;
        case tiles::MapKind::Minor:
            return metres_ <= 2.2;
        case tiles::MapKind::Service:
        case tiles::MapKind::Square:
        case tiles::MapKind::Pier:
        case tiles::MapKind::PointOfInterest:
            return metres_ <= 1.2;
        default:
            return false;
    }
}

bool MapScale::showsPlace(tiles::PlaceRank rank) const {
    struct Span {
        double nearest;
        double farthest;
    };
    static constexpr std::array<Span, 9> kSpans = {{{400.0, 40000.0},  // Country
                                                    {250.0, 1500.0},
                                                    {8.0, 12000.0},
                                                    {8.0, 2500.0},
                                                    {4.0, 160.0},
                                                    {2.0, 50.0},
                                                    {3.0, 25.0},
                                                    {1.5, 12.0},
                                                    {1.0, 16.0}}};
    const auto& span = kSpans[std::min(static_cast<std::size_t>(rank), kSpans.size() - 1)];
    return metres_ >= span.nearest && metres_ <= span.farthest;
}

double MapScale::labelFactor() const {
    return std::clamp(1.0 + 0.2 * (2.2 - metres_), 1.0, 1.2);
}

}  // namespace ktr::linux_
