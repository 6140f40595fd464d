#include "linux/configuration/SignOut.h"

#include <memory>
#include <system_error>

#include "linux/configuration/ConfigurationFile.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/SecretModule.h"
#include "linux/device/Buses.h"
#include "linux/device/LoadableModule.h"

namespace ktr::linux_ {

namespace {

bool forgetInKeyring(const std::string& person, const std::string& host, const std::atomic<bool>& givesUp,
                     std::string& problem) {
    void* entry = LoadableModule::entry("libktr-secret.so", kSecretModuleEntry, problem);
    if (entry == nullptr) {
        return false;
    }
    const std::unique_ptr<SecretModule> module(reinterpret_cast<SecretModuleEntry>(entry)());
    return module && module->forget(person, host, Buses::kSecretAlone, givesUp, problem);
}

}  // namespace

std::string SignOut::run(const std::filesystem::path& configurationFile, const std::atomic<bool>& givesUp) {
    return run(configurationFile, givesUp, forgetInKeyring);
}

std::string SignOut::run(const std::filesystem::path& configurationFile, const std::atomic<bool>& givesUp,
                         const Forget& forget) {
    const auto path = std::filesystem::absolute(configurationFile);
    const auto read = ConfigurationReader::readFile(path);
    const auto* configuration = std::get_if<Configuration>(&read);
    if (configuration == nullptr) {
        return std::get<ConfigurationReader::Error>(read).text;
    }
    if (!configuration->account) {
        return "";
    }
    const auto& account = *configuration->account;
    std::error_code failed;
    const auto token = path.parent_path() / "token";
    const bool hadFile = account.tokenFile.has_value() || std::filesystem::exists(token, failed);
    std::string problem;
    if (!forget(account.personId, account.host.value_or(""), givesUp, problem) && !hadFile) {
        return problem.empty() ? "the keyring keeps the secret" : problem;
    }
    std::filesystem::remove(token, failed);
    if (failed) {
        return failed.message();
    }
    return account.tokenFile ? ConfigurationFile(path).change({{"account.tokenFile", std::nullopt}}) : "";
}

}  // namespace ktr::linux_
