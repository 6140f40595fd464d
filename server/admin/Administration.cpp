#include "server/admin/Administration.h"

#include <algorithm>
#include <filesystem>

#include "documents/AtomicFile.h"
#include "documents/FileSteps.h"
#include "documents/NearestName.h"
#include "documents/Words.h"
#include "platform/base/Json.h"
#include "server/admin/ServiceSettings.h"
#include "server/http/CertificateAuthority.h"
#include "server/ingest/SealedText.h"
#include "server/rules/WallClock.h"
#include "server/store/Secret.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr long kAuthorityDays = 3650;
constexpr std::size_t kLongestName = 40;

/// A name goes into user names, answers and tables: one line, without the colon that ends a user name.
bool isName(const std::string& name) {
    return !name.empty() && name.size() <= kLongestName && name.front() != ' ' && name.back() != ' ' &&
           std::all_of(name.begin(), name.end(), [](char c) {
               const auto byte = static_cast<unsigned char>(c);
               return byte >= 0x20 && byte < 0x7F && c != ':';
           });
}

}  // namespace

std::string Administration::open() {
    std::string complaint;
    const auto settings = ServiceSettings::read(folder_, complaint);
    store_ = settings ? Store::open(settings->storeAddress(folder_), false, complaint) : nullptr;
    return store_ ? "" : complaint + " (is there a service? ktr-service init makes one)";
}

std::optional<Person> Administration::person(const std::string& name, std::string& complaint) {
    auto found = store_->personNamed(name);
    if (!found) {
        std::vector<std::string> names;
        for (const Person& one : store_->people()) {
            names.push_back(one.name);
        }
        complaint = "there is nobody called " + documents::inQuotes(name) + "; ktr-service people lists all" +
                    documents::didYouMean(name, names);
    }
    return found;
}

std::string Administration::init(const std::string& host, int port, const std::string& store) {
    if (!ServiceSettings::isHost(host)) {
        return "--host: expected a host name or an address, found " + documents::inQuotes(host);
    }
    if (!store.empty() && !StoreAddress::isServer(store)) {
        return "--store: expected an address such as postgresql:///ktr, found " + documents::inQuotes(store);
    }
    if (std::filesystem::exists(folder_ + "/settings.json")) {
        return folder_ + ": there is a service already";
    }
    std::string complaint = documents::AtomicFile::makeFolder(folder_);
    if (!complaint.empty()) {
        return complaint;
    }
    const ServiceSettings settings{host, port, store, {}};
    store_ = Store::open(settings.storeAddress(folder_), true, complaint);
    if (!store_) {
        return complaint;
    }
    const auto authority = CertificateAuthority::make("ktr-service", settings.constraint(), kAuthorityDays);
    complaint = authority ? authority->write(folder_) : "the certificate authority cannot be made";
    if (complaint.empty()) {
        complaint = settings.write(folder_);
    }
    if (complaint.empty()) {
        out_ << "service made in " << folder_ << "\nphones and readers reach it at " << settings.origin()
             << "\nand trust it by the certificate " << folder_ << "/ca.pem\n";
    }
    return complaint;
}

std::string Administration::addWithPhone(const Newcomer& who) {
    const std::string& name = who.name;
    std::string complaint = open();
    if (!complaint.empty()) {
        return complaint;
    }
    const auto settings = ServiceSettings::read(folder_, complaint);
    if (!settings) {
        return complaint;
    }
    if (!isName(name)) {
        return "expected a name of 1 to 40 plain letters without a colon, found " + documents::inQuotes(name);
    }
    for (const std::string& handle : who.handles) {
        const std::string plain = Store::normalisedHandle(handle);
        if (plain.size() < 3 || handle.size() > 254) {
            return "--handle: expected an e-mail address or a phone number, found " + documents::inQuotes(handle);
        }
        if (store_->personOf(handle)) {
            return "--handle: " + documents::inQuotes(handle) + " belongs to somebody else";
        }
    }
    if (!who.key.empty() && !SealedText::seal("", who.key)) {
        return "--key: expected at most 32 letters";
    }
    if (store_->personNamed(name)) {
        return documents::inQuotes(name) + " is there already";
    }
    const auto secret = Secret::make();
    if (!secret || !store_->addPerson(name, who.handles, now_)) {
        return "the person could not be written";
    }
    if (!store_->addDevice(store_->personNamed(name)->id, DeviceKind::Phone, *secret, who.key, now_, who.shared)) {
        return "the phone's secret could not be written";
    }
    out_ << name << " is added.\n";
    showPhone(PhoneSetUp::of(settings->origin(), name, *secret), who);
    return "";
}

std::string Administration::reader(const std::string& name, const std::string& tokenFile) {
    Dictionary configuration;
    std::string complaint = makeReader(name, tokenFile, configuration);
    if (complaint.empty()) {
        out_ << platform::writeJson(configuration) << "\n";
    }
    return complaint;
}

std::string Administration::makeReader(const std::string& name, const std::string& tokenFile,
                                       Dictionary& configuration) {
    std::string complaint = open();
    const auto settings = complaint.empty() ? ServiceSettings::read(folder_, complaint) : std::nullopt;
    const auto who = settings ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto secret = Secret::make();
    if (!secret || !store_->addDevice(who->id, DeviceKind::Reader, *secret, "", now_)) {
        return "the reader's secret could not be written";
    }
    complaint = documents::AtomicFile::write(tokenFile, *secret + "\n", 0600);
    if (!complaint.empty()) {
        return complaint;
    }
    const std::string origin = settings->origin();
    const Dictionary account{{"personId", name},
                             {"userName", who->handles.empty() ? name : who->handles.front()},
                             {"host", origin.substr(std::string("https://").size())},
                             {"tokenFile", documents::FileSteps::absolute(tokenFile).lexically_normal().string()}};
    const auto authority = documents::FileSteps::absolute(folder_ + "/ca.pem").lexically_normal().string();
    configuration = Dictionary{{"account", account}, {"certificates", Value::Array{authority}}};
    return "";
}

