// Random systems against an enumeration of all corners: the best answer by the solver's definition is one of them.
#include <algorithm>
#include <cmath>
#include <random>

#include "platform/layout/Solver.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

namespace {

struct Row {
    std::vector<double> factors;
    LayoutRelation relation = LayoutRelation::Equal;
    double constant = 0.0;
    double level = 0.0;
};

using Rows = std::vector<Row>;
using Numbers = std::vector<double>;

constexpr double kClose = 1e-7;

double errorOf(const Row& row, const Numbers& x) {
    double value = -row.constant;
    for (std::size_t i = 0; i < x.size(); ++i) {
        value += row.factors[i] * x[i];
    }
    switch (row.relation) {
        case LayoutRelation::Equal:
            return std::abs(value);
        case LayoutRelation::LessOrEqual:
            return std::max(0.0, value);
        case LayoutRelation::GreaterOrEqual:
            return std::max(0.0, -value);
    }
    return 0.0;
}

/// Compared from the front: required ones count 1 when they are missed; a soft level its sum, then each error; then
/// how far each variable is from zero.
Numbers costOf(Rows rows, const Numbers& x) {
    std::stable_sort(rows.begin(), rows.end(), [](const Row& a, const Row& b) { return a.level > b.level; });
    Numbers cost;
    for (auto begin = rows.begin(); begin != rows.end();) {
        const auto end = std::find_if(begin, rows.end(), [&](const Row& row) { return row.level != begin->level; });
        const bool isRequired = begin->level >= Solver::kRequired;
        double sum = 0.0;
        Numbers each;
        for (; begin != end; ++begin) {
            const double error = errorOf(*begin, x);
            sum += error;
            each.push_back(isRequired ? (error > kClose ? 1.0 : 0.0) : error);
        }
        cost.push_back(isRequired ? 0.0 : sum);
        cost.insert(cost.end(), each.begin(), each.end());
    }
    for (const double value : x) {
        cost.push_back(std::abs(value));
    }
    return cost;
}

bool isBetter(const Numbers& a, const Numbers& b) {
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (std::abs(a[i] - b[i]) > kClose) {
            return a[i] < b[i];
        }
    }
    return false;
}

/// Solves square equations (the constant last in each row); false when they have no single answer.
bool solveSquare(std::vector<Numbers> m, Numbers& x) {
    const std::size_t n = m.size();
    for (std::size_t c = 0; c < n; ++c) {
        std::size_t pivot = c;
        for (std::size_t r = c; r < n; ++r) {
            pivot = std::abs(m[r][c]) > std::abs(m[pivot][c]) ? r : pivot;
        }
        if (std::abs(m[pivot][c]) < 1e-9) {
            return false;
        }
        std::swap(m[pivot], m[c]);
        for (std::size_t r = 0; r < n; ++r) {
            const double factor = r == c ? 0.0 : m[r][c] / m[c][c];
            for (std::size_t k = c; k <= n && factor != 0.0; ++k) {
                m[r][k] -= factor * m[c][k];
            }
        }
    }
    x.resize(n);
    for (std::size_t i = 0; i < n; ++i) {
        x[i] = m[i][n] / m[i][i];
    }
    return true;
}

Numbers bestCorner(const Rows& rows, std::size_t variables) {
    std::vector<Numbers> planes;
    for (const Row& row : rows) {
        planes.push_back(row.factors);
        planes.back().push_back(row.constant);
    }
    for (std::size_t i = 0; i < variables; ++i) {
        planes.emplace_back(variables + 1, 0.0);
        planes.back()[i] = 1.0;
    }
    std::vector<int> chosen(planes.size(), 0);
    std::fill_n(chosen.begin(), variables, 1);
    Numbers best;
    do {
        std::vector<Numbers> square;
        for (std::size_t i = 0; i < planes.size(); ++i) {
            if (chosen[i] == 1) {
                square.push_back(planes[i]);
            }
        }
        Numbers corner;
        if (solveSquare(square, corner) && (best.empty() || isBetter(costOf(rows, corner), costOf(rows, best)))) {
            best = corner;
        }
    } while (std::prev_permutation(chosen.begin(), chosen.end()));
    return best;
}

class RandomSystem {
  public:
    explicit RandomSystem(unsigned seed) : random_(seed) {}

    int below(int limit) { return static_cast<int>(random_() % static_cast<unsigned>(limit)); }
    Row row(std::size_t variables) {
        static constexpr double kLevels[] = {Solver::kInput, 1000.0, 1000.0, 750.0, 500.0, 250.0};
        Row row;
        for (std::size_t i = 0; i < variables; ++i) {
            row.factors.push_back(below(5) - 2);
        }
        row.relation = static_cast<LayoutRelation>(below(3));
        row.constant = below(21) - 10;
        row.level = kLevels[below(6)];
        return row;
    }

  private:
    std::mt19937 random_;
};

ConstraintId add(Solver& solver, const Row& row, double constant) {
    std::vector<Term> terms;
    for (std::size_t i = 0; i < row.factors.size(); ++i) {
        terms.push_back({static_cast<VariableId>(i), row.factors[i]});
    }
    return solver.add(terms, row.relation, constant, row.level, true);
}

}  // namespace

class SolverOptimumTest : public PlatformTest {
  protected:
    static constexpr int kSystems = 1500;

