#include "linux/configuration/ConfiguredAccountStore.h"

#include <utility>
#include <variant>

#include "documents/FileSteps.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/SecretModule.h"
#include "linux/configuration/TokenFile.h"
#include "linux/device/Buses.h"
#include "linux/device/LoadableModule.h"
#include "linux/net/ServicePolicy.h"
#include "platform/base/LogArea.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::linux_ {

namespace {

void sayEntriesForNobody(const Configuration::Account& account) {
    const ServicePolicy policy(account.host.value_or(""), account.domains);
    for (const std::string& entry : policy.entriesForNobody()) {
        platform::areaLog(platform::LogArea::Account)
            .write(platform::LogLevel::Error,
                   "The entry \"%@\" of account.domains allows nobody: it is no host, or a domain in "
                   "which anybody can have a name",
                   platform::FormatArgument(entry).shown());
    }
}

}  // namespace

class ConfiguredAccountStore::OwnerAccount : public platform::DeviceOwnerAccount {
  public:
    OwnerAccount(Configuration::Account account, std::optional<std::string> token)
        : account_(std::move(account)), token_(std::move(token)) {}

    std::optional<std::string> personIdentifier() const override { return account_.personId; }
    std::optional<std::string> userName() const override { return account_.userName; }
    std::optional<std::string> tokenOfType(int type) const override {
        return type == platform::kFriendLocationService ? token_ : std::nullopt;
    }
    std::optional<std::string> hostNameOfType(int type) const override {
        return type == platform::kFriendLocationService ? account_.host : std::nullopt;
    }
    bool operator==(const OwnerAccount& other) const { return account_ == other.account_ && token_ == other.token_; }

  private:
    Configuration::Account account_;
    std::optional<std::string> token_;
};

ConfiguredAccountStore::ConfiguredAccountStore(const std::filesystem::path& configurationFile)
    : ConfiguredAccountStore(configurationFile, askSecretService) {}

ConfiguredAccountStore::ConfiguredAccountStore(const std::filesystem::path& configurationFile, Secrets secrets)
    : file_(documents::FileSteps::absolute(configurationFile)), secrets_(std::move(secrets)) {}

ConfiguredAccountStore::~ConfiguredAccountStore() = default;

std::optional<std::string> ConfiguredAccountStore::askSecretService(const SecretQuestion& question,
                                                                    std::string& problem) {
    void* entry = LoadableModule::entry("libktr-secret.so", kSecretModuleEntry, problem);
    if (entry == nullptr) {
        return std::nullopt;
    }
    const std::unique_ptr<SecretModule> module(reinterpret_cast<SecretModuleEntry>(entry)());
    return module ? module->lookUp(question.person, question.host, question.seconds, question.givesUp, problem)
                  : std::nullopt;
}

std::optional<std::string> ConfiguredAccountStore::readToken(const Configuration::Account& account,
                                                             std::string& problem) const {
    std::string secretProblem;
    const std::filesystem::path usual = file_.parent_path() / "token";
    if (!account.tokenFile && account.host) {
        std::error_code failure;
        const bool isFileThere = std::filesystem::exists(usual, failure);
        const double seconds = isFileThere ? Buses::kSecretBesideAFile : Buses::kSecretAlone;
        if (const auto secret = secrets_({account.personId, *account.host, seconds, givesUp_}, secretProblem)) {
            // Tools that read a secret from a pipe keep the line end that came with it.
            auto token = TokenFile::tokenIn(*secret);
            problem = token ? "" : "the Secret Service's secret is refused: expected one line of at most 16 KiB";
            return token;
        }
    }
    const auto read = TokenFile::read(account.tokenFile ? std::filesystem::path(*account.tokenFile) : usual);
    if (const auto* token = std::get_if<std::string>(&read)) {
        return *token;
    }
    const auto& error = std::get<TokenFile::Error>(read);
    problem = error.text;
    if (!account.tokenFile && error.missing) {
        problem = "no app token: the Secret Service has none" +
                  (secretProblem.empty() ? std::string() : " (" + secretProblem + ")") + ", and " + error.text;
    }
    return std::nullopt;
}

void ConfiguredAccountStore::read() {
    auto read = ConfigurationReader::readFile(file_);
    Reading reading;
    if (auto* configuration = std::get_if<Configuration>(&read)) {
        reading.configuration = std::move(*configuration);
    } else {
        reading.problem = std::get<ConfigurationReader::Error>(read).text;
    }
    if (reading.configuration && reading.configuration->account) {
        const auto& owner = *reading.configuration->account;
        auto token = readToken(owner, reading.problem);
        if (token && knownSecrets_) {
            knownSecrets_->add(*token);
            if (const auto header = platform::basicAuthorization(owner.personId, *token)) {
                knownSecrets_->add(header->substr(header->find(' ') + 1));
            }
        }
        reading.account = std::make_shared<OwnerAccount>(owner, std::move(token));
    }
    if (!reading.problem.empty()) {
        platform::areaLog(platform::LogArea::Account)
            .write(platform::LogLevel::Error, "%@", platform::FormatArgument(reading.problem).shown());
    }
    if (reading.account && reading.configuration->account != configuration().account) {
        sayEntriesForNobody(*reading.configuration->account);
    }
    const std::lock_guard<std::mutex> lock(mutex_);
    next_ = std::move(reading);
}

bool ConfiguredAccountStore::take() {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (!next_) {
        return false;
    }
    const Reading reading = *std::exchange(next_, std::nullopt);
    problem_ = reading.problem;
    isBroken_ = !reading.configuration.has_value();
    if (isBroken_) {
        return false;
    }
    const bool sameAccount = reading.account && account_ ? *reading.account == *account_ : reading.account == account_;
    const bool changed = !sameAccount || !(*reading.configuration == configuration_);
    configuration_ = *reading.configuration;
    if (!sameAccount) {
        account_ = reading.account;
    }
    return changed;
}

Configuration ConfiguredAccountStore::configuration() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return configuration_;
}

std::string ConfiguredAccountStore::problem() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return problem_;
}

bool ConfiguredAccountStore::isBroken() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return isBroken_;
}

std::filesystem::path ConfiguredAccountStore::tokenFile() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (!configuration_.account) {
        return {};
    }
    return configuration_.account->tokenFile ? std::filesystem::path(*configuration_.account->tokenFile)
                                             : file_.parent_path() / "token";
}

std::shared_ptr<platform::DeviceOwnerAccount> ConfiguredAccountStore::deviceOwnerAccount() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return account_;
}

}  // namespace ktr::linux_
