#include "linux/configuration/ConfigurationFile.h"

#include <filesystem>
#include <fstream>
#include <iterator>

#include "documents/FileLock.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/XdgFolders.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

namespace {

using platform::Value;

class ConfigurationFileTest : public ::testing::Test {
  protected:
    std::string text() const {
        std::ifstream stream(path);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    void write(const std::string& content) const {
        std::ofstream(path) << content;
        std::filesystem::permissions(path, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    }
    Configuration read() const {
        auto got = ConfigurationReader::readFile(path);
        const auto* error = std::get_if<ConfigurationReader::Error>(&got);
        EXPECT_EQ(error, nullptr) << error->text;
        return error == nullptr ? std::get<Configuration>(got) : Configuration();
    }

    test::TemporaryFolder folder;
    const std::filesystem::path path = std::filesystem::path(folder.path()) / "ktr" / "config.json";
    const ConfigurationFile file{path};
};

/// Every member, with a value that is good and one that is not.
struct Member {
    const char* name;
    const char* good;
    const char* bad;
};
constexpr Member kMembers[] = {
    {"account.userName", "ann@harbour.example", "[]"},
    {"account.host", "friends.example:8443", "https://friends.example/"},
    {"account.domains", R"(["friends.example"])", "[5]"},
    {"account.tokenFile", "token2", "true"},
    {"account.assistant", "assistant.example:8444", "https://assistant.example/"},
    {"certificates", "ca.pem", "{}"},
    {"contacts", R"(["a.vcf", "b.vcf"])", "[null]"},
    {"addressBooks", "false", "perhaps"},
    {"language", "de-AT", "7"},
    {"textSize", "AX3", "Huge"},
    {"colors", "high-contrast", "pink"},
    {"distances", "miles", "leagues"},
    {"geographicCountry", "DE", "de"},
    {"restrictions.friendLocationRestricted", "true", "yes"},
    {"restrictions.friendLocationAllowed", "false", "0"},
    {"positions.source", "gpsd", "stars"},
    {"positions.file", "walk.gpx", "[]"},
    {"positions.host", "127.0.0.1", "5"},
    {"positions.port", "2948", "70000"},
    {"maps.sources", R"([{"file": "town.mbtiles"}])", R"([{"file": 5}])"},
    {"maps.datum", "gcj02", "mars"},
    {"maps.cacheMegabytes", "50", "0"},
};

}  // namespace

TEST_F(ConfigurationFileTest, EveryMember_TakesWhatTheReaderTakesAndRefusesTheRestUnwritten) {
    ASSERT_EQ(file.set("account.personId", "1000"), "");
    EXPECT_EQ(read().account->personId, "1000") << "digits are a name here";
    for (const Member& member : kMembers) {
        EXPECT_EQ(file.set(member.name, member.good), "") << member.name;
        const std::string before = text();
        const std::string problem = file.set(member.name, member.bad);
        const bool isText =
            std::string(member.name) == "account.userName" || std::string(member.name) == "account.tokenFile";
        if (!isText) {
            EXPECT_NE(problem, "") << member.name;
            EXPECT_EQ(text(), before) << member.name;
        }
        EXPECT_EQ(problem.find('\n'), std::string::npos) << member.name;
    }
    EXPECT_EQ(std::size(kMembers) + 1, ConfigurationFile::names().size()) << "a member is missing here";
    const auto all = std::get<0>(file.list());
    EXPECT_EQ(all.size(), ConfigurationFile::names().size());
    read();
}

TEST_F(ConfigurationFileTest, WhatIsNotChanged_StaysAsItIs) {
    ASSERT_EQ(file.set("language", "de"), "");
    write(R"({"textSize": "XL", "unknown": {"kept": [1, 2]}, "language": "de"})");
    ASSERT_EQ(file.set("language", "fr"), "");
    EXPECT_EQ(text(),
              "{\n  \"textSize\": \"XL\",\n  \"unknown\": {\n    \"kept\": [1,2]\n  },\n  \"language\": \"fr\"\n}\n");
    EXPECT_EQ(file.change({{"textSize", std::nullopt}}), "");
    EXPECT_EQ(read().textSize, std::nullopt);
}

TEST_F(ConfigurationFileTest, UnknownMember_IsNamedWithTheNearest) {
    EXPECT_NE(file.set("acount.host", "x").find("account.host"), std::string::npos);
    EXPECT_NE(std::get<1>(file.get("textsize")).find("textSize"), std::string::npos);
    EXPECT_FALSE(std::filesystem::exists(path));
}

TEST_F(ConfigurationFileTest, BadValue_IsSaidOfItsMember_AndWhatWasWrongBeforeOfItsLine) {
    EXPECT_EQ(file.set("positions.port", "70000").rfind("positions.port: ", 0), 0U)
        << file.set("positions.port", "70000") << ": no line of a text that nobody wrote";
    ASSERT_EQ(file.set("language", "de"), "");
    EXPECT_EQ(file.set("textSize", "Huge").rfind("textSize: ", 0), 0U) << file.set("textSize", "Huge");
    write("{\n \"language\": \"de\",\n \"colors\": \"pink\"}");
    EXPECT_EQ(file.set("language", "fr").rfind(path.string() + ":3:", 0), 0U) << file.set("language", "fr");
}

TEST_F(ConfigurationFileTest, MissingFile_HasNothingAndIsMadeForItsOwner) {
    EXPECT_TRUE(std::get<0>(file.get("language")).isNull());
    EXPECT_TRUE(std::get<0>(file.list()).empty());
    ASSERT_EQ(file.set("language", "de"), "");
    EXPECT_EQ(std::filesystem::status(path).permissions() & std::filesystem::perms(077), std::filesystem::perms::none);
}

TEST_F(ConfigurationFileTest, BrokenFile_IsNotReplaced) {
    ASSERT_EQ(file.set("language", "de"), "");
    write("{\"language\": ");
    EXPECT_NE(file.set("language", "fr"), "");
    EXPECT_EQ(text(), "{\"language\": ");
    std::filesystem::remove(path);
    std::filesystem::create_directory(path);
    EXPECT_NE(file.set("language", "fr"), "") << "a folder";
}

TEST_F(ConfigurationFileTest, Link_StaysAndWhatItLeadsToIsChanged) {
    const auto kept = std::filesystem::path(folder.path()) / "kept.json";
    std::filesystem::create_directories(path.parent_path());
    std::filesystem::create_symlink(kept, path);
    std::ofstream(kept) << "{}";
    std::filesystem::permissions(kept, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    EXPECT_EQ(file.set("textSize", "XL"), "");
    EXPECT_TRUE(std::filesystem::is_symlink(path));
    EXPECT_NE(text().find("XL"), std::string::npos);
}

TEST_F(ConfigurationFileTest, FileInTheWorkingFolder_IsWritten) {
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(folder.path());
    EXPECT_EQ(ConfigurationFile("here.json").set("textSize", "XL"), "");
    std::filesystem::current_path(before);
    EXPECT_TRUE(std::filesystem::exists(std::filesystem::path(folder.path()) / "here.json"));
}

TEST_F(ConfigurationFileTest, TildeOfAPath_IsTheUsersOwnFolder) {
    std::filesystem::create_directories(path.parent_path());
    write(R"({"contacts": ["~/a.vcf", "~", "~b/c.vcf"]})");
    const auto contacts = read().contacts;
    EXPECT_EQ(contacts, (std::vector<std::string>{(XdgFolders::home() / "a.vcf").string(), XdgFolders::home().string(),
                                                  (path.parent_path() / "~b" / "c.vcf").string()}));
}

}  // namespace ktr::linux_
