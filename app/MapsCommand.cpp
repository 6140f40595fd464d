#include "app/MapsCommand.h"

#include <cstdio>
#include <filesystem>
#include <system_error>

#include "app/Messages.h"
#include "documents/AtomicFile.h"
#include "documents/Words.h"
#include "host/Resources.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/maps/MapFile.h"
#include "linux/maps/MbtilesLoader.h"

namespace ktr::app {

namespace {

namespace fs = std::filesystem;

host::ExitCode fail(const std::string& file, const std::string& why) {
    tell(documents::forLine(file) + ": " + documents::forLine(why));
    return host::ExitCode::Failure;
}

/// Where the map stands among those that were added. One of the same name takes the place of the earlier one.
fs::path placeFor(const fs::path& file) {
    return linux_::XdgFolders::data() / "maps" / (file.stem().string() + ".mbtiles");
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

host::ExitCode MapsCommand::add(const std::string& given) {
    std::error_code failed;
    const fs::path file = fs::canonical(given, failed);
    if (failed) {
        return fail(given, failed.message());
    }
    const auto read = linux_::MapFile::read(file.string(), host::resourceFolder() / "maps" / "world.bin",
                                            linux_::LocaleRegion::sessionLanguage());
    if (const auto* why = std::get_if<std::string>(&read)) {
        return fail(given, *why);
    }
    const fs::path place = placeFor(file);
    if (auto problem = documents::AtomicFile::makeFolder(place.parent_path()); !problem.empty()) {
        return fail(given, problem);
    }
    if (auto problem = put(file, place); !problem.empty()) {
        return fail(given, problem);
    }
    const std::string line = std::get<linux_::MapFile>(read).description();
    const bool isSaid = std::printf("%s: %s\n", documents::forLine(file.filename().string()).c_str(),
                                    documents::forLine(line, std::string::npos).c_str()) >= 0;
    return isSaid && std::fflush(stdout) == 0 ? host::ExitCode::Ok : host::ExitCode::Failure;
}

}  // namespace ktr::app
