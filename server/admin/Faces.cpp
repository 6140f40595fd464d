// `ktr-service face`.
#include "documents/FileReader.h"
#include "documents/Words.h"
#include "server/admin/Administration.h"
#include "server/ingest/Face.h"

namespace ktr::server {

std::string Administration::face(const std::string& name, const std::string& file) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    std::string picture;
    if (!file.empty()) {
        const auto read = documents::FileReader::read(file, {Face::kMostGiven, {}});
        if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
            return documents::inQuotes(file) + ": " + error->reason;
        }
        const auto face = Face::cleaned(std::get<std::string>(read), complaint);
        if (!face) {
            return documents::inQuotes(file) + " " + complaint;
        }
        picture = *face;
    }
    if (!store_->setFace(who->id, picture)) {
        return "the face could not be written";
    }
    out_ << name << (picture.empty() ? " has no face any more\n" : " has this face from now on\n");
    return "";
}

}  // namespace ktr::server
