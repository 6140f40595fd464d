#pragma once

#include <string>

namespace ktr::linux_ {

/// Loads one of this project's own modules (a shared library beside the platform library, or in the folder "ktr" beside
/// it) and finds its entry. A module stays loaded for good: what it made may outlive any owner. Any thread.
class LoadableModule {
  public:
    /// The address of the symbol, or null; then `error` says why.
    static void* entry(const std::string& fileName, const char* symbol, std::string& error);
};

}  // namespace ktr::linux_