std::string Administration::befriend(const std::string& one, const std::string& other) {
    const std::string complaint = share(one, other, {});
    return complaint.empty() ? share(other, one, {}) : complaint;
}

std::string Administration::share(const std::string& owner, const std::string& viewer, const GrantWords& words) {
    std::string complaint = open();
    const auto from = complaint.empty() ? person(owner, complaint) : std::nullopt;
    const auto to = from ? person(viewer, complaint) : std::nullopt;
    if (!to) {
        return complaint;
    }
    if (from->id == to->id) {
        return "nobody shares with themselves";
    }
    const auto exactness = precisionOf(words.precision);
    if (!exactness) {
        return "--precision: expected exact, 1km, town or places, found " + documents::inQuotes(words.precision);
    }
    if (words.fences && *exactness != Precision::Exact) {
        return "--fences: only who sees somebody exactly can be told when they come and go";
    }
    Grant grant;
    grant.precision = *exactness;
    grant.from = store_->present(now_);
    grant.aloud = words.aloud;
    grant.fences = words.fences;
    if (!words.until.empty()) {
        grant.until = WallClock(from->zone).endingOf(words.until, now_);
        if (!grant.until) {
            return "--until: expected midnight, a time such as 18:30 or a date to come, found " +
                   documents::inQuotes(words.until);
        }
    }
    if (!words.arrival.empty()) {
        const auto place = placeNamed(*from, words.arrival, complaint);
        if (!place) {
            return complaint;
        }
        grant.arrival = place->id;
    }
    if (!store_->grant(from->id, to->id, grant)) {
        return "the grant could not be written";
    }
    out_ << viewer << " sees " << owner << ": " << wordsOf(*from, grant) << "\n";
    return "";
}

std::string Administration::revoke(const std::string& owner, const std::string& viewer) {
    std::string complaint = open();
    const auto from = complaint.empty() ? person(owner, complaint) : std::nullopt;
    if (!from) {
        return complaint;
    }
    if (viewer.empty()) {
        out_ << store_->revokeDevices(from->id, now_) << " secrets of " << owner << " ended\n";
        return "";
    }
    const auto to = person(viewer, complaint);
    if (!to) {
        return complaint;
    }
    if (!store_->revokeGrant(from->id, to->id)) {
        return viewer + " does not see " + owner;
    }
    out_ << viewer << " sees " << owner << " no more\n";
    return "";
}

std::string Administration::setHidden(const std::string& name, bool hidden) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    if (!store_->setHidden(who->id, hidden, now_)) {
        return "it could not be written";
    }
    out_ << name << (hidden ? " is hidden from everybody\n" : " is shown to those with a grant\n");
    return "";
}

std::string Administration::wordsOf(const Person& owner, const Grant& grant) {
    std::string words = wordOf(grant.precision);
    const auto places = grant.arrival == 0 ? std::vector<NamedPlace>() : store_->placesOf(owner.id);
    const auto place =
        std::find_if(places.begin(), places.end(), [&](const NamedPlace& one) { return one.id == grant.arrival; });
    if (place != places.end()) {
        words += " until at " + documents::forLine(place->name);
    }
    if (grant.until) {
        words += (place == places.end() ? " until " : ", at the latest ") + WallClock(owner.zone).face(*grant.until);
    }
    return words + (grant.aloud ? ", may be said aloud" : "") +
           (grant.fences ? ", may be told of coming and going" : "");
}

std::string Administration::people() {
    if (std::string complaint = open(); !complaint.empty()) {
        return complaint;
    }
    const std::int64_t present = store_->present(now_);
    for (const Person& person : store_->people()) {
        const auto heard = store_->lastHeard(person.id);
        const WallClock clock(person.zone);
        out_ << person.name << (person.hidden ? ", hidden" : "")
             << (heard ? ", last heard " + clock.face(*heard) : std::string(", never heard")) << "\n";
        for (const auto& [viewer, grant] : store_->grantsOf(person.id)) {
            out_ << "  seen by " << viewer << ": " << wordsOf(person, grant)
                 << (present >= grant.end() ? " (over)" : "");
            if (grant.asks(present)) {
                out_ << " (still meant? ends " << clock.face(grant.end()) << " unless ktr-service keep says so)";
            }
            out_ << "\n";
        }
    }
    return "";
}

std::string Administration::check() {
    std::string complaint = open();
    if (!complaint.empty()) {
        return complaint;
    }
    if (const std::string broken = store_->check(); !broken.empty()) {
        return "the store is damaged: " + broken;
    }
    const auto settings = ServiceSettings::read(folder_, complaint);
    if (!settings) {
        return complaint;
    }
    if (!CertificateAuthority::read(folder_, complaint)) {
        return complaint.empty() ? folder_ + "/ca.pem: is missing, damaged or about to expire" : complaint;
    }
    for (const std::string& broken : PlaceNames(settings->names()).complaints()) {
        complaint += (complaint.empty() ? "" : "; ") + broken;
    }
    if (complaint.empty()) {
        out_ << "the store is whole; the service is " << settings->origin() << "\n";
    }
    return complaint;
}

}  // namespace ktr::server
