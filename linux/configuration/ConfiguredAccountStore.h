#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <mutex>
#include <string>

#include "linux/configuration/Configuration.h"
#include "platform/client/DeviceOwnerAccount.h"

namespace ktr::linux_ {

/// The account of the configuration file, with the app token from the Secret Service or from a private file. It answers
/// from memory; `load` reads the disk and asks the bus.
class ConfiguredAccountStore : public platform::AccountStore {
  public:
    /// The secret for a person and a host from the Secret Service; none when it holds none, with the reason in the text
    /// if there is one. Any thread.
    using Secrets =
        std::function<std::optional<std::string>(const std::string& person, const std::string& host, std::string&)>;

    /// With the user's Secret Service, whose library is loaded when it is first asked.
    explicit ConfiguredAccountStore(const std::filesystem::path& configurationFile);
    ConfiguredAccountStore(const std::filesystem::path& configurationFile, Secrets secrets);
    ~ConfiguredAccountStore() override;

    /// Reads configuration and token; true when anything differs from before. A file with an error leaves everything as
    /// it was. Logs what is wrong, and keeps it for `problem`. Any thread, but for a keyring's sake not the main thread
    /// once a window is open.
    bool load();
    /// The configuration last read. Any thread.
    Configuration configuration() const;
    /// What was wrong at the last `load`, in one line; empty when nothing was. Any thread.
    std::string problem() const;
    std::filesystem::path configurationFile() const { return file_; }
    /// The file that a change of the token changes; empty when no file is asked.
    std::filesystem::path tokenFile() const;

    std::shared_ptr<platform::DeviceOwnerAccount> deviceOwnerAccount() const override;

  private:
    class OwnerAccount;
    std::optional<std::string> readToken(const Configuration::Account& account, std::string& problem) const;
    static std::optional<std::string> askSecretService(const std::string& person, const std::string& host,
                                                       std::string& problem);

    const std::filesystem::path file_;
    const Secrets secrets_;
    mutable std::mutex mutex_;
    Configuration configuration_;
    std::shared_ptr<OwnerAccount> account_;
    std::string problem_;
};

}  // namespace ktr::linux_
