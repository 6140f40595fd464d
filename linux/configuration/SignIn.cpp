#include "linux/configuration/SignIn.h"

#include <QCoreApplication>
#include <QMetaObject>
#include <optional>
#include <thread>

#include "documents/FileSteps.h"
#include "linux/configuration/ConfigurationFile.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/SecretModule.h"
#include "linux/configuration/SignInLink.h"
#include "linux/configuration/TokenChange.h"
#include "linux/configuration/TokenFile.h"
#include "linux/device/Buses.h"
#include "linux/device/LoadableModule.h"

namespace ktr::linux_ {

namespace {

using Outcome = SignIn::Outcome;

bool storeInKeyring(const std::string& person, const std::string& host, const std::string& secret,
                    const std::atomic<bool>& givesUp, std::string& problem) {
    void* entry = LoadableModule::entry("libktr-secret.so", kSecretModuleEntry, problem);
    if (entry == nullptr) {
        return false;
    }
    const std::unique_ptr<SecretModule> module(reinterpret_cast<SecretModuleEntry>(entry)());
    return module && module->store(person, host, secret, Buses::kSecretAlone, givesUp, problem);
}

Outcome outcomeOf(ServiceCheck::Outcome outcome) {
    switch (outcome) {
        case ServiceCheck::Outcome::Fine:
            return Outcome::Done;
        case ServiceCheck::Outcome::BadAddress:
            return Outcome::BadAddress;
        case ServiceCheck::Outcome::NothingAnswers:
            return Outcome::NothingAnswers;
        case ServiceCheck::Outcome::NotTrusted:
            return Outcome::NotTrusted;
        case ServiceCheck::Outcome::Unknown:
            return Outcome::Unknown;
        case ServiceCheck::Outcome::NoService:
            return Outcome::NoService;
        case ServiceCheck::Outcome::Failing:
            break;
    }
    return Outcome::Failing;
}

std::vector<std::string> certificatesOf(const std::filesystem::path& file) {
    const auto read = ConfigurationReader::readFile(file);
    const auto* configuration = std::get_if<Configuration>(&read);
    return configuration == nullptr ? std::vector<std::string>() : configuration->certificates;
}

std::optional<Configuration::Account> accountIn(const std::filesystem::path& file) {
    const auto read = ConfigurationReader::readFile(file);
    const auto* configuration = std::get_if<Configuration>(&read);
    return configuration == nullptr ? std::nullopt : configuration->account;
}

/// What the account of another service or person says does not hold for this one.
std::vector<ConfigurationFile::Change> changesFor(const std::optional<Configuration::Account>& before,
                                                  const std::string& person, const std::string& host) {
    std::vector<ConfigurationFile::Change> changes = {{"account.personId", platform::Value(person)},
                                                      {"account.host", platform::Value(host)},
                                                      // Where the secret is now is found without being told.
                                                      {"account.tokenFile", std::nullopt}};
    if (before && before->host != host) {
        changes.push_back({"account.domains", std::nullopt});
    }
    if (before && before->personId != person) {
        changes.push_back({"account.userName", std::nullopt});
    }
    return changes;
}

}  // namespace

struct SignIn::Attempt {
    std::filesystem::path file;
    Store store;
    Wish wish;
    std::string host;
    std::function<void(const Result&)> done;  ///< of the main thread
    std::atomic<bool> givesUp = false;
};

struct SignIn::Spent {
    std::string link;
    std::string person;
    std::string secret;
};

SignIn::SignIn(const std::filesystem::path& configurationFile) : SignIn(configurationFile, storeInKeyring) {}

SignIn::SignIn(const std::filesystem::path& configurationFile, Store store)
    : file_(documents::FileSteps::absolute(configurationFile)), store_(std::move(store)) {}

SignIn::~SignIn() {
    cancel();
}

void SignIn::cancel() {
    if (attempt_) {
        attempt_->givesUp = true;
        attempt_ = nullptr;
    }
}

void SignIn::begin(const Wish& wish, std::function<void(const Result&)> done) {
    cancel();
    attempt_ = std::make_shared<Attempt>();
    attempt_->file = file_;
    attempt_->store = store_;
    attempt_->wish = wish;
    attempt_->done = [this, done = std::move(done)](const Result& result) {
        attempt_ = nullptr;
        if (result.outcome == Outcome::Done) {
            spent_ = nullptr;
        }
        done(result);
    };
    if (!wish.link.empty()) {
        beginWithLink(wish);
        return;
    }
    const auto host = ServiceCheck::hostOf(wish.address);
    if (!host || wish.person.empty() || wish.person.find(':') != std::string::npos) {
        end(attempt_, {host ? Outcome::Unknown : Outcome::BadAddress, host.value_or(""), "it cannot be asked for"});
        return;
    }
    attempt_->host = *host;
    const auto before = accountIn(file_);
    const auto domains = before && before->host == *host ? before->domains : std::nullopt;
    ServiceCheck::run(client_, {*host, wish.person, wish.secret, certificatesOf(file_), domains},
                      [attempt = attempt_](const ServiceCheck::Result& found) { checked(attempt, found); });
}

void SignIn::beginWithLink(const Wish& wish) {
    const auto link = SignInLink::read(wish.link);
    if (!link) {
        end(attempt_, {Outcome::BadAddress, "", "it is no link for signing in"});
        return;
    }
    attempt_->host = link->host();
    const auto keepIt = [](const std::shared_ptr<Attempt>& attempt, const Spent& spent) {
        attempt->wish.person = spent.person;
        attempt->wish.secret = spent.secret;
        checked(attempt, {ServiceCheck::Outcome::Fine, "", 0.0, std::nullopt});
    };
    if (spent_ && spent_->link == wish.link && !spent_->secret.empty()) {
        keepIt(attempt_, *spent_);
        return;
    }
    if (!spent_ || spent_->link != wish.link) {
        spent_ = std::make_shared<Spent>(Spent{wish.link, "", ""});
    }
    link->exchange(client_, certificatesOf(file_),
                   [keepIt, attempt = attempt_, spent = spent_](const SignInLink::Exchanged& exchanged) {
                       QMetaObject::invokeMethod(
                           QCoreApplication::instance(),
                           [keepIt, attempt, spent, exchanged] {
                               // Whoever gave up may try again: the link is spent all the same.
                               if (exchanged.outcome == ServiceCheck::Outcome::Fine) {
                                   spent->person = exchanged.person;
                                   spent->secret = exchanged.secret;
                               }
                               if (attempt->givesUp) {
                                   return;
                               }
                               if (spent->secret.empty()) {
                                   end(attempt, {outcomeOf(exchanged.outcome), attempt->host, exchanged.reason});
                                   return;
                               }
                               keepIt(attempt, *spent);
                           },
                           Qt::QueuedConnection);
                   });
}

void SignIn::checked(const std::shared_ptr<Attempt>& attempt, const ServiceCheck::Result& found) {
    if (found.outcome != ServiceCheck::Outcome::Fine) {
        end(attempt, {outcomeOf(found.outcome), attempt->host, found.reason});
        return;
    }
    // A keyring may ask its owner for a password, for as long as that takes.
    std::thread([attempt] { end(attempt, keep(*attempt)); }).detach();
}

SignIn::Result SignIn::keep(Attempt& attempt) {
    Result result{Outcome::Done, attempt.host, {}};
    const Wish& wish = attempt.wish;
    if (!TokenFile::tokenIn(wish.secret)) {
        return {Outcome::Unknown, attempt.host, "no service gives such a secret"};
    }
    TokenChange token(attempt.file.parent_path() / "token");
    if (wish.place == Place::File) {
        result.reason = token.prepare(wish.secret);
    } else if (!attempt.store(wish.person, attempt.host, wish.secret, attempt.givesUp, result.reason)) {
        result.outcome = Outcome::NoKeyring;
        return result;
    } else {
        result.reason.clear();
    }
    if (result.reason.empty() && !attempt.givesUp) {
        const auto before = accountIn(attempt.file);
        const bool isSame =
            before && before->personId == wish.person && before->host == attempt.host && !before->tokenFile;
        // The same account's file is replaced in one step; any other would be sent to a service that it is not for.
        if (!isSame || wish.place != Place::File) {
            result.reason = token.takeAway();
        }
        if (result.reason.empty()) {
            result.reason = ConfigurationFile(attempt.file).change(changesFor(before, wish.person, attempt.host));
        }
        if (result.reason.empty()) {
            result.reason = token.finish();
        }
    }
    result.outcome = result.reason.empty() ? Outcome::Done : Outcome::NotWritten;
    return result;
}

void SignIn::end(const std::shared_ptr<Attempt>& attempt, Result result) {
    QMetaObject::invokeMethod(
        QCoreApplication::instance(),
        [attempt, result = std::move(result)] {
            if (!attempt->givesUp) {
                attempt->done(result);
            }
        },
        Qt::QueuedConnection);
}

}  // namespace ktr::linux_
