#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include "ask/Language.h"

namespace ktr::ask {

/// The languages of a folder, each read when it is first asked for. Any thread.
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

    const std::filesystem::path folder_;
    mutable std::mutex mutex_;
    std::map<std::string, std::shared_ptr<const Language>> known_;
    std::string problem_;
};

}  // namespace ktr::ask
