#include "documents/FileReader.h"

#include <gtest/gtest.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using documents::FileReader;

class FileReaderTest : public ::testing::Test {
  protected:
    static std::string reasonOf(const std::filesystem::path& file, const FileReader::Terms& terms) {
        const auto read = FileReader::read(file, terms);
        const auto* error = std::get_if<FileReader::Error>(&read);
        return error == nullptr ? "no error" : error->reason;
    }
    TemporaryFolder folder;
};

TEST_F(FileReaderTest, Bytes_AreReadAsTheyStand) {
    const std::string bytes = std::string("\0\r\n\xFF", 4) + std::string(300'000, 'x');
    EXPECT_EQ(std::get<std::string>(FileReader::read(folder.write("a", bytes))), bytes);
    EXPECT_EQ(std::get<std::string>(FileReader::read(folder.write("b", ""))), "");
}

TEST_F(FileReaderTest, FileWithoutASize_IsReadToItsEnd) {
    // The kernel's own files say that they are empty.
    const auto read = FileReader::read("/proc/self/status");
    ASSERT_TRUE(std::holds_alternative<std::string>(read));
    EXPECT_NE(std::get<std::string>(read).find("VmPeak"), std::string::npos);
}

TEST_F(FileReaderTest, Size_IsAllowedUpToTheLastByte) {
    const auto file = folder.write("a", std::string(2048, 'x'));
    EXPECT_EQ(reasonOf(file, {2048, {}}), "no error");
    EXPECT_EQ(reasonOf(file, {2047, {}}), "the file is larger than 1 KiB");
    EXPECT_EQ(reasonOf("/proc/self/status", {10, {}}), "the file is larger than 10 bytes");
}

TEST_F(FileReaderTest, Refusal_IsOfTheOpenedFile) {
    const auto file = folder.write("a", "x", 0640);
    std::size_t size = 0;
    const auto refuse = [&](const struct stat& facts) {
        size = static_cast<std::size_t>(facts.st_size);
        return (facts.st_mode & 040U) != 0 ? "others may read it" : "";
    };
    EXPECT_EQ(reasonOf(file, {100, refuse}), "others may read it");
    EXPECT_EQ(size, 1U);
}

TEST_F(FileReaderTest, NameWithAZeroByte_IsNoName) {
    folder.write("a", "x");
    EXPECT_EQ(reasonOf(folder.path() / std::string("a\0b", 3), {}), "there is no such file");
}

}  // namespace ktr::test
