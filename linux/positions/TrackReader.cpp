#include "linux/positions/TrackReader.h"

#include <QByteArray>
#include <QDateTime>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QXmlStreamReader>
#include <algorithm>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>

namespace ktr::linux_ {

namespace {

constexpr std::uintmax_t kLargestFile = std::uintmax_t{64} << 20;
constexpr double kSecondsBetween = 10.0;
constexpr double kMetresAtUnitDilution = 5.0;
constexpr double kOrdinaryAccuracy = 10.0;

struct Point {
    platform::PlatformLocation::Fix fix;
    std::optional<double> time;  ///< seconds since 1970
};

double numberOf(QStringView text) {
    bool read = false;
    const double number = text.trimmed().toDouble(&read);
    return read ? number : std::nan("");
}

/// Reads one point; the reader stands on its start tag.
Point readPoint(QXmlStreamReader& xml) {
    Point point;
    point.fix.coordinate = {numberOf(xml.attributes().value(QLatin1String("lat"))),
                            numberOf(xml.attributes().value(QLatin1String("lon")))};
    point.fix.horizontalAccuracy = kOrdinaryAccuracy;
    point.fix.verticalAccuracy = -1.0;
    point.fix.course = -1.0;
    point.fix.speed = -1.0;
    while (xml.readNextStartElement()) {
        const QString name = xml.name().toString();
        const QString text = xml.readElementText(QXmlStreamReader::SkipChildElements);
        const double number = numberOf(text);
        if (name == QLatin1String("time")) {
            const QDateTime time = QDateTime::fromString(text.trimmed(), Qt::ISODateWithMs);
            if (time.isValid()) {
                point.time = static_cast<double>(time.toMSecsSinceEpoch()) / 1000.0;
            }
        } else if (!std::isfinite(number)) {
            continue;
        } else if (name == QLatin1String("ele")) {
            point.fix.altitude = number;
            point.fix.verticalAccuracy = kOrdinaryAccuracy;
        } else if (name == QLatin1String("hdop")) {
            point.fix.horizontalAccuracy = number * kMetresAtUnitDilution;
        } else if (name == QLatin1String("course")) {
            point.fix.course = number;
        } else if (name == QLatin1String("speed")) {
            point.fix.speed = number;
        }
    }
    return point;
}

std::vector<TimedPosition> timed(const std::vector<Point>& points) {
    // Times count only when every point has one and none goes back.
    bool usable = !points.empty() && points.front().time.has_value();
    for (std::size_t i = 1; usable && i < points.size(); ++i) {
        usable = points[i].time.has_value() && *points[i].time >= *points[i - 1].time;
    }
    std::vector<TimedPosition> positions;
    for (std::size_t i = 0; i < points.size(); ++i) {
        const double seconds =
            usable ? *points[i].time - *points.front().time : static_cast<double>(i) * kSecondsBetween;
        positions.push_back({seconds, points[i].fix});
    }
    return positions;
}

}  // namespace

std::variant<std::vector<TimedPosition>, TrackReader::Error> TrackReader::readGpx(const std::string& text,
                                                                                  const std::string& file) {
    QXmlStreamReader xml(QByteArray::fromStdString(text));
    const auto place = [&] { return file + ":" + std::to_string(xml.lineNumber()) + ": "; };
    std::vector<Point> track;
    std::vector<Point> waypoints;
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement) {
            continue;
        }
        const QString name = xml.name().toString();
        const bool waypoint = name == QLatin1String("wpt");
        if (!waypoint && name != QLatin1String("trkpt") && name != QLatin1String("rtept")) {
            continue;
        }
        const std::string where = place();
        Point point = readPoint(xml);
        if (!platform::isValid(point.fix.coordinate)) {
            return Error{where + "expected a point with lat and lon in degrees"};
        }
        (waypoint ? waypoints : track).push_back(std::move(point));
    }
    if (xml.hasError()) {
        return Error{place() + xml.errorString().toStdString()};
    }
    if (track.empty() && waypoints.empty()) {
        return Error{file + ": expected a GPX file with at least one point"};
    }
    return timed(track.empty() ? waypoints : track);
}

std::variant<std::vector<TimedPosition>, TrackReader::Error> TrackReader::readScenario(const std::string& text,
                                                                                       const std::string& file) {
    QJsonParseError error;
    const QJsonDocument document = QJsonDocument::fromJson(QByteArray::fromStdString(text), &error);
    if (error.error != QJsonParseError::NoError || !document.isObject()) {
        return Error{file + ": expected a GPX file or a scenario: " + error.errorString().toStdString()};
    }
    const QJsonArray list = document.object().value(QLatin1String("positions")).toArray();
    std::vector<TimedPosition> positions;
    for (qsizetype i = 0; i < list.size(); ++i) {
        const QJsonObject entry = list[i].toObject();
        const auto number = [&](const char* name, double otherwise) {
            return entry.value(QLatin1String(name)).toDouble(otherwise);
        };
        TimedPosition position;
        position.seconds = number("at", 0.0);
        position.fix.coordinate = {number("latitude", std::nan("")), number("longitude", std::nan(""))};
        position.fix.horizontalAccuracy = number("accuracy", kOrdinaryAccuracy);
        position.fix.verticalAccuracy = -1.0;
        position.fix.course = -1.0;
        position.fix.speed = -1.0;
        if (!platform::isValid(position.fix.coordinate)) {
            return Error{file + ": $.positions[" + std::to_string(i) + "]: expected latitude and longitude in degrees"};
        }
        positions.push_back(position);
    }
    if (positions.empty()) {
        return Error{file + ": expected \"positions\" in the scenario"};
    }
    return positions;
}

std::variant<std::vector<TimedPosition>, TrackReader::Error> TrackReader::readFile(const std::string& file) {
    std::error_code failure;
    // Only a regular file has a size; a FIFO, once opened, would hold the program up.
    const auto size = std::filesystem::file_size(file, failure);
    if (!failure && size > kLargestFile) {
        return Error{file + ": the track is larger than 64 MiB"};
    }
    std::ifstream stream;
    if (!failure) {
        stream.open(file, std::ios::binary);
    }
    if (failure || !stream) {
        return Error{file + ": the track cannot be read"};
    }
    const std::string text{std::istreambuf_iterator<char>(stream), {}};
    const std::size_t first = text.find_first_not_of("\xEF\xBB\xBF \t\r\n");
    return first != std::string::npos && text[first] == '<' ? readGpx(text, file) : readScenario(text, file);
}

}  // namespace ktr::linux_
