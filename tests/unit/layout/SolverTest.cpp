#include "platform/layout/Solver.h"

#include <limits>

#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

namespace {

constexpr auto kEqual = LayoutRelation::Equal;
constexpr auto kAtMost = LayoutRelation::LessOrEqual;
constexpr auto kAtLeast = LayoutRelation::GreaterOrEqual;

/// A variable that can be multiplied.
struct Var {
    VariableId id;
    operator VariableId() const { return id; }  // NOLINT: stands for its number
};

LinearExpression operator*(double factor, Var variable) {
    return Term{variable.id, factor};
}

}  // namespace

class SolverTest : public PlatformTest {
  protected:
    ConstraintId add(VariableId variable, LayoutRelation relation, double constant, double level) {
        const Term term{variable, 1.0};
        return solver.add({&term, 1}, relation, constant, level);
    }
    std::vector<std::string> debugLines() const { return log->texts(LogLevel::Debug); }

    Solver solver;
    Var x{solver.addVariable()};
    Var y{solver.addVariable()};
    Var z{solver.addVariable()};
};

TEST_F(SolverTest, NothingDetermined_IsZero) {
    solver.solve();
    EXPECT_EQ(solver.value(x), 0.0);
    EXPECT_EQ(solver.value(99), 0.0);
}

TEST_F(SolverTest, RequiredEquations_AreSolved) {
    solver.add(1.0 * x + 1.0 * y - 10.0, kEqual, Solver::kRequired);
    solver.add(1.0 * x - 1.0 * y - 4.0, kEqual, Solver::kRequired);
    solver.add(2.0 * z - 1.0 * x, kEqual, Solver::kRequired);
    solver.solve();
    EXPECT_DOUBLE_EQ(solver.value(x), 7.0);
    EXPECT_DOUBLE_EQ(solver.value(y), 3.0);
    EXPECT_DOUBLE_EQ(solver.value(z), 3.5);
}

TEST_F(SolverTest, HigherLevel_IsNotOutvotedByManyLowerOnes) {
    add(x, kEqual, 0.0, 501.0);
    for (int i = 0; i < 100; ++i) {
        add(x, kEqual, 100.0 + i, 500.0);
    }
    solver.solve();
    EXPECT_EQ(solver.value(x), 0.0);
}

TEST_F(SolverTest, LevelsBetweenWholeNumbers_AreLevelsToo) {
    add(x, kEqual, 1.0, 500.25);
    add(x, kEqual, 2.0, 500.5);
    solver.solve();
    EXPECT_EQ(solver.value(x), 2.0);
}

TEST_F(SolverTest, LeastSumOfErrors_WinsInsideALevel) {
    add(x, kEqual, 1.0, 500.0);
    add(x, kEqual, 5.0, 500.0);
    add(x, kEqual, 6.0, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 5.0);
}

TEST_F(SolverTest, ErrorsCountInTheUnitsOfTheirConstraint) {
    add(x, kEqual, 0.0, 500.0);
    solver.add(3.0 * x - 30.0, kEqual, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 10.0);
}

TEST_F(SolverTest, Tie_GoesToTheEarlierConstraint) {
    add(x, kEqual, 3.0, 500.0);
    add(x, kEqual, 8.0, 500.0);
    add(y, kEqual, 8.0, 500.0);
    add(y, kEqual, 3.0, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 3.0);
    EXPECT_EQ(solver.value(y), 8.0);
}

TEST_F(SolverTest, Tie_IsDecidedBeforeLowerLevelsAreAsked) {
    add(x, kEqual, 3.0, 500.0);
    add(x, kEqual, 8.0, 500.0);
    add(x, kEqual, 8.0, 499.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 3.0);
}

TEST_F(SolverTest, Tie_AmongInequalities_FillsTheEarlierFirst) {
    // Three contents of 10 in a room of 18: each unit that one misses, another gains.
    solver.add(1.0 * x + 1.0 * y + 1.0 * z - 18.0, kEqual, Solver::kRequired);
    for (const Var variable : {y, x, z}) {
        add(variable, kAtLeast, 0.0, Solver::kRequired);
        add(variable, kAtLeast, 10.0, 750.0);
    }
    solver.solve();
    EXPECT_EQ(solver.value(y), 10.0);
    EXPECT_EQ(solver.value(x), 8.0);
    EXPECT_EQ(solver.value(z), 0.0);
}

