// Prints random systems and the solver's answers, one JSON object a line, for a comparison with another solver:
//   solver-systems COUNT SEED
#include <cstdio>
#include <cstdlib>
#include <random>
#include <vector>

#include "platform/layout/Solver.h"

namespace {

using namespace ktr::platform;

/// In the order of LayoutRelation.
constexpr const char* kRelations[] = {"<=", "==", ">="};
static_assert(static_cast<int>(LayoutRelation::Equal) == 1 && static_cast<int>(LayoutRelation::GreaterOrEqual) == 2);
constexpr double kLevels[] = {1000.0, 1000.0, 750.0, 500.0, 250.0};

void printSystem(std::mt19937& random) {
    const auto below = [&random](unsigned limit) { return static_cast<int>(random() % limit); };
    const int variables = 1 + below(8);
    const int count = 1 + below(24);
    Solver solver;
    for (int i = 0; i < variables; ++i) {
        solver.addVariable();
    }
    std::vector<ConstraintId> ids;
    std::printf("{\"variables\": %d, \"constraints\": [", variables);
    for (int i = 0; i < count; ++i) {
        std::vector<Term> terms;
        for (int v = 0; v < variables; ++v) {
            // Layout's constraints mention few variables each.
            const int factor = below(3) == 0 ? below(5) - 2 : 0;
            if (factor != 0) {
                terms.push_back({static_cast<VariableId>(v), static_cast<double>(factor)});
            }
        }
        const int relation = below(3);
        const double constant = below(201) - 100;
        const double level = kLevels[below(5)];
        ids.push_back(solver.add(terms, static_cast<LayoutRelation>(relation), constant, level, true));
        std::printf("%s{\"terms\": [", i == 0 ? "" : ", ");
        for (std::size_t t = 0; t < terms.size(); ++t) {
            std::printf("%s[%u, %g]", t == 0 ? "" : ", ", terms[t].variable, terms[t].coefficient);
        }
        std::printf("], \"relation\": \"%s\", \"constant\": %g, \"level\": %g}", kRelations[relation], constant, level);
    }
    solver.solve();
    std::printf("], \"values\": [");
    for (int v = 0; v < variables; ++v) {
        std::printf("%s%.17g", v == 0 ? "" : ", ", solver.value(static_cast<VariableId>(v)));
    }
    std::printf("], \"dropped\": [");
    for (std::size_t i = 0; i < ids.size(); ++i) {
        std::printf("%s%s", i == 0 ? "" : ", ", solver.isDropped(ids[i]) ? "true" : "false");
    }
    std::printf("]}\n");
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: %s COUNT SEED\n", argv[0]);
        return 2;
    }
    std::mt19937 random(static_cast<unsigned>(std::strtoul(argv[2], nullptr, 10)));
    for (long i = std::strtol(argv[1], nullptr, 10); i > 0; --i) {
        printSystem(random);
    }
    return 0;
}
