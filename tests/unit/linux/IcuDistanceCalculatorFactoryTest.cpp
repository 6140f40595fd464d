#include "linux/locale/IcuDistanceCalculatorFactory.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "linux/positions/GeographicLibGeodesy.h"
#include "tests/support/EnvironmentVariable.h"

namespace ktr::linux_ {

namespace {

class IcuDistanceCalculatorFactoryTest : public ::testing::Test {
  protected:
    long systemWith(const QByteArray& preferences, const std::string& suite = "group.friends") {
        QFile file(folder.filePath(QStringLiteral("group.friends.conf")));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(preferences);
        file.close();
        IcuDistanceCalculatorFactory factory(std::make_shared<GeographicLibGeodesy>(), folder.path().toStdString());
        return factory.makeDistanceCalculator({suite, "en", "de-DE", nullptr})->measurementSystem();
    }
    QTemporaryDir folder;
};

}  // namespace

TEST_F(IcuDistanceCalculatorFactoryTest, TheSuitesPreference_OverridesTheUnits) {
    EXPECT_EQ(systemWith("[units]\nsystem=us\n"), 1);
    EXPECT_EQ(systemWith("[units]\nsystem=uk\n"), 2);
    EXPECT_EQ(systemWith("[units]\nsystem=metric\n"), 0);
}

TEST_F(IcuDistanceCalculatorFactoryTest, AnotherWordSuiteOrAnEmptyFile_OverridesNothing) {
    EXPECT_EQ(systemWith("[units]\nsystem=furlongs\n"), 0);
    EXPECT_EQ(systemWith(""), 0);
    EXPECT_EQ(systemWith("[units]\nsystem=us\n", "group.other"), 0);
    EXPECT_EQ(systemWith("[units]\nsystem=us\n", "../group.friends"), 0);
    EXPECT_EQ(systemWith("[units]\nsystem=us\n", ""), 0);
}

TEST_F(IcuDistanceCalculatorFactoryTest, TheSessionsPreferences_StandInItsConfiguration) {
    const test::EnvironmentVariable home("XDG_CONFIG_HOME", "/somewhere/config");
    EXPECT_EQ(IcuDistanceCalculatorFactory::sessionPreferences(), "/somewhere/config/ktr");
}

TEST_F(IcuDistanceCalculatorFactoryTest, WithoutAFolder_NothingOverridesTheUnits) {
    IcuDistanceCalculatorFactory factory(std::make_shared<GeographicLibGeodesy>());
    EXPECT_EQ(factory.makeDistanceCalculator({"group", "en", "en-US", nullptr})->measurementSystem(), 1);
}

TEST_F(IcuDistanceCalculatorFactoryTest, WhatIsChosen_GoesBeforeThePreference) {
    systemWith("[units]\nsystem=us\n");
    IcuDistanceCalculatorFactory factory(std::make_shared<GeographicLibGeodesy>(), folder.path().toStdString(),
                                         UnitSystem::ImperialUK);
    EXPECT_EQ(factory.makeDistanceCalculator({"group.friends", "en", "de-DE", nullptr})->measurementSystem(), 2);
}

}  // namespace ktr::linux_
