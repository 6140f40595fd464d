#pragma once

#include <filesystem>
#include <memory>
#include <string>

#include "linux/contacts/MemoryContactStore.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

/// The contacts of a folder of vCards, or of a file of many, read once into memory. Main thread.
class VCardContactStore : public MemoryContactStore {
  public:
    /// Reads the cards; a card that cannot be read is passed over with a log line (error level) that names the file and
    /// the card's line. The sink is given since contacts are loaded before a platform is installed. The result is none,
    /// and the error says why, when the path is missing or nothing can be read.
    static platform::ContactFetch<std::shared_ptr<VCardContactStore>> load(
        const std::filesystem::path& path, std::shared_ptr<PhonenumberLibrary> phoneNumbers,
        const std::string& homeCountryCode, platform::LogSink& log);

    using MemoryContactStore::MemoryContactStore;
};

}  // namespace ktr::linux_
