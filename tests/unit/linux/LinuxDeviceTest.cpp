#include "linux/device/LinuxDevice.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace ktr::linux_ {

using platform::ContentSizeCategory;
using platform::UserInterfaceIdiom;

TEST(LinuxDeviceTest, TextScale_PicksTheCategory) {
    const std::vector<std::pair<double, ContentSizeCategory>> cases = {
        {0.5, ContentSizeCategory::XS},    {0.849, ContentSizeCategory::XS}, {0.85, ContentSizeCategory::S},
        {0.92, ContentSizeCategory::M},    {0.98, ContentSizeCategory::L},   {1.0, ContentSizeCategory::L},
        {1.07, ContentSizeCategory::XL},   {1.19, ContentSizeCategory::XXL}, {1.25, ContentSizeCategory::XXL},
        {1.32, ContentSizeCategory::XXXL}, {1.5, ContentSizeCategory::AX1},  {1.85, ContentSizeCategory::AX2},
        {2.0, ContentSizeCategory::AX2},   {2.2, ContentSizeCategory::AX3},  {2.6, ContentSizeCategory::AX4},
        {2.94, ContentSizeCategory::AX4},  {2.95, ContentSizeCategory::AX5}, {1e9, ContentSizeCategory::AX5}};
    for (const auto& [scale, category] : cases) {
        EXPECT_EQ(LinuxDevice::categoryForTextScale(scale), category) << scale;
    }
    EXPECT_EQ(LinuxDevice::categoryForTextScale(std::numeric_limits<double>::quiet_NaN()), ContentSizeCategory::L);
}

TEST(LinuxDeviceTest, Names_AreReadInAnyCase) {
    EXPECT_EQ(LinuxDevice::categoryNamed("xxxl"), ContentSizeCategory::XXXL);
    EXPECT_EQ(LinuxDevice::categoryNamed("AX3"), ContentSizeCategory::AX3);
    EXPECT_FALSE(LinuxDevice::categoryNamed("huge"));
    EXPECT_EQ(LinuxDevice::idiomNamed("Tablet"), UserInterfaceIdiom::Tablet);
    EXPECT_FALSE(LinuxDevice::idiomNamed(""));
    EXPECT_EQ(LinuxDevice::nameOf(ContentSizeCategory::AX5), "AX5");
    EXPECT_EQ(LinuxDevice::nameOf(UserInterfaceIdiom::Display), "display");
}

TEST(LinuxDeviceTest, Scale_IsNeverNone) {
    LinuxDevice device;
    device.setMainScreenScale(1.5);
    for (const double scale : {0.0, -1.0, std::numeric_limits<double>::infinity(), std::nan("")}) {
        device.setMainScreenScale(scale);
    }
    EXPECT_EQ(device.mainScreenScale(), 1.5);
}

}  // namespace ktr::linux_
