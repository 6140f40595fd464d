// The solver alone on the equations of one friend row: 22 constraints of its formats, 16 of its four texts, the row's
// size.
#include <benchmark/benchmark.h>

#include <array>

#include "platform/layout/Solver.h"

namespace {

using namespace ktr::platform;

constexpr double kLine = 22.0;

/// Variables: the row's width and height, then width, height, x and y of each view.
enum View : VariableId { kIcon, kPlace, kName, kDistance, kAge, kSeparator, kViews };
VariableId width(View view) {
    return 2 + 4 * view;
}
VariableId height(View view) {
    return width(view) + 1;
}
VariableId x(View view) {
    return width(view) + 2;
}
VariableId y(View view) {
    return width(view) + 3;
}

using Texts = std::array<double, 4>;
constexpr std::array kTextViews = {kPlace, kName, kDistance, kAge};
constexpr Texts kTexts = {120.0, 140.0, 48.0, 75.0};
constexpr Texts kOtherTexts = {98.0, 162.0, 53.0, 70.0};

/// The row's equations in a solver, and the constraints that hold its inputs.
struct Row {
    Solver solver;
    std::vector<double> constants;  // by ConstraintId
    std::array<ConstraintId, 4> widthsOfTexts{};

    Row() {
        for (VariableId i = 0; i < 2 + 4 * kViews; ++i) {
            solver.addVariable();
        }
        add({{0, 1.0}}, LayoutRelation::Equal, 400.0, Solver::kInput, true);
        add({{1, 1.0}}, LayoutRelation::Equal, 78.5, Solver::kInput, true);
        addFormats();
        for (std::size_t i = 0; i < kTexts.size(); ++i) {
            widthsOfTexts[i] = static_cast<ConstraintId>(constants.size());
            const double resistance = kTextViews[i] == kName ? 250.0 : 999.5;
            add({{width(kTextViews[i]), 1.0}}, LayoutRelation::GreaterOrEqual, kTexts[i], resistance, true);
            const double hugging = kTextViews[i] == kDistance ? 999.5 : 250.0;
            add({{width(kTextViews[i]), 1.0}}, LayoutRelation::LessOrEqual, kTexts[i], hugging, true);
            add({{height(kTextViews[i]), 1.0}}, LayoutRelation::GreaterOrEqual, kLine, 999.5, true);
            add({{height(kTextViews[i]), 1.0}}, LayoutRelation::LessOrEqual, kLine, 999.5, true);
        }
        solver.solve();
    }

    void add(std::initializer_list<Term> terms, LayoutRelation relation, double constant, double level = 1000.0,
             bool isEdited = false) {
        solver.add(std::span(terms.begin(), terms.size()), relation, constant, level, isEdited);
        constants.push_back(constant);
    }

    void addFormats() {
        const auto equal = LayoutRelation::Equal;
        const auto atLeast = LayoutRelation::GreaterOrEqual;
        add({{x(kIcon), 1.0}}, equal, 15.0);
        add({{width(kIcon), 1.0}}, equal, 54.0);
        for (const View view : {kPlace, kAge}) {
            add({{x(view), 1.0}}, equal, 82.0);
            add({{0, 1.0}, {x(view), -1.0}, {width(view), -1.0}}, equal, 15.0);
        }
        add({{x(kName), 1.0}}, equal, 82.0);
        add({{x(kDistance), 1.0}, {x(kName), -1.0}, {width(kName), -1.0}}, equal, 13.0);
        add({{0, 1.0}, {x(kDistance), -1.0}, {width(kDistance), -1.0}}, equal, 15.0);
        add({{y(kDistance), 1.0}, {height(kDistance), 0.5}, {y(kName), -1.0}, {height(kName), -0.5}}, equal, 0.0);
        add({{x(kSeparator), 1.0}}, equal, 0.0);
        add({{0, 1.0}, {x(kSeparator), -1.0}, {width(kSeparator), -1.0}}, equal, 0.0);
        add({{y(kIcon), 1.0}}, equal, 10.0);
        add({{height(kIcon), 1.0}}, equal, 54.0);
        add({{1, 1.0}, {y(kIcon), -1.0}, {height(kIcon), -1.0}}, atLeast, 10.0);
        add({{y(kPlace), 1.0}}, equal, 10.0);
        add({{y(kName), 1.0}, {y(kPlace), -1.0}, {height(kPlace), -1.0}}, equal, 0.0);
        add({{y(kAge), 1.0}, {y(kName), -1.0}, {height(kName), -1.0}}, equal, 0.0);
        add({{y(kSeparator), 1.0}, {y(kAge), -1.0}, {height(kAge), -1.0}}, atLeast, 1.0);
        add({{height(kSeparator), 1.0}}, equal, 0.5);
        add({{1, 1.0}, {y(kSeparator), -1.0}, {height(kSeparator), -1.0}}, equal, 0.0);
    }

