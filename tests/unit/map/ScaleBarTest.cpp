#include "platform/map/ScaleBar.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::test {

using platform::LengthSystem;
using platform::LengthUnit;
using platform::ScaleBar;

TEST(ScaleBarTest, TheRoundestLengthIsTaken) {
    const ScaleBar bar = ScaleBar::at(1.5, LengthSystem::Metric);
    EXPECT_EQ(bar.amount, 100.0);
    EXPECT_EQ(bar.unit, LengthUnit::Meter);
    EXPECT_NEAR(bar.points, 100.0 / 1.5, 1e-9);
    EXPECT_EQ(ScaleBar::at(0.9, LengthSystem::Metric).amount, 50.0);
    EXPECT_EQ(ScaleBar::at(3.0, LengthSystem::Metric).amount, 200.0);
    EXPECT_EQ(ScaleBar::at(12.0, LengthSystem::Metric).unit, LengthUnit::Kilometer);
    EXPECT_EQ(ScaleBar::at(12.0, LengthSystem::Metric).amount, 1.0);
}

TEST(ScaleBarTest, AtEveryScale_ItFits) {
    for (const auto system : {LengthSystem::Metric, LengthSystem::UnitedStates, LengthSystem::UnitedKingdom}) {
        for (double metres = 0.1; metres < 20000.0; metres *= 1.01) {
            const ScaleBar bar = ScaleBar::at(metres, system);
            EXPECT_GE(bar.points, 40.0 - 1e-6) << metres;
            EXPECT_LE(bar.points, 100.0 + 1e-6) << metres;
            EXPECT_NEAR(bar.amount * lengthOf(bar.unit), bar.points * metres, 1e-6 * bar.points * metres);
        }
    }
}

TEST(ScaleBarTest, UnitsFollowTheSystem) {
    EXPECT_EQ(ScaleBar::at(1.0, LengthSystem::UnitedStates).unit, LengthUnit::Foot);
    EXPECT_EQ(ScaleBar::at(1.0, LengthSystem::UnitedKingdom).unit, LengthUnit::Yard);
    EXPECT_EQ(ScaleBar::at(20.0, LengthSystem::UnitedStates).unit, LengthUnit::Mile);
    EXPECT_EQ(ScaleBar::at(20.0, LengthSystem::UnitedKingdom).unit, LengthUnit::Mile);
}

TEST(ScaleBarTest, NoScale_NoBar) {
    for (const double metres : {0.0, -1.0, std::nan(""), HUGE_VAL}) {
        EXPECT_EQ(ScaleBar::at(metres, LengthSystem::Metric), ScaleBar{});
    }
}

}  // namespace ktr::test
