#pragma once

#include <atomic>
#include <filesystem>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "linux/configuration/Configuration.h"
#include "linux/device/KnownSecrets.h"
#include "platform/client/DeviceOwnerAccount.h"

namespace ktr::linux_ {

/// The account of the configuration file, with the app token from the Secret Service or from a private file. It answers
/// from memory; `read` reads the disk and asks the bus, and what it has read counts once it is taken: whoever makes a
/// command finds the host that the token belongs to.
class ConfiguredAccountStore : public platform::AccountStore {
  public:
    /// What is asked of the Secret Service, and for how long.
    struct SecretQuestion {
        std::string person;
        std::string host;
        double seconds = 0.0;
        const std::atomic<bool>& givesUp;  ///< the answer is not waited for any more
    };
    /// The secret from the Secret Service; none when it holds none, with the reason in the text if there is one. Any
    /// thread.
    using Secrets = std::function<std::optional<std::string>(const SecretQuestion& question, std::string& problem)>;

    /// With the user's Secret Service, whose library is loaded when it is first asked.
    explicit ConfiguredAccountStore(const std::filesystem::path& configurationFile);
    ConfiguredAccountStore(const std::filesystem::path& configurationFile, Secrets secrets);
    ~ConfiguredAccountStore() override;

    /// Receives each token that is read before anything else gets it. Set before the first `read`.
    void setKnownSecrets(std::shared_ptr<KnownSecrets> secrets) { knownSecrets_ = std::move(secrets); }

    /// Reads configuration and token, and logs what is wrong. Any thread, but for a keyring's sake not the main thread
    /// once a window is open.
    void read();
    /// What was read last counts from now on; true when anything differs from before. A file with an error leaves
    /// everything as it was, but for `problem`. Main thread.
    bool take();
    /// The program ends: what a `read` still waits for is not waited for any longer. Any thread.
    void giveUp() { givesUp_ = true; }
    /// The configuration last taken. Any thread.
    Configuration configuration() const;
    /// What was wrong with what was taken last, in one line; empty when nothing was. Any thread.
    std::string problem() const;
    /// Whether the configuration itself could not be used at the last `take`, so that an earlier one counts. Any
    /// thread.
    bool isBroken() const;
    std::filesystem::path configurationFile() const { return file_; }
    /// The file that a change of the token changes; empty when no file is asked.
    std::filesystem::path tokenFile() const;

    std::shared_ptr<platform::DeviceOwnerAccount> deviceOwnerAccount() const override;

  private:
    class OwnerAccount;
    struct Reading {
        std::optional<Configuration> configuration;
        std::shared_ptr<OwnerAccount> account;
        std::string problem;
    };
    std::optional<std::string> readToken(const Configuration::Account& account, std::string& problem) const;
    static std::optional<std::string> askSecretService(const SecretQuestion& question, std::string& problem);

    const std::filesystem::path file_;
    const Secrets secrets_;
    std::atomic<bool> givesUp_ = false;
    std::shared_ptr<KnownSecrets> knownSecrets_;
    mutable std::mutex mutex_;
    std::optional<Reading> next_;  ///< read, and not taken yet
    Configuration configuration_;
    std::shared_ptr<OwnerAccount> account_;
    std::string problem_;
    bool isBroken_ = false;
};

}  // namespace ktr::linux_
