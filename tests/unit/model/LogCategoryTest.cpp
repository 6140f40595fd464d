#include "model/LogCategory.h"

#include <thread>
#include <vector>

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

class LogCategoryTest : public PlatformTest {};

TEST_F(LogCategoryTest, ThereIsOneHandle) {
    EXPECT_EQ(LogCategory_Unspecified(), LogCategory_Unspecified());
}

TEST_F(LogCategoryTest, ItCarriesThePluginsIdentifierAndTheCategory) {
    LogCategory_Unspecified()->line("a line");
    ASSERT_EQ(log->lines().size(), 1U);
    EXPECT_EQ(log->lines()[0],
              (RecordingLogSink::Line{platform::LogLevel::Default, "org.ktr.snippets", "_", "a line", "a line"}));
}

TEST_F(LogCategoryTest, AnotherPlatformHasItsOwn) {
    const auto first = LogCategory_Unspecified();
    platform::Platform::install(std::make_shared<platform::Platform>());
    EXPECT_NE(LogCategory_Unspecified(), first);
}

TEST_F(LogCategoryTest, WithoutAPlatformLinesGoNowhere) {
    platform::Platform::install(nullptr);
    LogCategory_Unspecified()->line("unheard");
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(LogCategoryTest, AnyThreadGetsTheOneHandle) {
    std::vector<std::shared_ptr<const platform::Log>> handles(8);
    std::vector<std::thread> threads;
    for (auto& handle : handles) {
        threads.emplace_back([&handle] { handle = LogCategory_Unspecified(); });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    for (const auto& handle : handles) {
        EXPECT_EQ(handle, LogCategory_Unspecified());
    }
}

}  // namespace
}  // namespace ktr::test
