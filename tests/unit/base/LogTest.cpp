#include "platform/base/Log.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

class LogTest : public PlatformTest {};

TEST_F(LogTest, LinesKeepFormatAndArgumentsApartUntilTheSink) {
    const platform::Log handle("sub", "cat");
    handle.line("at default %@", "x");
    handle.write(platform::LogLevel::Debug, "at debug %i", 1);
    ASSERT_EQ(log->lines().size(), 2U);
    EXPECT_EQ(log->lines()[0],
              (RecordingLogSink::Line{platform::LogLevel::Default, "sub", "cat", "at default %@", "at default x"}));
    EXPECT_EQ(log->lines()[1].level, platform::LogLevel::Debug);
}

TEST_F(LogTest, WithoutAPlatformLinesGoNowhere) {
    const platform::Log handle("sub", "cat");
    platform::Platform::install(nullptr);
    handle.line("unheard");
    EXPECT_TRUE(log->lines().empty());
}

}  // namespace
}  // namespace ktr::test
