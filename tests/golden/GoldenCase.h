#pragma once

#include <string>
#include <vector>

namespace ktr::test {

/// One line of cases.txt.
struct GoldenCase {
    std::string name;
    /// Of `ktr render`, without the output; the first is the scenario, with its folder.
    std::vector<std::string> arguments;
};

std::vector<GoldenCase> goldenCases();

}  // namespace ktr::test
