// The commands about what is kept, and for how long.
#include <charconv>
#include <filesystem>

#include "documents/AtomicFile.h"
#include "documents/Words.h"
#include "platform/base/Json.h"
#include "server/admin/Administration.h"
#include "server/admin/ServiceSettings.h"

namespace ktr::server {

namespace {

constexpr std::int64_t kHour = 3600;
constexpr std::int64_t kDay = 24 * kHour;

/// "90m", "24h", "7d" in seconds; none for anything else.
std::optional<std::int64_t> durationOf(std::string_view text) {
    std::int64_t count = 0;
    const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), count);
    const std::string_view unit = text.substr(static_cast<std::size_t>(stop - text.data()));
    const std::int64_t length = unit == "m" ? 60 : unit == "h" ? kHour : unit == "d" ? kDay : 0;
    const bool isDuration = error == std::errc() && length > 0 && count >= 0 && count < 1000000;
    return isDuration ? std::optional(count * length) : std::nullopt;
}

std::string wordsOfDuration(std::int64_t seconds) {
    const std::int64_t length = seconds % kDay == 0 ? kDay : seconds % kHour == 0 ? kHour : 60;
    const char* unit = length == kDay ? "d" : length == kHour ? "h" : "m";
    return std::to_string(seconds / length) + unit;
}

}  // namespace

std::string Administration::maps(const std::vector<std::string>& files, bool none) {
    std::string complaint;
    auto settings = ServiceSettings::read(folder_, complaint);
    if (!settings) {
        return complaint;
    }
    if (!files.empty() || none) {
        settings->maps.clear();
        for (const std::string& file : files) {
            std::error_code error;
            settings->maps.push_back(std::filesystem::absolute(file, error).lexically_normal().string());
        }
        for (const std::string& broken : PlaceNames(settings->names()).complaints()) {
            complaint += (complaint.empty() ? "" : "; ") + broken;
        }
        complaint = complaint.empty() ? settings->write(folder_) : complaint;
    }
    for (const std::string& map : complaint.empty() ? settings->maps : std::vector<std::string>()) {
        out_ << map << "\n";
    }
    if (complaint.empty() && settings->maps.empty()) {
        out_ << "no map: places are called by the nearest town of the world\n";
    }
    return complaint;
}

std::string Administration::backup(const std::string& file) {
    std::string complaint = open();
    if (complaint.empty()) {
        complaint = store_->backup(file);
    }
    if (complaint.empty()) {
        out_ << "the backup is in " << file
             << "\nIt has people, secrets as hashes, grants and named places, and nowhere "
             << "that anybody was. Keep a copy of settings.json, ca.pem and ca-key.pem with it: they do not change.\n";
    }
    return complaint;
}

std::string Administration::restore(const std::string& file, bool replace) {
    std::string complaint = open();
    if (!complaint.empty()) {
        return complaint;
    }
    std::error_code ignored;
    if (std::filesystem::equivalent(file, folder_ + "/service.db", ignored)) {
        return file + ": is the store itself";
    }
    if (!replace && !store_->people().empty()) {
        return "there are people already; --replace puts those of the backup in their place";
    }
    if (complaint = store_->restore(file, folder_, now_); !complaint.empty()) {
        return complaint;
    }
    out_ << store_->people().size() << " people are back. Everybody is hidden: each has to be shown again.\n"
         << "Readers do nothing until their person says that they are theirs: ktr-service confirm NAME\n";
    return "";
}

std::string Administration::confirm(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    out_ << "readers of " << name << " that work again: " << store_->confirm(who->id)
         << (who->hidden ? "; " + name + " is still hidden" : std::string()) << "\n";
    return "";
}

std::string Administration::exportPerson(const std::string& name, const std::string& file) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto everything = store_->everythingOf(who->id);
    if (!everything) {
        return "the store cannot be read";
    }
    complaint = documents::AtomicFile::write(file, platform::writeJson(*everything) + "\n", 0600);
    if (complaint.empty()) {
        out_ << "all that is kept of " << name << " is in " << file << "\n";
    }
    return complaint;
}

std::string Administration::forget(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    if (!store_->forget(who->id, now_)) {
        return "it could not be written";
    }
    out_ << name << " is forgotten: no backup brings them back. Friends' phones keep what they heard last.\n";
    return "";
}

std::string Administration::retention(const std::string& name, const std::string& fixes, const std::string& looks) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    auto kept = who ? store_->retention(who->id) : std::nullopt;
    if (!kept) {
        return complaint.empty() ? "the store cannot be read" : complaint;
    }
    if (!fixes.empty()) {
        kept->fixes = durationOf(fixes).value_or(0);
    }
    if (!looks.empty()) {
        kept->looks = durationOf(looks).value_or(0);
    }
    if (kept->fixes < kHour || kept->fixes > Retention::kLongestFixes) {
        return "--fixes: expected 1h to 48h, found " + documents::inQuotes(fixes);
    }
    if (kept->looks < kDay || kept->looks > Retention::kLongestLooks) {
        return "--looks: expected 1d to 30d, found " + documents::inQuotes(looks);
    }
    const bool isChange = !fixes.empty() || !looks.empty();
    if (isChange && !store_->setRetention(who->id, *kept, now_)) {
        return "it could not be written";
    }
    out_ << "where " << name << " was is kept for " << wordsOfDuration(kept->fixes) << ", who looked for "
         << wordsOfDuration(kept->looks) << "\n";
    return "";
}

}  // namespace ktr::server