TEST_F(SolverTest, Undetermined_EarlierVariableGoesToZeroFirst) {
    solver.add(1.0 * x + 1.0 * y - 10.0, kEqual, Solver::kRequired);
    solver.solve();
    EXPECT_EQ(solver.value(x), 0.0);
    EXPECT_EQ(solver.value(y), 10.0);
}

TEST_F(SolverTest, Inequalities_HoldAndOtherwiseLeaveFree) {
    add(x, kAtLeast, 5.0, Solver::kRequired);
    add(x, kAtMost, 9.0, Solver::kRequired);
    const ConstraintId wish = add(x, kEqual, 7.0, 10.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 7.0);
    solver.setConstant(wish, 20.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 9.0);
    EXPECT_DOUBLE_EQ(solver.error(wish), 11.0);
    solver.setConstant(wish, -20.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 5.0);
}

TEST_F(SolverTest, RequiredConflict_DropsTheNewestWithADebugLine) {
    const ConstraintId first = add(x, kEqual, 5.0, Solver::kRequired);
    const ConstraintId second = add(x, kAtLeast, 6.0, Solver::kRequired);
    solver.solve([](VariableId) { return std::string("width"); });
    EXPECT_EQ(solver.value(x), 5.0);
    EXPECT_FALSE(solver.isDropped(first));
    EXPECT_TRUE(solver.isDropped(second));
    EXPECT_DOUBLE_EQ(solver.error(second), 1.0);
    EXPECT_EQ(debugLines(),
              std::vector<std::string>{"A required constraint conflicts with earlier ones and is dropped: width >= 6"});
}

TEST_F(SolverTest, DroppedConstraint_CountsForNothing) {
    add(x, kEqual, 5.0, Solver::kRequired);
    solver.add(1.0 * x + 1.0 * y - 8.0, kEqual, Solver::kRequired);
    const ConstraintId dropped = add(y, kAtLeast, 50.0, Solver::kRequired);
    add(y, kAtLeast, 60.0, 1.0);
    solver.solve();
    EXPECT_EQ(solver.value(y), 3.0);
    EXPECT_TRUE(solver.isDropped(dropped));
}

TEST_F(SolverTest, DroppedConstraint_ComesBackWhenItCanHold) {
    const ConstraintId room = add(x, kEqual, 0.0, Solver::kInput);
    const ConstraintId content = solver.add(1.0 * x - 1.0 * y - 20.0, kEqual, Solver::kRequired);
    const ConstraintId least = add(y, kAtLeast, 30.0, Solver::kRequired);
    solver.solve();
    EXPECT_FALSE(solver.isDropped(content));
    EXPECT_TRUE(solver.isDropped(least));
    solver.setConstant(room, 100.0);
    solver.solve();
    EXPECT_FALSE(solver.isDropped(least));
    EXPECT_EQ(solver.value(y), 80.0);
    EXPECT_EQ(debugLines().size(), 1U);
    solver.setConstant(room, 10.0);
    solver.solve();
    EXPECT_EQ(debugLines().size(), 2U);
}

TEST_F(SolverTest, DroppedConstraint_ComesBackThoughAWeakerOneHidesIt) {
    const ConstraintId low = add(x, kAtLeast, 5.0, Solver::kRequired);
    const ConstraintId high = add(x, kAtMost, 4.0, Solver::kRequired);
    add(x, kEqual, 7.0, 750.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 7.0);
    solver.setConstant(low, -1.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 4.0);
    EXPECT_FALSE(solver.isDropped(high));
}

TEST_F(SolverTest, Input_IsStrongerThanRequired) {
    const ConstraintId inner = add(x, kEqual, 300.0, Solver::kRequired);
    add(x, kEqual, 400.0, Solver::kInput);
    solver.solve();
    EXPECT_EQ(solver.value(x), 400.0);
    EXPECT_TRUE(solver.isDropped(inner));
}

TEST_F(SolverTest, EqualConstraints_AreOneAndCounted) {
    std::vector<ConstraintId> ids;
    for (int i = 0; i < 1000; ++i) {
        ids.push_back(add(x, kEqual, 4.0, 500.0));
    }
    // The same, written the other way round.
    ids.push_back(solver.add(LinearExpression(4.0) - 1.0 * x, kEqual, 500.0));
    add(x, kEqual, 9.0, 500.0);
    add(x, kEqual, 9.5, 500.0);
    EXPECT_EQ(solver.constraintCount(), 3U);
    solver.solve();
    EXPECT_EQ(solver.value(x), 9.0);  // outvoted: it counts once
    for (std::size_t i = 0; i + 1 < ids.size(); ++i) {
        solver.remove(ids[i]);
    }
    EXPECT_EQ(solver.constraintCount(), 3U);
    solver.remove(ids.back());
    EXPECT_EQ(solver.constraintCount(), 2U);
}

