#include "linux/configuration/TokenChange.h"

#include <cerrno>
#include <cstdio>
#include <system_error>
#include <utility>

#include "documents/AtomicFile.h"
#include "documents/FileSteps.h"

namespace ktr::linux_ {

namespace {

std::filesystem::path beside(const std::filesystem::path& file, const char* ending) {
    std::filesystem::path name = file;
    name += ending;
    return name;
}

}  // namespace

TokenChange::TokenChange(std::filesystem::path token)
    : place_(std::move(token)), fresh_(beside(place_, ".next")), earlier_(beside(place_, ".before")) {}

TokenChange::~TokenChange() {
    std::error_code nothingLeftToDo;
    if (isPrepared_) {
        std::filesystem::remove(fresh_, nothingLeftToDo);
    }
    if (isAway_) {
        std::filesystem::rename(earlier_, place_, nothingLeftToDo);
    }
}

std::string TokenChange::prepare(const std::string& token) {
    if (auto problem = documents::AtomicFile::makeFolder(place_.parent_path()); !problem.empty()) {
        return problem;
    }
    auto problem = documents::AtomicFile::write(fresh_, token + "\n");
    isPrepared_ = problem.empty();
    return problem;
}

std::string TokenChange::takeAway() {
    isAway_ = std::rename(place_.c_str(), earlier_.c_str()) == 0;
    return isAway_ || errno == ENOENT || errno == ENOTDIR ? ""
                                                          : documents::FileSteps::sentence(place_, "replaced", errno);
}

std::string TokenChange::finish() {
    std::error_code failure;
    if (std::exchange(isAway_, false)) {
        std::filesystem::remove(earlier_, failure);
    }
    if (!isPrepared_) {
        return "";
    }
    if (std::rename(fresh_.c_str(), place_.c_str()) != 0) {
        return documents::FileSteps::sentence(place_, "written", errno);
    }
    isPrepared_ = false;
    const int unsaved = documents::FileSteps::syncFolder(documents::FileSteps::folderOf(place_));
    return unsaved == 0 ? "" : documents::FileSteps::sentence(place_, "brought to the disk", unsaved);
}

}  // namespace ktr::linux_
