#pragma once

#include "app/KeepingOptions.h"

namespace CLI {
class App;
}

namespace ktr::app {

/// The commands `config` and `doctor` of the command line. Any thread.
class KeepingArguments {
  public:
    /// Adds the commands to the program's parser, which goes first; the options outlive it too.
    KeepingArguments(CLI::App& program, ConfigOptions& config, DoctorOptions& doctor);

    /// After parsing: which command was asked for. Fills in what it is to do.
    bool isConfig() const;
    bool isDoctor() const;

  private:
    ConfigOptions& config_;
    CLI::App* configCommand_;
    CLI::App* get_;
    CLI::App* set_;
    CLI::App* unset_;
    CLI::App* doctorCommand_;
};

}  // namespace ktr::app
