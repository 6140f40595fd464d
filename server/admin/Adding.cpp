// `ktr-service add`.
#include <algorithm>
#include <filesystem>

#include "documents/AtomicFile.h"
#include "documents/Words.h"
#include "server/admin/Administration.h"

namespace ktr::server {

std::string Administration::add(const Newcomer& who) {
    std::string complaint = open();
    // Nothing is done when not all of it can be done.
    for (const std::string& name : who.friends) {
        if (complaint.empty() && name == who.name) {
            complaint = "nobody shares with themselves";
        } else if (complaint.empty()) {
            person(name, complaint);
        }
    }
    const std::filesystem::path folder = who.ktr;
    if (complaint.empty() && !who.ktr.empty()) {
        std::error_code failed;
        complaint = std::filesystem::exists(folder / "config.json", failed)
                        ? "--ktr: " + documents::inQuotes(who.ktr) +
                              " has a configuration already; name another folder, or move it away"
                        : documents::AtomicFile::makeFolder(folder);
    }
    if (complaint.empty()) {
        complaint = addWithPhone(who.name, who.handles, who.key, who.shared);
    }
    for (const std::string& name : who.friends) {
        complaint = complaint.empty() ? befriend(who.name, name) : complaint;
    }
    if (!complaint.empty() || who.ktr.empty()) {
        return complaint;
    }
    std::string configuration;
    complaint = makeReader(who.name, (folder / "token").string(), configuration);
    if (complaint.empty()) {
        complaint = documents::AtomicFile::write(folder / "config.json", configuration + "\n");
    }
    if (complaint.empty()) {
        out_ << "ktr asks as " << who.name << " with " << (folder / "config.json").string() << "\n";
    }
    return complaint;
}

}  // namespace ktr::server
