// The part of the administration that is about the people's page.
#include "server/admin/Administration.h"
#include "server/admin/ServiceSettings.h"
#include "server/admin/TerminalCode.h"
#include "server/store/Secret.h"

namespace ktr::server {

std::string Administration::link(const std::string& name, bool isTerminal) {
    std::string complaint = open();
    const auto settings = complaint.empty() ? ServiceSettings::read(folder_, complaint) : std::nullopt;
    const auto who = settings ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto link = Secret::make();
    if (!link || !store_->addSignIn(who->id, *link, now_)) {
        return "the link could not be written";
    }
    const std::string address = settings->origin() + "/me/in?link=" + *link;
    out_ << "Whoever opens this within 15 minutes, once, is signed in as " << name << " for 30 days:\n  " << address
         << "\nPasted into ktr's page for signing in, or with ktr open, it signs ktr in instead.\n";
    const auto code = isTerminal ? QrCode::of(address) : std::nullopt;
    if (code) {
        out_ << terminalCode(*code, true);
    }
    return "";
}

}  // namespace ktr::server
