#include "linux/device/StderrLogSink.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "tests/support/EnvironmentVariable.h"

namespace ktr::linux_ {

namespace {

using platform::FormatArgument;
using platform::LogLevel;

class StderrLogSinkTest : public ::testing::Test {
  protected:
    struct Close {
        void operator()(std::FILE* open) const { std::fclose(open); }
    };
    std::unique_ptr<std::FILE, Close> file{std::tmpfile()};

    std::string written() {
        std::rewind(file.get());
        std::string text;
        for (int c = std::fgetc(file.get()); c != EOF; c = std::fgetc(file.get())) {
            text += static_cast<char>(c);
        }
        return text;
    }
};

}  // namespace

TEST_F(StderrLogSinkTest, ARecord_IsOneLineWithLevelSubsystemAndCategory) {
    StderrLogSink sink(false, file.get());
    sink.write({LogLevel::Info, "org.ktr.snippets", "_", "Locked state is %i", {FormatArgument(1)}});
    EXPECT_EQ(written(), "info org.ktr.snippets _: Locked state is 1\n");
}

TEST_F(StderrLogSinkTest, PrivateArguments_AreRedacted) {
    StderrLogSink sink(false, file.get());
    sink.write(
        {LogLevel::Default, "s", "c", "%@ is at %@", {FormatArgument("Ann"), FormatArgument(std::string("pier"))}});
    EXPECT_EQ(written(), "default s c: <private> is at <private>\n");
}

TEST_F(StderrLogSinkTest, ShowPrivate_RevealsThem) {
    StderrLogSink sink(true, file.get());
    sink.write({LogLevel::Debug, "s", "c", "%@", {FormatArgument("Ann")}});
    EXPECT_EQ(written(), "debug s c: Ann\n");
}

TEST_F(StderrLogSinkTest, ATokenIsNeverShown) {
    StderrLogSink sink(true, file.get());
    sink.write({LogLevel::Error, "s", "c", "%@", {FormatArgument(platform::Dictionary{{"authToken", "secret"}})}});
    EXPECT_EQ(written().find("secret"), std::string::npos);
}

/// What describes itself as an answer of the service does.
struct DescribedAnswer : platform::Object {
    std::string description() const override { return R"(({"authToken":"secret","city":"Port"}))"; }
};

TEST_F(StderrLogSinkTest, ATokenInsideAnObjectsDescription_IsNotShown) {
    StderrLogSink sink(true, file.get());
    sink.write(
        {LogLevel::Error, "s", "c", "visibility_response: %@", {FormatArgument(std::make_shared<DescribedAnswer>())}});
    EXPECT_EQ(written(), "error s c: visibility_response: ({\"authToken\":\"<hidden>\",\"city\":\"Port\"})\n");
}

TEST_F(StderrLogSinkTest, AKnownToken_IsNotShownWhateverEchoesIt) {
    const auto secrets = std::make_shared<linux_::KnownSecrets>();
    StderrLogSink sink(true, file.get(), secrets);
    secrets->add("t0ken/value");
    const platform::Url url("ktrServerContext://serverContext?a=t0ken%2Fvalue&");
    sink.write({LogLevel::Error,
                "s",
                "t0ken/value",
                "t0ken/value %@ %@",
                {FormatArgument("a t0ken/value b"), FormatArgument(url)}});
    EXPECT_EQ(written(), "error s <hidden>: <hidden> a <hidden> b ktrServerContext://serverContext?a=<hidden>&\n");
}

TEST_F(StderrLogSinkTest, LineEndsAndControlCharacters_AreEscaped) {
    StderrLogSink sink(true, file.get());
    sink.write({LogLevel::Error, "s", "c", "%@", {FormatArgument(std::string("a\nb\r\tc\x1b[31m\u0085\u2028é"))}});
    EXPECT_EQ(written(), "error s c: a\\nb\\r\\tc\\x1b[31m\\u0085\\u2028é\n");
}

TEST_F(StderrLogSinkTest, ManyThreads_WriteWholeLines) {
    StderrLogSink sink(false, file.get());
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i) {
        threads.emplace_back([&sink] {
            for (int n = 0; n < 100; ++n) {
                sink.write({LogLevel::Error, "s", "c", "a line of some length that could be cut", {}});
            }
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    std::string expected;
    for (int n = 0; n < 400; ++n) {
        expected += "error s c: a line of some length that could be cut\n";
    }
    EXPECT_EQ(written(), expected);
}

TEST_F(StderrLogSinkTest, OnlyTheWordShow_RevealsPrivateArguments) {
    const test::EnvironmentVariable show("KTR_LOG_PRIVATE", "show");
    EXPECT_TRUE(StderrLogSink::environmentShowsPrivate());
    for (const char* other : {"", "1", "SHOW", "hide"}) {
        const test::EnvironmentVariable value("KTR_LOG_PRIVATE", other);
        EXPECT_FALSE(StderrLogSink::environmentShowsPrivate()) << other;
    }
    const test::EnvironmentVariable unset("KTR_LOG_PRIVATE", nullptr);
    EXPECT_FALSE(StderrLogSink::environmentShowsPrivate());
}

}  // namespace ktr::linux_
