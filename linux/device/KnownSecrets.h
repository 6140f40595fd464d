#pragma once

#include <mutex>
#include <string>
#include <vector>

namespace ktr::linux_ {

/// What must never be printed, whatever carries it: values that were named as secrets, in every form in which they
/// travel (as they are, in JSON, percent-escaped), and the value of anything called "authToken". Any thread.
class KnownSecrets {
  public:
    /// From now on this value is hidden, too. What is shorter than four characters hides nothing and is passed over.
    void add(const std::string& secret);
    /// The text with "<hidden>" in the place of each secret.
    std::string without(std::string text) const;

  private:
    mutable std::mutex mutex_;
    std::vector<std::string> forms_;  ///< the longest first
};

}  // namespace ktr::linux_
