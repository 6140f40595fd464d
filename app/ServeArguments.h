#pragma once

#include <memory>
#include <string>

#include "serve/ServeOptions.h"

namespace CLI {
class App;
}

namespace ktr::app {

/// The `serve` command of the command line. Any thread.
class ServeArguments {
  public:
    /// Adds the command to the program's parser, which goes first.
    explicit ServeArguments(CLI::App& program);
    ~ServeArguments();
    ServeArguments(const ServeArguments&) = delete;
    ServeArguments& operator=(const ServeArguments&) = delete;

    /// After parsing: whether this command was asked for.
    bool parsed() const;
    /// Fills in what the words say; the complaint about the first wrong one, or an empty text.
    std::string read(serve::ServeOptions& options) const;

  private:
    struct Words;
    CLI::App* command_;
    std::unique_ptr<Words> words_;
};

}  // namespace ktr::app
