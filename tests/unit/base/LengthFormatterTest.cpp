#include "platform/base/LengthFormatter.h"

#include <gtest/gtest.h>

#include "tests/support/Doubles.h"

namespace ktr::test {

using platform::LengthSystem;
using platform::LengthWidth;

class LengthFormatterTest : public ::testing::Test {
  protected:
    std::string told(double metres, LengthSystem system = LengthSystem::Metric) {
        lengths_.units = system;
        return lengths_.textForMetres(metres, LengthWidth::Spoken);
    }
    FakeLengths lengths_;
};

TEST_F(LengthFormatterTest, TwoDigitsAreTold) {
    EXPECT_EQ(told(7.4), "7 metres");
    EXPECT_EQ(told(12.0), "12 metres");
    EXPECT_EQ(told(124.0), "120 metres");
    EXPECT_EQ(told(987.0), "990 metres");
}

TEST_F(LengthFormatterTest, FromAKilometreOn_Kilometres) {
    EXPECT_EQ(told(996.0), "1 kilometres");
    EXPECT_EQ(told(1449.0), "1.4 kilometres");
    EXPECT_EQ(told(12345.0), "12 kilometres");
    EXPECT_EQ(told(123456.0), "120 kilometres");
}

TEST_F(LengthFormatterTest, FeetAndYardsEndAtHalfAMile) {
    EXPECT_EQ(told(30.48, LengthSystem::UnitedStates), "100 feet");
    EXPECT_EQ(told(91.44, LengthSystem::UnitedKingdom), "100 yards");
    EXPECT_EQ(told(900.0, LengthSystem::UnitedStates), "0.6 miles");
    EXPECT_EQ(told(900.0, LengthSystem::UnitedKingdom), "0.6 miles");
}

}  // namespace ktr::test
