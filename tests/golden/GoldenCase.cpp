#include "tests/golden/GoldenCase.h"

#include <fstream>
#include <sstream>

namespace ktr::test {

std::vector<GoldenCase> goldenCases() {
    std::vector<GoldenCase> cases;
    std::ifstream file(KTR_TEST_DATA "/golden/cases.txt");
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        GoldenCase one;
        if (line.starts_with('#') || !(words >> one.name)) {
            continue;
        }
        for (std::string word; words >> word;) {
            const bool scenario = one.arguments.empty();
            one.arguments.push_back(scenario ? KTR_SOURCE_DIR "/resources/scenarios/" + word : word);
        }
        cases.push_back(std::move(one));
    }
    return cases;
}

}  // namespace ktr::test
