#include "linux/contacts/ContactFiles.h"

#include <iterator>
#include <utility>

#include "linux/contacts/VCardReader.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

void report(const std::vector<VCardReader::Problem>& problems) {
    for (const VCardReader::Problem& problem : problems) {
        // Where the mistake is belongs to whoever has to mend it: shown, unlike what stands in the card.
        platform::areaLog(platform::LogArea::Contacts)
            .write(platform::LogLevel::Error, "%@:%li: contact passed over: %@",
                   platform::FormatArgument(problem.file.string()).shown(), static_cast<long>(problem.line),
                   platform::FormatArgument(problem.message).shown());
    }
}

}  // namespace

std::optional<ContactFiles::Contacts> ContactFiles::read(const Paths& paths, std::string& error) {
    Contacts all;
    for (const std::string& path : paths) {
        auto read = VCardReader().read(path);
        report(read.problems);
        if (read.error) {
            error = *read.error;
            return std::nullopt;
        }
        std::move(read.contacts.begin(), read.contacts.end(), std::back_inserter(all));
    }
    return all;
}

ContactFiles::Contacts ContactFiles::readText(const std::string& text, const std::string& name) {
    auto read = VCardReader().readText(text, name);
    if (read.error) {
        read.problems.push_back({name, 0, *read.error});
    }
    report(read.problems);
    return std::move(read.contacts);
}

ContactFiles::Paths ContactFiles::watched(const Paths& paths) {
    // Editors replace files: the folder tells of the new one, the file of changes in place. Of a folder of cards each
    // file is watched for the latter.
    Paths wanted;
    std::error_code failure;
    const auto add = [&](const std::filesystem::path& path) {
        if (!path.empty() && std::filesystem::exists(path, failure)) {
            wanted.push_back(path.string());
        }
    };
    for (const std::string& path : paths) {
        const std::filesystem::path file(path);
        add(file);
        add(file.parent_path());
        if (std::filesystem::is_directory(file, failure)) {
            // An operating system watches so many files for one user, and no more.
            constexpr std::size_t kMost = 1000;
            for (std::filesystem::directory_iterator at(file, failure), end; at != end && wanted.size() < kMost;
                 at.increment(failure)) {
                if (VCardReader::isCardFile(at->path())) {
                    add(at->path());
                }
            }
        }
    }
    return wanted;
}

}  // namespace ktr::linux_
