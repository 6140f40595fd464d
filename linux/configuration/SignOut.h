#pragma once

#include <atomic>
#include <filesystem>
#include <functional>
#include <string>

namespace ktr::linux_ {

/// Signs somebody out on this computer: the secret goes from the keyring and from the file beside the configuration,
/// and no other file is asked for it. Who it was stays written, so that it need not be typed again. It waits for disk
/// and keyring: any thread but the main thread.
class SignOut {
  public:
    /// Has the keyring forget a secret; false with a reason when it does not. One that is not there is forgotten.
    using Forget = std::function<bool(const std::string& person, const std::string& host,
                                      const std::atomic<bool>& givesUp, std::string& problem)>;

    /// Empty when nobody is signed in any more, else one line without anything private. With the user's Secret
    /// Service.
    static std::string run(const std::filesystem::path& configurationFile, const std::atomic<bool>& givesUp);
    static std::string run(const std::filesystem::path& configurationFile, const std::atomic<bool>& givesUp,
                           const Forget& forget);
};

}  // namespace ktr::linux_