    void setText(Solver& to, std::size_t text, double value) const {
        to.setConstant(widthsOfTexts[text], value);
        to.setConstant(widthsOfTexts[text] + 1, value);
    }
};

void FirstOfItsStructure(benchmark::State& state) {
    for (auto _ : state) {
        Row row;
        benchmark::DoNotOptimize(row.solver.value(5));
    }
}
BENCHMARK(FirstOfItsStructure);

/// Another row's inputs in the solver of the structure.
void FurtherRow_BySolver(benchmark::State& state) {
    Row row;
    bool other = false;
    for (auto _ : state) {
        other = !other;
        for (std::size_t i = 0; i < kTexts.size(); ++i) {
            row.setText(row.solver, i, other ? kOtherTexts[i] : kTexts[i]);
        }
        row.solver.solve();
        benchmark::DoNotOptimize(row.solver.value(5));
    }
}
BENCHMARK(FurtherRow_BySolver);

/// Another row's inputs in the answer that the first row left: how scopes of one structure are solved.
void FurtherRow(benchmark::State& state) {
    const Row row;
    const auto form = row.solver.form();
    if (!form) {
        state.SkipWithError("the row's answer is no sum of its inputs");
        return;
    }
    std::vector<double> constants = row.constants;
    std::vector<double> values;
    bool other = false;
    for (auto _ : state) {
        other = !other;
        for (std::size_t i = 0; i < kTexts.size(); ++i) {
            constants[row.widthsOfTexts[i]] = constants[row.widthsOfTexts[i] + 1] = other ? kOtherTexts[i] : kTexts[i];
        }
        if (!form->evaluate(constants, values)) {
            state.SkipWithError("the other row needs another answer");
            break;
        }
        benchmark::DoNotOptimize(values.data());
    }
}
BENCHMARK(FurtherRow);

void WidthChange(benchmark::State& state) {
    const Row row;
    const auto form = row.solver.form();
    std::vector<double> constants = row.constants;
    std::vector<double> values;
    for (auto _ : state) {
        constants[0] = constants[0] < 400.0 ? 400.0 : 360.0;
        if (!form || !form->evaluate(constants, values)) {
            state.SkipWithError("the other width needs another answer");
            break;
        }
        benchmark::DoNotOptimize(values.data());
    }
}
BENCHMARK(WidthChange);

void OneTextsSize(benchmark::State& state) {
    const Row row;
    const auto form = row.solver.form();
    std::vector<double> constants = row.constants;
    std::vector<double> values;
    for (auto _ : state) {
        double& size = constants[row.widthsOfTexts[2]];
        size = constants[row.widthsOfTexts[2] + 1] = size < 50.0 ? 55.0 : 48.0;
        if (!form || !form->evaluate(constants, values)) {
            state.SkipWithError("the other text needs another answer");
            break;
        }
        benchmark::DoNotOptimize(values.data());
    }
}
BENCHMARK(OneTextsSize);

}  // namespace

BENCHMARK_MAIN();