TEST_F(SolverTest, EqualConstraints_AreOtherwiseCountedInRelationAndLevel) {
    add(x, kAtLeast, 4.0, 500.0);
    add(x, kAtMost, 4.0, 500.0);
    add(x, kAtLeast, 4.0, 501.0);
    add(y, kAtLeast, 4.0, 500.0);
    solver.add(2.0 * x - 8.0, kAtLeast, 500.0);
    EXPECT_EQ(solver.constraintCount(), 5U);
}

TEST_F(SolverTest, EqualInequality_WrittenTheOtherWayRound_IsTheSame) {
    solver.add(1.0 * y - 1.0 * x - 8.0, kAtLeast, 500.0);
    const ConstraintId turned = solver.add(1.0 * x - 1.0 * y + 8.0, kAtMost, 500.0);
    EXPECT_EQ(solver.constraintCount(), 1U);
    EXPECT_EQ(solver.constant(turned), -8.0);
}

TEST_F(SolverTest, EditOfOneOfEqualConstraints_PartsIt) {
    const ConstraintId first = add(x, kAtLeast, 4.0, 500.0);
    const ConstraintId second = add(x, kAtLeast, 4.0, 500.0);
    solver.setConstant(second, 6.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 6.0);
    solver.remove(second);
    solver.solve();
    EXPECT_EQ(solver.value(x), 4.0);
    EXPECT_EQ(solver.constant(first), 4.0);
}

TEST_F(SolverTest, EditedTwin_KeepsItsOwnSign) {
    solver.add(1.0 * y - 1.0 * x - 8.0, kAtLeast, 500.0);
    const ConstraintId turned = solver.add(1.0 * x - 1.0 * y + 8.0, kAtMost, 500.0);
    solver.setConstant(turned, -12.0);  // x - y <= -12
    solver.solve();
    EXPECT_EQ(solver.value(y), 12.0);
}

TEST_F(SolverTest, Remove_FreesWhatWasHeld) {
    const ConstraintId hold = add(x, kEqual, 5.0, Solver::kRequired);
    add(x, kEqual, 8.0, 300.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 5.0);
    solver.remove(hold);
    solver.solve();
    EXPECT_EQ(solver.value(x), 8.0);
    solver.remove(hold);
    solver.remove(12345);
    solver.solve();
    EXPECT_EQ(solver.value(x), 8.0);
}

TEST_F(SolverTest, RemovedAndAddedAgain_IsTheNewest) {
    const ConstraintId three = add(x, kEqual, 3.0, 500.0);
    add(x, kEqual, 8.0, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 3.0);
    solver.remove(three);
    add(x, kEqual, 3.0, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 8.0);
}

TEST_F(SolverTest, EditOfAConstant_NeedsNoExchange) {
    solver.add(1.0 * y - 1.0 * x - 10.0, kEqual, Solver::kRequired);
    solver.add(1.0 * z - 2.0 * y, kEqual, Solver::kRequired);
    const ConstraintId width = add(x, kEqual, 100.0, Solver::kInput);
    solver.solve();
    const int steps = solver.steps();
    for (int i = 0; i < 1000; ++i) {
        solver.setConstant(width, 100.0 + 0.1 * i);
        solver.solve();
    }
    EXPECT_EQ(solver.steps(), steps);
    EXPECT_DOUBLE_EQ(solver.value(z), 2.0 * (100.0 + 0.1 * 999 + 10.0));
}

TEST_F(SolverTest, Copy_IsIndependentAndSharesTheElimination) {
    solver.add(1.0 * y - 1.0 * x - 10.0, kEqual, Solver::kRequired);
    const ConstraintId width = add(x, kEqual, 100.0, Solver::kInput);
    solver.solve();
    Solver copy = solver;
    copy.setConstant(width, 50.0);
    copy.solve();
    EXPECT_EQ(copy.steps(), solver.steps());
    EXPECT_EQ(copy.value(y), 60.0);
    EXPECT_EQ(solver.value(y), 110.0);
    const Term term{y, 1.0};
    copy.add({&term, 1}, kEqual, 1.0, Solver::kInput);
    copy.solve();
    solver.setConstant(width, 70.0);
    solver.solve();
    EXPECT_EQ(copy.value(y), 1.0);
    EXPECT_EQ(solver.value(y), 80.0);
    EXPECT_EQ(solver.constraintCount() + 1, copy.constraintCount());
}

