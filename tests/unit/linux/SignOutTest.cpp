#include "linux/configuration/SignOut.h"

#include <filesystem>
#include <fstream>
#include <iterator>

#include "linux/configuration/ConfigurationReader.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::test {

using linux_::SignOut;

class SignOutTest : public ::testing::Test {
  protected:
    void write(const std::string& account) {
        std::ofstream(file) << R"({"account": )" << account << R"(, "textSize": "XL"})";
        std::filesystem::permissions(file, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    }
    std::string signOut(bool keyringForgets = true) {
        return SignOut::run(file, givesUp,
                            [this, keyringForgets](const std::string& person, const std::string& host,
                                                   const std::atomic<bool>&, std::string& problem) {
                                forgotten = person + "@" + host;
                                problem = keyringForgets ? "" : "locked";
                                return keyringForgets;
                            });
    }
    linux_::Configuration configuration() const {
        const auto read = linux_::ConfigurationReader::readFile(file);
        return std::get<linux_::Configuration>(read);
    }
    TemporaryFolder folder;
    const std::filesystem::path file = folder.path() / "config.json";
    const std::filesystem::path token = folder.path() / "token";
    const std::atomic<bool> givesUp = false;
    std::string forgotten;
};

TEST_F(SignOutTest, Secret_GoesFromKeyringAndFile_AndWhoItWasStays) {
    write(R"({"personId": "mara", "host": "brin.example"})");
    std::ofstream(token) << "s3cret\n";
    EXPECT_EQ(signOut(), "");
    EXPECT_EQ(forgotten, "mara@brin.example");
    EXPECT_FALSE(std::filesystem::exists(token));
    EXPECT_EQ(configuration().account->personId, "mara");
    EXPECT_TRUE(configuration().textSize);
    EXPECT_EQ(signOut(), "") << "again changes nothing";
}

TEST_F(SignOutTest, FileElsewhere_IsNotAskedAnyMore_AndNotTakenAway) {
    const auto elsewhere = folder.path() / "elsewhere";
    std::ofstream(elsewhere) << "s3cret\n";
    write(R"({"personId": "mara", "host": "brin.example", "tokenFile": ")" + elsewhere.string() + "\"}");
    EXPECT_EQ(signOut(false), "") << "no keyring is needed for a file";
    EXPECT_FALSE(configuration().account->tokenFile);
    EXPECT_TRUE(std::filesystem::exists(elsewhere));
}

TEST_F(SignOutTest, LockedKeyring_IsSaid_AndNobodyIsAFineAnswer) {
    write(R"({"personId": "mara", "host": "brin.example"})");
    EXPECT_EQ(signOut(false), "locked");
    std::filesystem::remove(file);
    forgotten.clear();
    EXPECT_EQ(signOut(), "");
    EXPECT_EQ(forgotten, "");
}

}  // namespace ktr::test