    void SetUp() override { variables = 0; }
    void makeSystem(int mostVariables = 3, int mostRows = 8) {
        variables = 1 + static_cast<std::size_t>(random.below(mostVariables));
        rows.clear();
        for (int i = random.below(mostRows); i >= 0; --i) {
            rows.push_back(random.row(variables));
        }
        solver = Solver();
        for (std::size_t i = 0; i < variables; ++i) {
            solver.addVariable();
        }
    }
    void expectBest(int system) {
        solver.solve();
        Numbers x(variables);
        for (std::size_t i = 0; i < variables; ++i) {
            x[i] = solver.value(static_cast<VariableId>(i));
        }
        const Numbers mine = costOf(rows, x);
        const Numbers best = costOf(rows, bestCorner(rows, variables));
        ASSERT_FALSE(isBetter(best, mine) || isBetter(mine, best)) << "system " << system << "\n" << solver.dump();
    }

    RandomSystem random{20260115};
    std::size_t variables = 0;
    Rows rows;
    Solver solver;
};

TEST_F(SolverOptimumTest, FreshSystem) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        for (const Row& row : rows) {
            add(solver, row, row.constant);
        }
        expectBest(i);
    }
}

TEST_F(SolverOptimumTest, AfterEdits) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        std::vector<ConstraintId> ids;
        for (const Row& row : rows) {
            ids.push_back(add(solver, row, random.below(15) - 7));
        }
        solver.solve();
        for (std::size_t k = 0; k < rows.size(); ++k) {
            solver.setConstant(ids[k], rows[k].constant);
        }
        expectBest(i);
        for (int edits = 0; edits < 3; ++edits) {
            const auto k = static_cast<std::size_t>(random.below(static_cast<int>(rows.size())));
            rows[k].constant = random.below(21) - 10;
            solver.setConstant(ids[k], rows[k].constant);
            expectBest(i);
        }
    }
}

/// Where an answer that was kept as sums says that it holds for other constants, it is theirs.
TEST_F(SolverOptimumTest, AnswerAsSums_IsTheBestWhereItHolds) {
    int held = 0;
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        Numbers constants;
        for (const Row& row : rows) {
            add(solver, row, row.constant);
            constants.push_back(row.constant);
        }
        solver.solve();
        const auto form = solver.form();
        for (int edits = 0; form && edits < 4; ++edits) {
            const auto k = static_cast<std::size_t>(random.below(static_cast<int>(rows.size())));
            rows[k].constant = constants[k] = random.below(21) - 10;
            Numbers x;
            if (!form->evaluate(constants, x)) {
                continue;
            }
            ++held;
            const Numbers mine = costOf(rows, x);
            const Numbers best = costOf(rows, bestCorner(rows, variables));
            ASSERT_FALSE(isBetter(best, mine) || isBetter(mine, best)) << "system " << i << "\n" << solver.dump();
        }
    }
    EXPECT_GT(held, kSystems / 2);
}

TEST_F(SolverOptimumTest, AnswerAsSums_HoldsForItsOwnConstants) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem(6, 14);
        Numbers constants;
        for (const Row& row : rows) {
            add(solver, row, row.constant);
            constants.push_back(row.constant);
        }
        solver.solve();
        Numbers x;
        if (const auto form = solver.form()) {
            ASSERT_TRUE(form->evaluate(constants, x)) << solver.dump();
            for (std::size_t v = 0; v < variables; ++v) {
                ASSERT_NEAR(x[v], solver.value(static_cast<VariableId>(v)), 1e-9) << solver.dump();
            }
        }
    }
}

TEST_F(SolverOptimumTest, AfterAddsAndRemoves) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        std::vector<ConstraintId> extra;
        for (const Row& row : rows) {
            add(solver, row, row.constant);
            extra.push_back(add(solver, random.row(variables), random.below(15) - 7));
            solver.solve();
        }
        for (const ConstraintId id : extra) {
            solver.remove(id);
            if (random.below(2) == 0) {
                solver.solve();
            }
        }
        expectBest(i);
    }
}

TEST_F(SolverOptimumTest, LowerLevel_NeverChangesAHigherOnesErrors) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        std::vector<ConstraintId> ids;
        for (const Row& row : rows) {
            ids.push_back(add(solver, row, row.constant));
        }
        solver.solve();
        Numbers before;
        for (const ConstraintId id : ids) {
            before.push_back(solver.error(id));
        }
        for (int k = 0; k < 5; ++k) {
            Row weak = random.row(variables);
            weak.level = 100.0;
            add(solver, weak, weak.constant);
        }
        solver.solve();
        for (std::size_t k = 0; k < ids.size(); ++k) {
            if (!solver.isDropped(ids[k])) {
                ASSERT_NEAR(solver.error(ids[k]), before[k], kClose) << solver.dump();
            }
        }
    }
}

TEST_F(SolverOptimumTest, OrderOfSolving_DoesNotMatter) {
    for (int i = 0; i < kSystems; ++i) {
        makeSystem();
        Solver stepwise = solver;
        for (const Row& row : rows) {
            add(solver, row, row.constant);
            add(stepwise, row, row.constant);
            stepwise.solve();
        }
        solver.solve();
        for (VariableId v = 0; v < variables; ++v) {
            ASSERT_NEAR(solver.value(v), stepwise.value(v), kClose) << solver.dump();
        }
    }
}

TEST_F(SolverOptimumTest, LargeSystems_ReachOneAnswerOnEveryWay) {
    for (int i = 0; i < 100; ++i) {
        makeSystem(15, 50);
        Solver stepwise = solver;
        for (const Row& row : rows) {
            add(solver, row, row.constant);
            const ConstraintId id = add(stepwise, row, random.below(50));
            stepwise.solve();
            stepwise.setConstant(id, row.constant);
        }
        solver.solve();
        stepwise.solve();
        for (VariableId v = 0; v < variables; ++v) {
            ASSERT_NEAR(solver.value(v), stepwise.value(v), 1e-6 * (1.0 + std::abs(solver.value(v)))) << solver.dump();
        }
    }
}

}  // namespace ktr::test