TEST_F(SolverTest, EmptyConstraint_HoldsOrIsDropped) {
    const ConstraintId fine = solver.add(LinearExpression(3.0), kAtLeast, Solver::kRequired);
    const ConstraintId wrong = solver.add(LinearExpression(3.0), kEqual, Solver::kRequired);
    const ConstraintId soft = solver.add(1.0 * x - 1.0 * x + 3.0, kEqual, 500.0);
    solver.solve();
    EXPECT_FALSE(solver.isDropped(fine));
    EXPECT_TRUE(solver.isDropped(wrong));
    EXPECT_DOUBLE_EQ(solver.error(soft), 3.0);
}

TEST_F(SolverTest, NotFinite_IsIgnoredWithADebugLine) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double infinite = std::numeric_limits<double>::infinity();
    const ConstraintId width = add(x, kEqual, 5.0, 500.0);
    EXPECT_TRUE(solver.isDropped(add(x, kEqual, nan, 1000.0)));
    EXPECT_TRUE(solver.isDropped(add(x, kAtLeast, infinite, 1000.0)));
    EXPECT_TRUE(solver.isDropped(add(x, kEqual, 1.0, nan)));
    EXPECT_TRUE(solver.isDropped(solver.add(infinite * x, kEqual, 1000.0)));
    solver.setConstant(width, nan);
    solver.solve();
    EXPECT_EQ(solver.value(x), 5.0);
    EXPECT_EQ(debugLines().size(), 5U);
    EXPECT_EQ(solver.constraintCount(), 1U);
}

TEST_F(SolverTest, LevelsOutOfRange_AreClamped) {
    add(x, kEqual, 1.0, -7.0);
    add(x, kEqual, 2.0, 1.0);
    add(y, kEqual, 1.0, 5000.0);
    add(y, kEqual, 2.0, Solver::kInput);
    solver.solve();
    EXPECT_EQ(solver.value(x), 1.0);
    EXPECT_EQ(solver.value(y), 1.0);
}

TEST_F(SolverTest, HugeNumbers_KeepTheSmallOnesExact) {
    const ConstraintId huge = add(x, kAtMost, 1e9, 900.0);
    solver.add(1.0 * y - 1.0 * x - 0.25, kEqual, Solver::kRequired);
    const ConstraintId wish = add(x, kAtLeast, 1e9, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(y), 1e9 + 0.25);
    solver.setConstant(huge, 3.5);
    solver.solve();
    EXPECT_EQ(solver.value(x), 3.5);
    EXPECT_EQ(solver.value(y), 3.75);
    EXPECT_DOUBLE_EQ(solver.error(wish), 1e9 - 3.5);
}

TEST_F(SolverTest, NumbersBeyondReason_End) {
    const ConstraintId width = add(x, kEqual, 1e308, Solver::kInput);
    solver.add(1e308 * y - 1e308 * x, kEqual, Solver::kRequired);
    solver.add(1e-308 * z - 1e308 * y + 1e308, kAtLeast, 500.0);
    add(z, kAtMost, -1e308, 500.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 1e308);
    solver.setConstant(width, 3.0);
    solver.solve();
    EXPECT_EQ(solver.value(x), 3.0);
}

TEST_F(SolverTest, TinyAndHugeFactors_AreAlike) {
    solver.add(1e-9 * x - 5e-9, kEqual, Solver::kRequired);
    solver.add(1e9 * y - 1e9 * x - 2e9, kEqual, Solver::kRequired);
    solver.solve();
    EXPECT_DOUBLE_EQ(solver.value(x), 5.0);
    EXPECT_DOUBLE_EQ(solver.value(y), 7.0);
}

