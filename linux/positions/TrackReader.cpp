#include "linux/positions/TrackReader.h"

#include "documents/DocumentReader.h"
#include "linux/positions/GpxPoints.h"
#include "linux/positions/ScenarioPositions.h"

namespace ktr::linux_ {

namespace {

using documents::DocumentError;
using Track = TrackReader::Track;

constexpr std::size_t kLargestFile = std::size_t{64} << 20;
constexpr double kSecondsBetween = 10.0;

Track timed(const std::vector<GpxPoints::Point>& points) {
    // Times count only when every point has one and none goes back.
    bool usable = !points.empty() && points.front().time.has_value();
    for (std::size_t i = 1; usable && i < points.size(); ++i) {
        usable = points[i].time.has_value() && *points[i].time >= *points[i - 1].time;
    }
    Track positions;
    for (std::size_t i = 0; i < points.size(); ++i) {
        const double seconds =
            usable ? *points[i].time - *points.front().time : static_cast<double>(i) * kSecondsBetween;
        positions.push_back({seconds, points[i].fix});
    }
    return positions;
}

}  // namespace

std::variant<Track, DocumentError> TrackReader::readGpx(const std::string& text, const std::string& file) {
    const auto read = GpxPoints::read(text, file);
    if (const auto* error = std::get_if<DocumentError>(&read)) {
        return *error;
    }
    const auto& points = std::get<GpxPoints>(read);
    if (points.track.empty() && points.waypoints.empty()) {
        return DocumentError{file, std::nullopt, "", "expected a GPX file with at least one point"};
    }
    return timed(points.track.empty() ? points.waypoints : points.track);
}

std::variant<Track, DocumentError> TrackReader::readScenario(const std::string& text, const std::string& file,
                                                             documents::DocumentWarnings* warnings) {
    Track track;
    const auto read = [&](documents::FieldReader& fields) {
        // The rest of a scenario is not this reader's.
        fields.leaveOthers();
        for (const ScenarioPosition& position : readScenarioPositions(fields)) {
            TimedPosition timed;
            timed.seconds = position.at;
            timed.fix.coordinate = position.coordinate;
            timed.fix.horizontalAccuracy = position.accuracy;
            timed.fix.verticalAccuracy = timed.fix.course = timed.fix.speed = -1.0;
            track.push_back(timed);
        }
        if (track.empty()) {
            fields.complain("", "expected a GPX file, or a scenario with \"positions\"");
        }
    };
    if (auto error = documents::DocumentReader::readText(text, file, read, warnings)) {
        return *std::move(error);
    }
    return track;
}

std::variant<Track, DocumentError> TrackReader::readFile(const std::string& file,
                                                         documents::DocumentWarnings* warnings) {
    const auto read = documents::DocumentReader::textOf(file, {kLargestFile, {}});
    if (const auto* error = std::get_if<DocumentError>(&read)) {
        return *error;
    }
    const auto& text = std::get<std::string>(read);
    const std::size_t first = documents::DocumentReader::withoutMark(text).find_first_not_of(" \t\r\n");
    const bool isGpx =
        first != std::string::npos && documents::DocumentReader::withoutMark(text).substr(first).starts_with('<');
    return isGpx ? readGpx(text, file) : readScenario(text, file, warnings);
}

}  // namespace ktr::linux_
