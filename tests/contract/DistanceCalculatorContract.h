#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/client/DistanceCalculator.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

struct DistanceCalculatorCase {
    std::string name;
    std::function<std::shared_ptr<platform::DistanceCalculatorFactory>()> make;
};

class DistanceCalculatorContract : public PlatformTest, public ::testing::WithParamInterface<DistanceCalculatorCase> {
  protected:
    void SetUp() override {
        factory = GetParam().make();
        // Metric units and English words, which every implementation knows.
        calculator = factory->makeDistanceCalculator({"org.example.group", "en", "en-IE", localization});
    }
    std::shared_ptr<platform::DistanceCalculatorFactory> factory;
    std::shared_ptr<platform::DistanceCalculator> calculator;
};

}  // namespace ktr::test
