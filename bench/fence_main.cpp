// How far fences are to be believed: the service's rule beside the naive one, over people who are made up, or over your
// own tracks.
//   ktr-fence-simulation [--hours N]
//   ktr-fence-simulation TRACK.gpx LATITUDE LONGITUDE [RADIUS]
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <iostream>
#include <string>
#include <vector>

#include "linux/positions/TrackReader.h"
#include "server/simulation/FenceSimulation.h"

namespace {

using ktr::linux_::TrackReader;
using ktr::server::FenceCircle;
using ktr::server::FenceCrossing;
using ktr::server::FenceSimulation;
using ktr::server::Fix;

constexpr double kHours = 10000.0;
constexpr int kCrossings = 1000;

void printResting(const char* name, const FenceSimulation::Rest& rest, double hours) {
    const auto tally = FenceSimulation(1).rest(rest, hours);
    std::printf("%-58s %9d %9d\n", name, tally.naive, tally.rule);
}

void printCrossing(const char* name, bool byCar) {
    const auto crossings = FenceSimulation(2).cross(kCrossings, byCar);
    std::printf("%-58s %9d %9d   late %d, false %d\n", name, crossings.naive, crossings.seen, crossings.late,
                crossings.unmeant);
}

int simulate(double hours) {
    std::printf("A fence of 100 m, %.0f hours; transitions by the naive rule, by this one.\n\n", hours);
    std::printf("%-58s %9s %9s\n", "at rest: all of them false", "naive", "rule");
    printResting("in the centre, a fix in 15 minutes", {0.0, 900, 165.0, 1}, hours);
    printResting("80 m from the centre, a fix in 15 minutes", {80.0, 900, 165.0, 1}, hours);
    printResting("400 m from the centre, a fix in 15 minutes", {400.0, 900, 165.0, 1}, hours);
    printResting("80 m, a fix in 10 seconds, jumps that last three fixes", {80.0, 10, 60.0, 3}, hours);
    std::printf("\n%-58s %9s %9s\n", "1,000 real crossings", "naive", "seen");
    printCrossing("on foot, a fix in 40 seconds", false);
    printCrossing("by car, a fix in 60 seconds", true);
    return EXIT_SUCCESS;
}

void print(const char* name, const std::vector<FenceCrossing>& crossings) {
    std::printf("%s: %zu\n", name, crossings.size());
    for (const FenceCrossing& crossing : crossings) {
        std::printf("  %s after %lld s\n", crossing.arrives ? "arrived" : "left",
                    static_cast<long long>(crossing.time));
    }
}

int follow(const std::string& file, const FenceCircle& circle) {
    const auto read = TrackReader::readFile(file);
    const auto* track = std::get_if<TrackReader::Track>(&read);
    if (track == nullptr) {
        std::cerr << std::get<ktr::documents::DocumentError>(read).text() << std::endl;
        return EXIT_FAILURE;
    }
    std::vector<Fix> fixes;
    for (const auto& point : *track) {
        const auto time = static_cast<std::int64_t>(std::floor(point.seconds));
        const double accuracy = point.fix.horizontalAccuracy;
        fixes.push_back({time, time, point.fix.coordinate.latitude, point.fix.coordinate.longitude,
                         accuracy > 0.0 ? std::optional(accuracy) : std::nullopt});
    }
    std::printf("%zu fixes\n", fixes.size());
    print("naive", FenceSimulation::naiveOn(circle, fixes));
    print("rule", FenceSimulation::ruleOn(circle, fixes));
    return EXIT_SUCCESS;
}

}  // namespace

int main(int count, char** words) {
    const std::vector<std::string> arguments(words + 1, words + count);
    if (arguments.empty()) {
        return simulate(kHours);
    }
    if (arguments.size() == 2 && arguments[0] == "--hours" && std::atof(words[2]) > 0.0) {
        return simulate(std::atof(words[2]));
    }
    if (arguments.size() == 3 || arguments.size() == 4) {
        const FenceCircle circle{std::atof(words[2]), std::atof(words[3]),
                                 arguments.size() == 4 ? std::atof(words[4]) : FenceCircle::kAdvisedRadius};
        return follow(arguments[0], circle);
    }
    std::cerr << "ktr-fence-simulation [--hours N] | TRACK.gpx LATITUDE LONGITUDE [RADIUS]" << std::endl;
    return EXIT_FAILURE;
}
