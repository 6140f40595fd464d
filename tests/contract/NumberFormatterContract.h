#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/base/Region.h"

namespace ktr::test {

struct NumberFormatterCase {
    std::string name;
    /// A formatter for English as written in the United Kingdom.
    std::function<std::shared_ptr<platform::NumberFormatter>()> make;
};

class NumberFormatterContract : public ::testing::TestWithParam<NumberFormatterCase> {
  protected:
    void SetUp() override { numbers = GetParam().make(); }
    std::shared_ptr<platform::NumberFormatter> numbers;
};

}  // namespace ktr::test
