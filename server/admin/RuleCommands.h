#pragma once

#include <CLI/CLI.hpp>
#include <optional>
#include <string>

#include "server/admin/Administration.h"

namespace ktr::server {

/// The part of the command line that is about who sees what: places, zones, who looked, which grants stay, and devices
/// one by one.
class RuleCommands {
  public:
    explicit RuleCommands(CLI::App& program);
    RuleCommands(const RuleCommands&) = delete;
    RuleCommands& operator=(const RuleCommands&) = delete;

    /// Runs the command that was given, and says what went wrong (empty: nothing); none when it is not one of these.
    std::optional<std::string> run(Administration& administration) const;

  private:
    std::string name_;
    std::string other_;
    Administration::PlaceWords place_;
    bool said_ = false;
    bool unsaid_ = false;
    CLI::App* setPlace_;
    CLI::App* places_;
    CLI::App* zone_;
    CLI::App* looks_;
    CLI::App* fences_;
    int number_ = 0;
    CLI::App* keep_;
    CLI::App* devices_;
};

}  // namespace ktr::server
