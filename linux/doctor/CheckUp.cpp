#include "linux/doctor/CheckUp.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cmath>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>

#include "documents/Words.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/doctor/AccountChecks.h"
#include "linux/doctor/SessionChecks.h"
#include "linux/net/ServiceCheck.h"
#include "platform/base/Json.h"

namespace ktr::linux_ {

namespace {

using Clock = std::chrono::steady_clock;

/// What the threads of a check-up leave behind; it outlives one that never ends.
struct Board {
    std::mutex mutex;
    std::condition_variable changed;
    std::vector<std::optional<CheckUp::Finding>> findings;
};

const char* nameOf(CheckUp::State state) {
    switch (state) {
        case CheckUp::State::Fine:
            return "fine";
        case CheckUp::State::Wrong:
            return "wrong";
        case CheckUp::State::NotUsed:
            break;
    }
    return "not used";
}

/// Where the service is; empty for none.
std::string hostOf(const Configuration& configuration) {
    return configuration.account ? configuration.account->host.value_or("") : "";
}

/// As JSON has it; empty for none.
const char* nameOf(CheckUp::Cause cause) {
    constexpr std::array kNames = {"",          "settings",   "nobody",        "locked",        "unreachable",
                                   "untrusted", "no-service", "failing",       "unknown",       "redirect",
                                   "ahead",     "behind",     "contacts",      "address-books", "position",
                                   "map",       "letters",    "screen-reader", "desktop"};
    return kNames[static_cast<std::size_t>(cause)];
}

}  // namespace

std::vector<CheckUp::Check> CheckUp::checks(const Places& places) {
    const auto read = ConfigurationReader::readFile(places.configuration);
    const auto* found = std::get_if<Configuration>(&read);
    const Configuration configuration = found == nullptr ? Configuration() : *found;
    const double usual = places.patience;
    // The secret goes first, then the answer.
    const double asking = usual + ServiceCheck::kDeadline;
    namespace own = account_checks;
    namespace around = session_checks;
    return {
        {"settings", usual, [=] { return own::configuration(places); }, "the disk does not answer", "check the disk",
         Cause::Settings},
        {"account", usual, [=] { return own::account(configuration); }, "it takes too long", "check the disk",
         Cause::Settings},
        {"secret", usual, [=] { return own::secret(places, configuration); }, "the keyring does not answer",
         "unlock the keyring, or keep the secret in a file: ktr show", Cause::Locked},
        {"name", usual, [=] { return own::name(configuration); }, "whoever knows names does not answer",
         "check the network", Cause::Unreachable, hostOf(configuration)},
        {"service", asking, [=] { return own::service(places, configuration); }, "it does not answer",
         "check the network, or ask whoever runs it", Cause::Unreachable, hostOf(configuration)},
        {"clock", asking, [=] { return own::clock(places, configuration); }, "the service does not answer",
         "check the network, or ask whoever runs it", Cause::Unreachable, hostOf(configuration)},
        {"redirect", usual, [=] { return own::redirect(places, configuration); }, "the disk does not answer",
         "check the disk", Cause::Settings},
        {"contacts", usual, [=] { return around::contacts(configuration); }, "they cannot be read in time",
         "ktr config get contacts", Cause::Contacts},
        {"address books", usual, [=] { return around::addressBooks(places, configuration); }, "they do not answer",
         "systemctl --user restart evolution-addressbook-factory evolution-source-registry", Cause::AddressBooks},
        {"position", usual, [=] { return around::positions(places, configuration); },
         "whoever tells it does not answer", "sudo systemctl restart geoclue", Cause::Position},
        {"maps", usual, [=] { return around::maps(places, configuration); }, "they cannot be read in time",
         "ktr config get maps.sources", Cause::Map},
        {"locale", usual, [=] { return around::locale(places); }, "the disk does not answer", "check the disk",
         Cause::Letters},
        {"screen reader", usual, [=] { return around::screenReader(places); }, "the session bus does not answer",
         "log out and in again", Cause::ScreenReader},
        {"portals", usual, [=] { return around::portals(places); }, "the portal does not answer",
         "systemctl --user restart xdg-desktop-portal", Cause::Desktop},
    };
}

std::vector<CheckUp::Finding> CheckUp::runAll(const std::vector<Check>& checks) {
    const auto board = std::make_shared<Board>();
    board->findings.resize(checks.size());
    const auto began = Clock::now();
    const auto since = [began] { return std::chrono::duration<double>(Clock::now() - began).count(); };
    for (std::size_t i = 0; i < checks.size(); ++i) {
        std::thread([board, i, look = checks[i].look, since] {
            Finding finding = look();
            finding.seconds = since();
            const std::lock_guard lock(board->mutex);
            board->findings[i] = std::move(finding);
            board->changed.notify_all();
        }).detach();
    }
    std::vector<Finding> told;
    std::unique_lock lock(board->mutex);
    for (std::size_t i = 0; i < checks.size(); ++i) {
        const auto until =
            began + std::chrono::duration_cast<Clock::duration>(std::chrono::duration<double>(checks[i].patience));
        board->changed.wait_until(lock, until, [&] { return board->findings[i].has_value(); });
        const Check& check = checks[i];
        told.push_back(board->findings[i] ? *board->findings[i]
                                          : Finding{check.thing, State::Wrong, check.silent, check.remedy,
                                                    check.patience, check.cause, check.detail});
    }
    return told;
}

std::vector<CheckUp::Finding> CheckUp::run(const Places& places) {
    std::vector<Finding> findings = runAll(checks(places));
    const auto beforeLocale = std::find_if(findings.begin(), findings.end(),
                                           [](const Finding& finding) { return finding.thing == "locale"; });
    findings.insert(beforeLocale, letters());
    return findings;
}

CheckUp::Finding CheckUp::letters() {
    return session_checks::letters();
}

bool CheckUp::isWell(const std::vector<Finding>& findings) {
    return std::none_of(findings.begin(), findings.end(),
                        [](const Finding& finding) { return finding.state == State::Wrong; });
}

std::string CheckUp::text(const std::vector<Finding>& findings) {
    constexpr std::size_t kColumn = 15;
    std::string text;
    for (const Finding& finding : findings) {
        const std::string thing = finding.thing + ":";
        text += std::string(finding.state == State::Wrong  ? "wrong  "
                            : finding.state == State::Fine ? "fine   "
                                                           : "-      ");
        text += thing + std::string(kColumn - std::min(thing.size(), kColumn - 1), ' ') +
                documents::forLine(finding.words, std::string::npos) + "\n";
        if (!finding.remedy.empty()) {
            text += "         " + std::string(finding.state == State::Wrong ? "mend it: " : "if wanted: ") +
                    documents::forLine(finding.remedy, std::string::npos) + "\n";
        }
    }
    return text;
}

std::string CheckUp::json(const std::vector<Finding>& findings) {
    platform::Value::Array all;
    for (const Finding& finding : findings) {
        all.push_back(platform::Dictionary{{"thing", finding.thing},
                                           {"state", nameOf(finding.state)},
                                           {"words", finding.words},
                                           {"remedy", finding.remedy},
                                           {"milliseconds", std::round(finding.seconds * 1000.0)},
                                           {"cause", nameOf(finding.cause)}});
    }
    const platform::Dictionary object{{"ok", isWell(findings)}, {"findings", std::move(all)}};
    return documents::jsonForTerminal(platform::writeJson(object)) + "\n";
}

}  // namespace ktr::linux_
