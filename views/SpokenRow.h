#pragma once

#include <string>
#include <vector>

namespace ktr {

/// What a row says to a listener. Stateless. Main thread.
class SpokenRow {
  public:
    /// The parts in one line, as the language lists things; empty ones are left out.
    static std::string line(const std::vector<std::string>& parts);
};

}  // namespace ktr
