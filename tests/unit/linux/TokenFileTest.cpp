#include "linux/configuration/TokenFile.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::TokenFile;

class TokenFileTest : public ::testing::Test {
  protected:
    std::string refusalOf(const std::filesystem::path& file) const {
        const auto read = TokenFile::read(file);
        const auto* error = std::get_if<TokenFile::Error>(&read);
        return error != nullptr ? error->text : "no error";
    }
    TemporaryFolder folder;
};

TEST_F(TokenFileTest, PrivateFile_GivesItsLine) {
    const auto read = TokenFile::read(folder.write("token", "s3cret\n", 0600));
    ASSERT_TRUE(std::holds_alternative<std::string>(read));
    EXPECT_EQ(std::get<std::string>(read), "s3cret");
    EXPECT_TRUE(std::holds_alternative<std::string>(TokenFile::read(folder.write("token", "s3cret", 0400))));
}

TEST_F(TokenFileTest, FileThatOthersReach_IsRefusedWithItsModeAndWithoutItsText) {
    for (const unsigned mode : {0640U, 0604U, 0620U, 0601U, 0666U}) {
        const std::string text = refusalOf(folder.write("token", "s3cret", mode));
        EXPECT_NE(text.find("chmod 600"), std::string::npos) << text;
        EXPECT_EQ(text.find("s3cret"), std::string::npos);
        EXPECT_EQ(text.find((folder.path() / "token").string()), 0U);
    }
}

TEST_F(TokenFileTest, WhatIsNoTokenFile_IsRefused) {
    EXPECT_NE(refusalOf(folder.path()).find("a folder, not a file"), std::string::npos);
    EXPECT_NE(refusalOf(folder.write("a", "")).find("one line"), std::string::npos);
    EXPECT_NE(refusalOf(folder.write("b", "one\ntwo\n")).find("one line"), std::string::npos);
    EXPECT_NE(refusalOf(folder.write("c", std::string(20000, 'x'))).find("larger than 16 KiB"), std::string::npos);
    const auto pipe = folder.path() / "pipe";
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_NE(refusalOf(pipe).find("a pipe, not a file"), std::string::npos);
    const auto read = TokenFile::read(folder.path() / "none");
    ASSERT_TRUE(std::holds_alternative<TokenFile::Error>(read));
    EXPECT_TRUE(std::get<TokenFile::Error>(read).missing);
}

}  // namespace ktr::test
