#pragma once

#include <CLI/CLI.hpp>
#include <optional>
#include <string>
#include <vector>

#include "server/admin/Administration.h"

namespace ktr::server {

/// The part of the command line that is about what is kept: backups, a person's data, how long.
class KeepingCommands {
  public:
    explicit KeepingCommands(CLI::App& program);
    KeepingCommands(const KeepingCommands&) = delete;
    KeepingCommands& operator=(const KeepingCommands&) = delete;

    /// Runs the command that was given, and says what went wrong (empty: nothing); none when it is not one of these.
    std::optional<std::string> run(Administration& administration) const;

  private:
    std::string name_;
    std::string file_;
    std::string fixes_;
    std::string looks_;
    std::vector<std::string> files_;
    bool none_ = false;
    bool replace_ = false;
    CLI::App* maps_;
    CLI::App* backup_;
    CLI::App* restore_;
    CLI::App* confirm_;
    CLI::App* export_;
    CLI::App* forget_;
    CLI::App* retention_;
};

}  // namespace ktr::server
