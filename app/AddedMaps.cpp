#include "app/AddedMaps.h"

#include <algorithm>
#include <map>
#include <system_error>
#include <tuple>

#include "documents/AtomicFile.h"
#include "host/Resources.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/maps/MapFile.h"
#include "linux/maps/MbtilesLoader.h"
#include "tiles/TilesetFacts.h"

namespace ktr::app {

namespace {

namespace fs = std::filesystem;

constexpr const char* kEnding = ".mbtiles";

fs::path folder() {
    return linux_::XdgFolders::data() / "maps";
}

std::string fileName(const fs::path& place) {
    return tiles::TilesetFacts::plainText(place.stem().string());
}

/// What one program has made often bears that program's name.
void tellApart(std::vector<AddedMaps::Map>& maps) {
    std::map<std::string, int> times;
    for (const auto& map : maps) {
        ++times[map.name];
    }
    for (auto& map : maps) {
        if (const std::string file = fileName(map.place); times[map.name] > 1 && file != map.name) {
            map.name += " (" + file + ")";
        }
    }
}

/// A link takes the place of whatever is there in one step.
std::string link(const fs::path& file, const fs::path& place) {
    std::error_code failed;
    const fs::path beside = place.string() + ".new";
    fs::remove(beside, failed);
    fs::create_symlink(file, beside, failed);
    if (!failed) {
        fs::rename(beside, place, failed);
    }
    return failed ? failed.message() : "";
}

/// Empty when done.
std::string put(const fs::path& file, const fs::path& place) {
    std::error_code failed;
    bool isCopied = false;
    const fs::path copy = place.string() + ".copy";
    fs::remove(copy, failed);
    if (auto problem = linux_::MbtilesLoader::index(file.string(), copy.string(), isCopied); !problem.empty()) {
        return problem;
    }
    if (isCopied) {
        fs::rename(copy, place, failed);
        return failed ? failed.message() : "";
    }
    // Somebody who adds a map twice may give the place that it was added to.
    const bool isItself = !fs::is_symlink(place, failed) && fs::equivalent(file, place, failed);
    return isItself ? "" : link(file, place);
}

}  // namespace

std::vector<AddedMaps::Map> AddedMaps::list() {
    std::vector<Map> maps;
    std::error_code failed;
    for (fs::directory_iterator at(folder(), failed), end; !failed && at != end; at.increment(failed)) {
        if (at->path().extension() == kEnding) {
            std::error_code gone;
            const auto bytes = fs::file_size(at->path(), gone);
            maps.push_back({at->path(), nameOf(at->path()), gone ? 0 : bytes});
        }
    }
    tellApart(maps);
    std::sort(maps.begin(), maps.end(), [](const Map& one, const Map& other) {
        return std::tie(one.name, one.place) < std::tie(other.name, other.place);
    });
    return maps;
}

std::string AddedMaps::nameOf(const fs::path& place) {
    std::string error;
    const auto file = linux_::MbtilesLoader::open(place.string(), error);
    const std::string name = file ? tiles::TilesetFacts::of(file->metadata()).name : "";
    return name.empty() ? fileName(place) : name;
}

std::variant<std::string, AddedMaps::Problem> AddedMaps::add(const std::string& given) {
    std::error_code failed;
    const fs::path file = fs::canonical(given, failed);
    if (failed) {
        return Problem{failed.message()};
    }
    const auto read = linux_::MapFile::read(file.string(), host::resourceFolder() / "maps" / "world.bin",
                                            linux_::LocaleRegion::sessionLanguage());
    if (const auto* why = std::get_if<std::string>(&read)) {
        return Problem{*why};
    }
    // One of the same name takes the place of the earlier one.
    const fs::path place = folder() / (file.stem().string() + kEnding);
    if (auto problem = documents::AtomicFile::makeFolder(place.parent_path()); !problem.empty()) {
        return Problem{problem};
    }
    if (auto problem = put(file, place); !problem.empty()) {
        return Problem{problem};
    }
    return std::get<linux_::MapFile>(read).description();
}

std::string AddedMaps::remove(const fs::path& place) {
    std::error_code failed;
    fs::remove(place, failed);
    return failed ? failed.message() : "";
}

}  // namespace ktr::app
