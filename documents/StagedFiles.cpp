#include "documents/StagedFiles.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <set>

#include "documents/FileSteps.h"

namespace ktr::documents {

namespace {

namespace fs = std::filesystem;

constexpr mode_t kUsualMode = 0666;

/// Where a link leads; the place itself for what is none.
fs::path followed(const fs::path& file) {
    std::error_code failure;
    if (!fs::is_symlink(file, failure)) {
        return file;
    }
    const fs::path target = fs::weakly_canonical(file, failure);
    return failure ? file : target;
}

}  // namespace

StagedFiles::~StagedFiles() {
    for (const File& file : files_) {
        if (!file.moved) {
            ::unlink(file.beside.c_str());
        }
    }
}

std::string StagedFiles::refusal(const fs::path& file) {
    struct stat facts {};
    if (::stat(file.c_str(), &facts) != 0) {
        return errno == ENOENT ? "" : FileSteps::sentence(file, "written", errno);
    }
    if (S_ISREG(facts.st_mode)) {
        return "";
    }
    const char* what = S_ISDIR(facts.st_mode) ? "a folder" : S_ISFIFO(facts.st_mode) ? "a pipe" : "a device";
    return file.string() + ": cannot be written: this is " + what + ", not a file";
}

std::string StagedFiles::add(const fs::path& file, std::string_view bytes) {
    if (auto problem = refusal(file); !problem.empty()) {
        return problem;
    }
    File staged;
    staged.place = followed(file);
    struct stat facts {};
    staged.replaces = ::stat(staged.place.c_str(), &facts) == 0;
    int failure = EEXIST;
    for (int number = 0; failure == EEXIST && number < 1000; ++number) {
        staged.beside = staged.place;
        staged.beside += "." + std::to_string(::getpid()) + "-" + std::to_string(number) + ".new";
        failure = FileSteps::writeNew(staged.beside, bytes, kUsualMode);
    }
    if (failure != 0) {
        return FileSteps::sentence(file, "written", failure);
    }
    if (staged.replaces) {
        // Not worth a failure: a new file with the usual mode is the picture that was asked for.
        static_cast<void>(::chmod(staged.beside.c_str(), facts.st_mode & 0777U));
    }
    files_.push_back(std::move(staged));
    return "";
}

int StagedFiles::put(File& file, bool canGoBack) {
    // An exchange keeps what lay there, so that it can be taken back; not every file system knows it.
    if (canGoBack && file.replaces &&
        ::renameat2(AT_FDCWD, file.beside.c_str(), AT_FDCWD, file.place.c_str(), RENAME_EXCHANGE) == 0) {
        file.exchanged = true;
        return 0;
    }
    if (::rename(file.beside.c_str(), file.place.c_str()) != 0) {
        return errno;
    }
    file.moved = true;
    return 0;
}

void StagedFiles::takeBack() {
    for (File& file : files_) {
        if (file.exchanged) {
            ::renameat2(AT_FDCWD, file.beside.c_str(), AT_FDCWD, file.place.c_str(), RENAME_EXCHANGE);
            file.exchanged = false;
        } else if (file.moved && !file.replaces) {
            ::unlink(file.place.c_str());
        }
    }
}

std::string StagedFiles::commit() {
    for (File& file : files_) {
        if (const int failure = put(file, files_.size() > 1); failure != 0) {
            takeBack();
            return FileSteps::sentence(file.place, "replaced", failure);
        }
    }
    std::set<fs::path> folders;
    for (File& file : files_) {
        if (file.exchanged) {
            ::unlink(file.beside.c_str());
            file.moved = true;
        }
        folders.insert(FileSteps::folderOf(file.place));
    }
    for (const fs::path& folder : folders) {
        if (const int failure = FileSteps::syncFolder(folder); failure != 0) {
            return FileSteps::sentence(folder, "brought to the disk", failure);
        }
    }
    return "";
}

}  // namespace ktr::documents
