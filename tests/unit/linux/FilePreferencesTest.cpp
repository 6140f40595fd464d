#include "linux/configuration/FilePreferences.h"

#include "tests/support/PlatformTest.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::FilePreferences;

class FilePreferencesTest : public PlatformTest {
  protected:
    static constexpr const char* kDomain = "org.ktr.snippets";
    TemporaryFolder folder;
};

TEST_F(FilePreferencesTest, Value_IsSeenAtOnceAndByTheNextProcess) {
    {
        FilePreferences settings(folder.path());
        EXPECT_EQ(settings.value("host", kDomain), std::nullopt);
        settings.setValue("host", "a.example", kDomain);
        EXPECT_EQ(settings.value("host", kDomain), "a.example");
        EXPECT_EQ(settings.value("host", "org.ktr.other"), std::nullopt);
        settings.synchronize(kDomain);
    }
    FilePreferences again(folder.path());
    EXPECT_EQ(again.value("host", kDomain), "a.example");
    again.setValue("host", std::nullopt, kDomain);
    EXPECT_EQ(again.value("host", kDomain), std::nullopt);
    again.synchronize(kDomain);
    again.waitUntilSynchronized();
    EXPECT_EQ(FilePreferences(folder.path()).value("host", kDomain), std::nullopt);
}

TEST_F(FilePreferencesTest, Unsynchronized_StaysInMemory) {
    {
        FilePreferences settings(folder.path());
        settings.setValue("host", "a.example", kDomain);
    }
    EXPECT_EQ(FilePreferences(folder.path()).value("host", kDomain), std::nullopt);
}

TEST_F(FilePreferencesTest, Synchronize_BringsWhatOthersWrote) {
    FilePreferences one(folder.path());
    FilePreferences other(folder.path());
    one.setValue("a", "1", kDomain);
    other.setValue("b", "2", kDomain);
    one.synchronize(kDomain);
    one.waitUntilSynchronized();
    other.synchronize(kDomain);
    other.waitUntilSynchronized();
    EXPECT_EQ(other.value("a", kDomain), "1");
    EXPECT_EQ(one.value("b", kDomain), std::nullopt);
    one.synchronize(kDomain);
    one.waitUntilSynchronized();
    EXPECT_EQ(one.value("b", kDomain), "2");
}

TEST_F(FilePreferencesTest, FailedWrite_KeepsTheValueAndTriesAgain) {
    const auto place = folder.path() / "place";
    folder.write("place", "a file where the folder should be");
    FilePreferences settings(place);
    settings.setValue("host", "a.example", kDomain);
    settings.synchronize(kDomain);
    settings.waitUntilSynchronized();
    EXPECT_EQ(settings.value("host", kDomain), "a.example");
    const auto errors = log->texts(platform::LogLevel::Error);
    ASSERT_EQ(errors.size(), 1U);
    expectErrorLine(errors.front());
    std::filesystem::remove(place);
    settings.synchronize(kDomain);
    settings.waitUntilSynchronized();
    EXPECT_EQ(FilePreferences(place).value("host", kDomain), "a.example");
}

TEST_F(FilePreferencesTest, DomainThatIsNoFileName_WritesNothing) {
    FilePreferences settings(folder.path());
    for (const char* domain : {"", "..", "../up", "a/b", ".hidden"}) {
        settings.setValue("key", "value", domain);
        settings.synchronize(domain);
        EXPECT_EQ(settings.value("key", domain), "value");
    }
    settings.waitUntilSynchronized();
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

}  // namespace ktr::test