TEST_F(SolverTest, RedundantSystem_IsSolvedOnce) {
    for (int i = 1; i <= 40; ++i) {
        solver.add(static_cast<double>(i) * x + static_cast<double>(i) * y - 10.0 * i, kEqual, Solver::kRequired);
        solver.add(static_cast<double>(i) * x - 4.0 * i, kEqual, Solver::kRequired);
    }
    solver.solve();
    EXPECT_DOUBLE_EQ(solver.value(x), 4.0);
    EXPECT_DOUBLE_EQ(solver.value(y), 6.0);
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(SolverTest, LargeDegenerateSystem_EndsInBoundedSteps) {
    // A chain of 200 variables, each pair bound from both sides and wished to all meet in one point.
    Solver large;
    std::vector<Var> chain;
    for (int i = 0; i < 200; ++i) {
        chain.push_back({large.addVariable()});
    }
    for (std::size_t i = 1; i < chain.size(); ++i) {
        large.add(1.0 * chain[i] - 1.0 * chain[i - 1], kAtLeast, Solver::kRequired);
        large.add(1.0 * chain[i] - 1.0 * chain[i - 1], kAtMost, 700.0);
        large.add(1.0 * chain[i] - 1.0 * chain[0], kEqual, 600.0);
        large.add(1.0 * chain[i] - 7.0, kEqual, 500.0);
    }
    large.solve();
    EXPECT_LT(large.steps(), 5000);
    for (const Var variable : chain) {
        EXPECT_NEAR(large.value(variable), 7.0, 1e-9);
    }
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(SolverTest, TenThousandAddsAndRemoves_DoNotDrift) {
    Solver long_;
    const Var a{long_.addVariable()};
    const Var b{long_.addVariable()};
    const Var c{long_.addVariable()};
    long_.add(3.0 * b - 1.0 * a - 1.0 * c, kEqual, Solver::kRequired);
    const ConstraintId width = long_.add(7.0 * c - 1.0, kEqual, Solver::kInput);
    for (int i = 0; i < 10000; ++i) {
        const ConstraintId id = long_.add(0.7 * a - 0.3 * b - static_cast<double>(i % 13), kEqual, 400.0 + i % 7);
        long_.setConstant(width, 1.0 + i % 11);
        long_.solve();
        long_.remove(id);
    }
    long_.setConstant(width, 1.0);
    long_.add(1.0 * a - 2.0, kEqual, 300.0);
    long_.solve();
    EXPECT_EQ(long_.constraintCount(), 3U);
    EXPECT_DOUBLE_EQ(long_.value(c), 1.0 / 7.0);
    EXPECT_DOUBLE_EQ(long_.value(a), 2.0);
    EXPECT_DOUBLE_EQ(long_.value(b), (2.0 + 1.0 / 7.0) / 3.0);
}

TEST_F(SolverTest, Dump_TellsEachConstraintItsLevelAndState) {
    add(x, kEqual, 400.0, Solver::kInput);
    solver.add(1.0 * x - 1.0 * y - 15.0, kEqual, Solver::kRequired);
    add(y, kAtLeast, 0.0, Solver::kRequired);
    add(y, kEqual, 20.0, Solver::kRequired);
    solver.add(2.0 * z - 0.5 * y, kAtLeast, 750.0);
    add(z, kEqual, 400.0, 250.5);
    add(z, kEqual, 400.0, 250.5);
    EXPECT_NE(solver.dump().find("not solved since the last change"), std::string::npos);
    solver.solve();
    const char* const expected =
        "level input\n"
        "  x = 400                                          holds\n"
        "level required\n"
        "  x - y = 15                                       holds\n"
        "  y >= 0                                           room 385\n"
        "  y = 20                                           dropped, off by +365\n"
        "level 750\n"
        "  0.5*y - 2*z <= 0                                 room 607.5\n"
        "level 250.5\n"
        "  z = 400                                          holds, added 2 times\n"
        "variables\n"
        "  x = 400\n"
        "  y = 385\n"
        "  z = 400\n";
    EXPECT_EQ(solver.dump([](VariableId v) { return std::string(1, static_cast<char>('x' + v)); }), expected);
}

TEST_F(SolverTest, Dump_WithoutNames_NumbersTheVariables) {
    add(y, kAtMost, -3.0, 500.0);
    add(y, kAtLeast, 0.0, 400.0);
    solver.solve();
    EXPECT_EQ(solver.dump(),
              "level 500\n"
              "  v1 <= -3                                         holds\n"
              "level 400\n"
              "  v1 >= 0                                          off by -3\n"
              "variables\n"
              "  v0 = 0\n"
              "  v1 = -3\n"
              "  v2 = 0\n");
}

}  // namespace ktr::test
