#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <mutex>
#include <set>
#include <string>

#include "ask/Language.h"

namespace ktr::ask {

/// The languages of a folder, each file read when it is first asked for, and once for all tags that it serves: whoever
/// invents tags makes nothing grow. Any thread.
class Languages {
  public:
    explicit Languages(std::filesystem::path folder) : folder_(std::move(folder)) {}
    /// The language that serves a tag (BCP 47); English for one that there is no file for. None: not even that can be
    /// read, with the reason in `problem`.
    std::shared_ptr<const Language> language(const std::string& tag);
    /// What was wrong with a file; empty when nothing was.
    std::string problem() const;

  private:
    std::shared_ptr<const Language> read(const std::string& tag);
    void list();

    const std::filesystem::path folder_;
    mutable std::mutex mutex_;
    std::set<std::string> files_;                                   ///< named without their ending
    std::map<std::string, std::shared_ptr<const Language>> known_;  ///< by the name of the file
    std::string problem_;
};

}  // namespace ktr::ask
