#include "linux/device/SystemDeviceInformation.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/utsname.h>

#include <filesystem>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::SystemDeviceInformation;

class SystemDeviceInformationTest : public ::testing::Test {
  protected:
    TemporaryFolder root;
};

TEST_F(SystemDeviceInformationTest, Facts_ComeFromFirmwareAndOsRelease) {
    root.write("sys/class/dmi/id/product_name", "  Lantern 9 \n");
    root.write("etc/os-release", "# a comment\nNAME=Debian\nVERSION_ID=\"12.5\"\nBUILD_ID='b\\7'\n");
    const SystemDeviceInformation device(root.path());
    EXPECT_EQ(device.productType(), "Lantern 9");
    EXPECT_EQ(device.operatingSystemVersion(), "12.5");
    EXPECT_EQ(device.operatingSystemBuild(), "b\\7");
}

TEST_F(SystemDeviceInformationTest, WhatIsMissing_IsNone) {
    const SystemDeviceInformation device(root.path());
    EXPECT_EQ(device.productType(), std::nullopt);
    EXPECT_EQ(device.operatingSystemVersion(), std::nullopt);
    utsname kernel{};
    ASSERT_EQ(::uname(&kernel), 0);
    EXPECT_EQ(device.operatingSystemBuild(), kernel.release);
}

TEST_F(SystemDeviceInformationTest, FillerOfTheFirmware_GivesWayToTheDeviceTree) {
    root.write("sys/class/dmi/id/product_name", "To Be Filled By O.E.M.\n");
    root.write("proc/device-tree/model", std::string("Board 4\0", 8));
    root.write("usr/lib/os-release", "VERSION_ID=7\n");
    const SystemDeviceInformation device(root.path());
    EXPECT_EQ(device.productType(), "Board 4");
    EXPECT_EQ(device.operatingSystemVersion(), "7");
}

TEST_F(SystemDeviceInformationTest, WhatIsNoFile_IsNotWaitedFor) {
    std::filesystem::create_directories(root.path() / "sys/class/dmi/id");
    ASSERT_EQ(::mkfifo((root.path() / "sys/class/dmi/id/product_name").c_str(), 0600), 0);
    std::filesystem::create_directories(root.path() / "etc/os-release");
    root.write("usr/lib/os-release", "VERSION_ID=7\n");
    const SystemDeviceInformation device(root.path());
    EXPECT_EQ(device.productType(), std::nullopt);
    EXPECT_EQ(device.operatingSystemVersion(), "7");
}

TEST_F(SystemDeviceInformationTest, Identifier_IsStableAndNotTheMachinesOwn) {
    const auto identifier = SystemDeviceInformation().uniqueDeviceIdentifier();
    EXPECT_EQ(identifier, SystemDeviceInformation(root.path()).uniqueDeviceIdentifier());
    if (identifier) {
        EXPECT_EQ(identifier->size(), 32U);
        EXPECT_EQ(TemporaryFolder::read("/etc/machine-id").find(*identifier), std::string::npos);
    }
}

}  // namespace ktr::test
