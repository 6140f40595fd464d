#pragma once

#include <atomic>
#include <optional>
#include <string>

namespace ktr::linux_ {

/// What libktr-secret.so offers: the user's Secret Service, behind an interface of our own in a module that is loaded
/// on demand. Nothing thrown leaves it. Any thread but the main thread: a lookup may wait for the user to unlock a
/// keyring.
class SecretModule {
  public:
    virtual ~SecretModule() = default;
    /// The secret stored with the attributes application=ktr, person and host. None when there is none; then `error`
    /// says why, or is empty when the service simply holds no such item. Gives up after `seconds`, and within a tenth
    /// of one when `givesUp` becomes true.
    virtual std::optional<std::string> lookUp(const std::string& person, const std::string& host, double seconds,
                                              const std::atomic<bool>& givesUp, std::string& error) const = 0;
    /// Keeps the secret with these attributes, in place of one that is there; a locked keyring asks the user to unlock
    /// it. False when it is not kept; then `error` says why, and is never empty.
    virtual bool store(const std::string& person, const std::string& host, const std::string& secret, double seconds,
                       const std::atomic<bool>& givesUp, std::string& error) const = 0;
    /// Forgets the secret with these attributes; one that is not there is forgotten. False when that cannot be done;
    /// then `error` says why.
    virtual bool forget(const std::string& person, const std::string& host, double seconds,
                        const std::atomic<bool>& givesUp, std::string& error) const = 0;
};

/// The module's only symbol, of type `SecretModuleEntry`: makes the module's object; null when it cannot be made.
inline constexpr const char* kSecretModuleEntry = "ktrMakeSecretModule";
using SecretModuleEntry = SecretModule* (*)();

}  // namespace ktr::linux_
