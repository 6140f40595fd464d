#include "linux/device/FilteredLogSink.h"

#include <gtest/gtest.h>

#include "tests/support/EnvironmentVariable.h"
#include "tests/support/RecordingLogSink.h"

namespace ktr::linux_ {

namespace {

using platform::LogLevel;

class FilteredLogSinkTest : public ::testing::Test {
  protected:
    std::vector<std::string> passed(std::optional<LogLevel> lowest) {
        target->clear();
        FilteredLogSink sink(target, lowest);
        sink.write({LogLevel::Debug, "s", "c", "debug", {}});
        sink.write({LogLevel::Info, "s", "c", "info", {}});
        sink.write({LogLevel::Default, "s", "c", "default", {}});
        sink.write({LogLevel::Error, "s", "c", "error", {}});
        return target->texts();
    }
    std::shared_ptr<test::RecordingLogSink> target = std::make_shared<test::RecordingLogSink>();
};

using Texts = std::vector<std::string>;

}  // namespace

TEST_F(FilteredLogSinkTest, LevelsBelowAreDropped) {
    EXPECT_EQ(passed(LogLevel::Debug), (Texts{"debug", "info", "default", "error"}));
    EXPECT_EQ(passed(LogLevel::Default), (Texts{"default", "error"}));
    EXPECT_EQ(passed(LogLevel::Error), (Texts{"error"}));
    EXPECT_EQ(passed(std::nullopt), Texts{});
}

TEST_F(FilteredLogSinkTest, Wants_SaysTheSameBeforehand) {
    const FilteredLogSink sink(target, LogLevel::Info);
    EXPECT_FALSE(sink.wants(LogLevel::Debug));
    EXPECT_TRUE(sink.wants(LogLevel::Info));
    EXPECT_FALSE(FilteredLogSink(target, std::nullopt).wants(LogLevel::Error));
}

TEST_F(FilteredLogSinkTest, Environment_NamesTheLevel) {
    const struct {
        const char* word;
        std::optional<LogLevel> level;
    } cases[] = {{"debug", LogLevel::Debug}, {"info", LogLevel::Info},  {"default", LogLevel::Default},
                 {"error", LogLevel::Error}, {"off", std::nullopt},     {"loud", LogLevel::Error},
                 {"", LogLevel::Error},      {nullptr, LogLevel::Error}};
    for (const auto& each : cases) {
        const test::EnvironmentVariable value("KTR_LOG", each.word);
        EXPECT_EQ(FilteredLogSink::environmentLevel(), each.level) << (each.word ? each.word : "unset");
    }
}

TEST_F(FilteredLogSinkTest, UnknownWord_IsToldApartFromOff) {
    EXPECT_EQ(FilteredLogSink::levelNamed("loud"), std::nullopt);
    ASSERT_TRUE(FilteredLogSink::levelNamed("off").has_value());
    EXPECT_EQ(*FilteredLogSink::levelNamed("off"), std::nullopt);
}

}  // namespace ktr::linux_
