// `ktr-service add`.
#include <algorithm>
#include <filesystem>

#include "documents/AtomicFile.h"
#include "documents/FileSteps.h"
#include "documents/VCard.h"
#include "documents/Words.h"
#include "platform/base/Json.h"
#include "server/admin/Administration.h"
#include "server/admin/TerminalCode.h"
#include "server/page/QrCode.h"

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
        complaint = addWithPhone(who);
    }
    for (const std::string& name : who.friends) {
        complaint = complaint.empty() ? befriend(who.name, name) : complaint;
    }
    if (!complaint.empty() || who.ktr.empty()) {
        return complaint;
    }
    platform::Dictionary configuration;
    complaint = makeReader(who.name, (folder / "token").string(), configuration);
    if (complaint.empty() && !who.friends.empty()) {
        const auto cards = documents::FileSteps::absolute(who.ktr).lexically_normal() / "friends.vcf";
        complaint = documents::AtomicFile::write(cards, contactsOf(who.friends), 0600);
        configuration.set("contacts", platform::Value::Array{cards.string()});
    }
    if (complaint.empty()) {
        complaint = documents::AtomicFile::write(folder / "config.json", platform::writeJson(configuration) + "\n");
    }
    if (complaint.empty()) {
        out_ << "ktr asks as " << who.name << " with " << (folder / "config.json").string() << "\n";
    }
    return complaint;
}

std::string Administration::contactsOf(const std::vector<std::string>& names) {
    std::string cards;
    for (const std::string& name : names) {
        std::string complaint;
        const auto someone = person(name, complaint);
        if (!someone) {
            continue;
        }
        documents::VCard card{someone->name, {}, someone->name, {}, {}};
        for (const std::string& handle : someone->handles) {
            (handle.find('@') != std::string::npos ? card.emails : card.phones).push_back(handle);
        }
        cards += card.text();
    }
    return cards;
}

void Administration::showPhone(const PhoneSetUp& phone, const Newcomer& who) {
    out_ << "In the phone's tracker, OwnTracks, choose the mode HTTP and type:\n  URL       " << phone.url
         << "\n  User name " << phone.user << "\n  Password  " << phone.password
         << "\nThe password is not shown again. The first place comes when the phone reports: an Android phone every 15"
            " minutes\nwhile it rests, an iPhone when it has moved. Trackers that know only a URL take this one:\n  "
         << phone.address() << "\n";
    const auto code = who.code ? QrCode::of(phone.link()) : std::nullopt;
    if (code) {
        out_ << "Or let the phone's camera read this, once the app's settings allow configuration from outside:\n"
             << terminalCode(*code, who.coloured);
    }
}

}  // namespace ktr::server
