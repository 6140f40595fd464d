#include "documents/AtomicFile.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>

#include "documents/FileSteps.h"
#include "documents/StagedFiles.h"

namespace ktr::documents {

std::string AtomicFile::write(const std::filesystem::path& file, std::string_view bytes, mode_t mode) {
    // Only a link itself is replaced, wherever it leads.
    std::error_code unknown;
    if (!std::filesystem::is_symlink(file, unknown)) {
        if (auto problem = StagedFiles::refusal(file); !problem.empty()) {
            return problem;
        }
    }
    std::filesystem::path fresh = file;
    fresh += ".new";
    // What a process that was killed left there is not ours to continue: begin anew.
    if (::unlink(fresh.c_str()) != 0 && errno != ENOENT) {
        return FileSteps::sentence(file, "written", errno);
    }
    if (const int failure = FileSteps::writeNew(fresh, bytes, mode); failure != 0) {
        return FileSteps::sentence(file, "written", failure);
    }
    if (::rename(fresh.c_str(), file.c_str()) != 0) {
        const int failure = errno;
        ::unlink(fresh.c_str());
        return FileSteps::sentence(file, "replaced", failure);
    }
    const int failure = FileSteps::syncFolder(FileSteps::folderOf(file));
    return failure == 0 ? "" : FileSteps::sentence(file, "brought to the disk", failure);
}

std::string AtomicFile::makeFolder(const std::filesystem::path& folder) {
    std::error_code failure;
    const std::filesystem::path above = folder.parent_path();
    if (!above.empty()) {
        std::filesystem::create_directories(above, failure);
    }
    if (::mkdir(folder.c_str(), 0700) == 0) {
        return "";
    }
    const int reason = errno;
    if (reason == EEXIST && std::filesystem::is_directory(folder, failure)) {
        return "";
    }
    return FileSteps::sentence(folder, "made", reason);
}

}  // namespace ktr::documents
