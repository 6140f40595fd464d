#include "linux/doctor/AccountChecks.h"

#include <netdb.h>

#include <algorithm>
#include <cmath>
#include <future>
#include <memory>

#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/ConfiguredAccountStore.h"
#include "linux/configuration/PreferencesFile.h"
#include "linux/net/ServiceCheck.h"
#include "linux/net/ServicePolicy.h"

namespace ktr::linux_::account_checks {

namespace {

using Finding = CheckUp::Finding;
using State = CheckUp::State;
using Cause = CheckUp::Cause;

constexpr double kMillisecondsASecond = 1000.0;
/// Ages are said in minutes: from here on they are wrong ones.
constexpr double kClocksApart = 30.0;
constexpr const char* kRedirectedHost = "RedirectedHostKey";

Finding fine(std::string thing, std::string words) {
    return {std::move(thing), State::Fine, std::move(words), {}};
}

Finding wrong(std::string thing, Cause cause, std::string words, std::string remedy, std::string detail = {}) {
    return {std::move(thing), State::Wrong, std::move(words), std::move(remedy), 0.0, cause, std::move(detail)};
}

bool hasHost(const Configuration& configuration) {
    return configuration.account && configuration.account->host;
}

Finding withoutAccount(std::string thing) {
    return {std::move(thing), State::NotUsed, "nobody is signed in", {}};
}

std::optional<std::string> tokenOf(const CheckUp::Places& places, std::string& problem) {
    ConfiguredAccountStore store(places.configuration);
    store.read();
    store.take();
    problem = store.problem();
    const auto account = store.deviceOwnerAccount();
    return account ? account->tokenOfType(platform::kFriendLocationService) : std::nullopt;
}

ServiceCheck::Result ask(const CheckUp::Places& places, const Configuration& configuration) {
    std::string problem;
    const auto token = tokenOf(places, problem);
    auto promise = std::make_shared<std::promise<ServiceCheck::Result>>();
    HttpsClient client;
    ServiceCheck::run(client,
                      {*configuration.account->host, configuration.account->personId, token.value_or("none"),
                       configuration.certificates, configuration.account->domains},
                      [promise](ServiceCheck::Result result) { promise->set_value(std::move(result)); });
    return promise->get_future().get();
}

}  // namespace

Finding configuration(const CheckUp::Places& places) {
    documents::DocumentWarnings warnings;
    const auto read = ConfigurationReader::readFile(places.configuration, &warnings);
    if (const auto* error = std::get_if<ConfigurationReader::Error>(&read)) {
        return wrong("settings", Cause::Settings, error->text,
                     "mend that line, or move the file away and sign in anew with: ktr show");
    }
    if (!warnings.empty()) {
        return wrong("settings", Cause::Settings, warnings.front().text(), "mend the name in that line");
    }
    return fine("settings", "they can be read");
}

Finding account(const Configuration& configuration) {
    if (!configuration.account) {
        return wrong("account", Cause::Nobody, "nobody is signed in", "ktr show");
    }
    if (!configuration.account->host) {
        return wrong("account", Cause::Nobody, "it names no service", "ktr config set account.host HOST");
    }
    const ServicePolicy policy(*configuration.account->host, configuration.account->domains);
    if (!policy.entriesForNobody().empty()) {
        return wrong("account", Cause::Settings, "an entry of account.domains allows nobody",
                     "ktr config get account.domains");
    }
    return fine("account", "somebody is signed in");
}

Finding secret(const CheckUp::Places& places, const Configuration& configuration) {
    if (!hasHost(configuration)) {
        return withoutAccount("secret");
    }
    std::string problem;
    return tokenOf(places, problem) ? fine("secret", "it can be read")
                                    : wrong("secret", Cause::Locked, problem.empty() ? "it cannot be read" : problem,
                                            "unlock the keyring, or sign in again with: ktr show");
}

Finding name(const Configuration& configuration) {
    if (!hasHost(configuration)) {
        return withoutAccount("name");
    }
    const auto origin = Origin::fromText(*configuration.account->host);
    if (!origin) {
        return wrong("name", Cause::Unreachable, "the service's host is none", "ktr config set account.host HOST",
                     *configuration.account->host);
    }
    addrinfo* found = nullptr;
    const int failure = ::getaddrinfo(origin->host.c_str(), nullptr, nullptr, &found);
    if (failure != 0) {
        return wrong("name", Cause::Unreachable,
                     "the service's name has no address: " + std::string(::gai_strerror(failure)),
                     "check the network, and the name with: ktr config get account.host", *configuration.account->host);
    }
    ::freeaddrinfo(found);
    return fine("name", origin->isAddress() ? "it is an address" : "it has an address");
}

Finding service(const CheckUp::Places& places, const Configuration& configuration) {
    if (!hasHost(configuration)) {
        return withoutAccount("service");
    }
    using Outcome = ServiceCheck::Outcome;
    const std::string& host = *configuration.account->host;
    const auto result = ask(places, configuration);
    const std::string why = result.reason.empty() ? std::string() : " (" + result.reason + ")";
    switch (result.outcome) {
        case Outcome::Fine:
            return {"service",
                    State::Fine,
                    "it answers after " + std::to_string(std::lround(result.seconds * kMillisecondsASecond)) + " ms",
                    {},
                    0.0,
                    Cause::None,
                    host + ", " + std::to_string(std::lround(result.seconds * kMillisecondsASecond)) + " ms"};
        case Outcome::BadAddress:
            return wrong("service", Cause::Unreachable, "its address is none", "ktr config set account.host HOST",
                         host);
        case Outcome::NothingAnswers:
            return wrong("service", Cause::Unreachable, "nothing answers there" + why,
                         "check the network, or ask whoever runs it", host);
        case Outcome::NotTrusted:
            return wrong("service", Cause::NotTrusted, "it cannot prove who it is, so nothing is sent" + why,
                         "ktr config set certificates FILE.pem, if it is your own; else ask whoever runs it", host);
        case Outcome::Unknown:
            return wrong("service", Cause::Unknown, "it does not know person and secret together",
                         "ktr show, and sign in again", host);
        case Outcome::NoService:
            return wrong("service", Cause::NoService, "something else answers there" + why,
                         "ktr config set account.host HOST", host);
        case Outcome::Failing:
            break;
    }
    return wrong("service", Cause::Failing, "it cannot help now" + why, "ask whoever runs it", host);
}

Finding clock(const CheckUp::Places& places, const Configuration& configuration) {
    if (!hasHost(configuration)) {
        return withoutAccount("clock");
    }
    const auto ahead = ask(places, configuration).ahead;
    if (!ahead) {
        return {"clock", State::NotUsed, "the service does not tell its time", {}};
    }
    const long apart = std::lround(std::abs(*ahead));
    if (std::abs(*ahead) > kClocksApart) {
        constexpr double kMinute = 60.0;
        return wrong("clock", *ahead > 0 ? Cause::ClockAhead : Cause::ClockBehind,
                     "this computer is " + std::to_string(apart) + " s " + (*ahead > 0 ? "ahead of" : "behind") +
                         " the service, so that ages are wrong",
                     "timedatectl set-ntp true", std::to_string(std::max(std::lround(std::abs(*ahead) / kMinute), 1L)));
    }
    return fine("clock", std::to_string(apart) + " s apart");
}

Finding redirect(const CheckUp::Places& places, const Configuration& configuration) {
    if (!hasHost(configuration)) {
        return withoutAccount("redirect");
    }
    const auto read = PreferencesFile::read(places.preferences);
    if (const auto* error = std::get_if<PreferencesFile::Error>(&read)) {
        return wrong("redirect", Cause::Redirect, error->text, "rm '" + places.preferences.string() + "'");
    }
    const auto& texts = std::get<PreferencesFile::Texts>(read);
    const auto host = texts.find(kRedirectedHost);
    if (host == texts.end() || host->second.empty()) {
        return fine("redirect", "commands go to the account's host");
    }
    const auto origin = Origin::fromText(host->second);
    const ServicePolicy policy(*configuration.account->host, configuration.account->domains);
    if (!origin || !policy.allows(*origin)) {
        return wrong("redirect", Cause::Redirect, "a host is remembered that the account does not allow",
                     "rm '" + places.preferences.string() + "'");
    }
    return fine("redirect", "commands go to a host of the service's");
}

}  // namespace ktr::linux_::account_checks
