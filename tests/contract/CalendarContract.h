#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/base/Clock.h"

namespace ktr::test {

struct CalendarCase {
    std::string name;
    /// A calendar in UTC.
    std::function<std::shared_ptr<platform::Calendar>()> make;
};

class CalendarContract : public ::testing::TestWithParam<CalendarCase> {
  protected:
    void SetUp() override { calendar = GetParam().make(); }
    std::shared_ptr<platform::Calendar> calendar;
};

}  // namespace ktr::test
