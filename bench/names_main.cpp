// What places are called: how long it takes to find out, cold and warm, and what is kept for it.
//
//   ktr-name-bench MAP.mbtiles LATITUDE,LONGITUDE [METRES]
//
// 1,000 places about the given one, streets and towns; then 1,000 places all over the earth, in every language.
#include <algorithm>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <random>
#include <string>
#include <vector>

#include "bench/ThreadTime.h"
#include "server/names/PlaceNames.h"
#include "server/page/PageTexts.h"

namespace {

using ktr::server::PlaceName;
using ktr::server::PlaceNames;
using Clock = std::chrono::steady_clock;

constexpr int kPlaces = 1000;
constexpr double kMetresADegree = 111195.0;

struct Figures {
    double mean = 0.0;  ///< milliseconds
    double most = 0.0;
    double mostComputed = 0.0;  ///< the same of one look-up without what else the machine did meanwhile
    int streets = 0;
    int towns = 0;
};

Figures measure(PlaceNames& names, const std::vector<PlaceNames::Place>& places, const std::string& language) {
    Figures figures;
    for (const PlaceNames::Place& place : places) {
        const auto begun = Clock::now();
        const double computed = ktr::bench::computed();
        const PlaceName name = names.name(place, {language, ""}, begun + std::chrono::hours(1));
        const double took = std::chrono::duration<double, std::milli>(Clock::now() - begun).count();
        figures.mostComputed = std::max(figures.mostComputed, ktr::bench::computed() - computed);
        figures.mean += took / kPlaces;
        figures.most = std::max(figures.most, took);
        figures.streets += name.street.empty() ? 0 : 1;
        figures.towns += name.town.empty() ? 0 : 1;
    }
    return figures;
}

void print(const char* what, const Figures& figures, const PlaceNames& names) {
    std::printf(
        "%-24s mean %8.4f ms, longest %8.3f ms (%8.3f of computing); %4d streets, %4d towns; %5.1f MB kept, %llu tiles "
        "read\n",
        what, figures.mean, figures.most, figures.mostComputed, figures.streets, figures.towns,
        static_cast<double>(names.bytes()) / 1e6, static_cast<unsigned long long>(names.tilesRead()));
}

double numberOf(std::string_view text) {
    double number = std::nan("");
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

}  // namespace

int main(int count, char** words) {
    const std::string at = count > 2 ? words[2] : "";
    const std::size_t comma = at.find(',');
    if (count < 3 || comma == std::string::npos) {
        std::fprintf(stderr, "ktr-name-bench MAP.mbtiles LATITUDE,LONGITUDE [METRES]\n");
        return 1;
    }
    const double latitude = numberOf(at);
    const double longitude = numberOf(std::string_view(at).substr(comma + 1));
    const double metres = count > 3 ? numberOf(words[3]) : 2000.0;
    std::mt19937 chance(1);
    std::uniform_real_distribution<double> share(-1.0, 1.0);
    std::vector<PlaceNames::Place> near, far;
    for (int number = 0; number < kPlaces; ++number) {
        const double north = share(chance) * metres / kMetresADegree;
        const double east = share(chance) * metres / kMetresADegree / std::cos(latitude * 3.14159265 / 180.0);
        near.push_back({latitude + north, longitude + east, true});
        far.push_back({std::asin(share(chance)) * 180.0 / 3.14159265, share(chance) * 180.0, true});
    }
    PlaceNames names({{words[1]}});
    for (const std::string& complaint : names.complaints()) {
        std::fprintf(stderr, "%s\n", complaint.c_str());
        return 1;
    }
    print("about the place, cold", measure(names, near, "en"), names);
    print("about the place, warm", measure(names, near, "en"), names);
    print("all over, cold", measure(names, far, "en"), names);
    print("all over, warm", measure(names, far, "en"), names);
    Figures all;
    for (const auto language : ktr::server::PageTexts::languages()) {
        measure(names, far, std::string(language));  // its names and formats
        const Figures one = measure(names, far, std::string(language));
        all.mean = std::max(all.mean, one.mean);
        all.most = std::max(all.most, one.most);
        all.mostComputed = std::max(all.mostComputed, one.mostComputed);
    }
    print("slowest of all languages", all, names);
    return 0;
}
