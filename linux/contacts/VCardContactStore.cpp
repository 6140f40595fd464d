#include "linux/contacts/VCardContactStore.h"

#include <utility>

#include "linux/contacts/VCardReader.h"

namespace ktr::linux_ {

platform::ContactFetch<std::shared_ptr<VCardContactStore>> VCardContactStore::load(
    const std::filesystem::path& path, std::shared_ptr<PhonenumberLibrary> phoneNumbers,
    const std::string& homeCountryCode, platform::LogSink& log) {
    auto read = VCardReader().read(path);
    if (log.wants(platform::LogLevel::Error)) {
        for (const VCardReader::Problem& problem : read.problems) {
            // Where the mistake is belongs to whoever has to mend it: shown, unlike what stands in the card.
            log.write({platform::LogLevel::Error,
                       "org.ktr.linux",
                       "contacts",
                       "%@:%li: contact passed over: %@",
                       {platform::FormatArgument(problem.file.string()).shown(),
                        platform::FormatArgument(static_cast<long>(problem.line)),
                        platform::FormatArgument(problem.message).shown()}});
        }
    }
    if (read.error) {
        return {nullptr, read.error};
    }
    return {std::make_shared<VCardContactStore>(std::move(read.contacts), std::move(phoneNumbers), homeCountryCode),
            std::nullopt};
}

}  // namespace ktr::linux_
