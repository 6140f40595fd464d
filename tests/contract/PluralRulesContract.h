#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/base/PluralRules.h"

namespace ktr::test {

struct PluralRulesCase {
    std::string name;
    std::function<std::shared_ptr<platform::PluralRules>()> make;
};

class PluralRulesContract : public ::testing::TestWithParam<PluralRulesCase> {
  protected:
    void SetUp() override { rules = GetParam().make(); }
    std::shared_ptr<platform::PluralRules> rules;
};

}  // namespace ktr::test
