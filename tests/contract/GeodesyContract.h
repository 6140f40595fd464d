#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/location/Geodesy.h"

namespace ktr::test {

struct GeodesyCase {
    std::string name;
    std::function<std::shared_ptr<platform::Geodesy>()> make;
};

class GeodesyContract : public ::testing::TestWithParam<GeodesyCase> {
  protected:
    void SetUp() override { geodesy = GetParam().make(); }
    std::shared_ptr<platform::Geodesy> geodesy;
};

}  // namespace ktr::test
