#include <gtest/gtest.h>
#include <sys/stat.h>

#include <future>
#include <sstream>

#include "server/admin/Administration.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using server::Administration;
using server::Newcomer;
using server::Store;

class KeepingCommandsTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void SetUp() override {
        ASSERT_EQ(command().init("localhost", 8443, ""), "");
        Newcomer ann;
        ann.name = "Ann";
        ann.handles = {"ann@x.example"};
        ASSERT_EQ(command().add(ann), "");
        Newcomer otto;
        otto.name = "Otto";
        otto.friends = {"Ann"};
        ASSERT_EQ(command().add(otto), "");
        std::string complaint;
        const auto store = Store::open({data()}, false, complaint);
        ASSERT_TRUE(store) << complaint;
        std::promise<bool> written;
        store->keep(0, store->personNamed("Ann")->id, {{kNow, kNow, 12.3456789, -3.1, std::nullopt}}, kNow,
                    [&](bool good) { written.set_value(good); });
        ASSERT_TRUE(written.get_future().get());
    }
    /// As each command is a process of its own; `said` has what it printed.
    Administration& command() {
        said.str("");
        administration_.emplace(data(), kNow + 60, said);
        return *administration_;
    }
    std::string data() const { return (folder.path() / "data").string(); }
    std::string file(const char* name) const { return (folder.path() / name).string(); }

    TemporaryFolder folder;
    std::ostringstream said;

  private:
    std::optional<Administration> administration_;
};

TEST_F(KeepingCommandsTest, Export_GoesToAPrivateFile_AndPrintsNoPosition) {
    ASSERT_EQ(command().exportPerson("Ann", file("ann.json")), "");
    EXPECT_EQ(said.str(), "all that is kept of Ann is in " + file("ann.json") + "\n");
    EXPECT_NE(TemporaryFolder::read(file("ann.json")).find("12.3456789"), std::string::npos);
    struct stat facts {};
    ASSERT_EQ(::stat(file("ann.json").c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777U, 0600U);
    EXPECT_EQ(command().exportPerson("Ann", folder.path().string()),
              folder.path().string() + ": cannot be written: this is a folder, not a file");
    EXPECT_EQ(command().exportPerson("Anne", file("x")),
              "there is nobody called \"Anne\"; ktr-service people lists all; did you mean \"Ann\"?");
}

TEST_F(KeepingCommandsTest, Restore_ReplacesPeopleOnlyWhenToldTo_AndHidesEverybody) {
    ASSERT_EQ(command().backup(file("backup")), "");
    EXPECT_EQ(TemporaryFolder::read(file("backup")).find("12.345"), std::string::npos);
    EXPECT_EQ(command().restore(file("backup"), false),
              "there are people already; --replace puts those of the backup in their place");
    EXPECT_EQ(command().restore(data() + "/service.db", true), data() + "/service.db: is the store itself");
    ASSERT_EQ(command().forget("Ann"), "");
    EXPECT_EQ(command().forget("Ann"), "there is nobody called \"Ann\"; ktr-service people lists all");
    ASSERT_EQ(command().restore(file("backup"), true), "");
    ASSERT_EQ(command().people(), "");
    EXPECT_EQ(said.str().find("Ann"), std::string::npos) << said.str();
    EXPECT_EQ(said.str().rfind("Otto, hidden", 0), 0U) << said.str();
    ASSERT_EQ(command().confirm("Otto"), "");
    EXPECT_EQ(said.str(), "readers of Otto that work again: 0; Otto is still hidden\n");
}

TEST_F(KeepingCommandsTest, Retention_TakesDurationsWithinTheBounds) {
    ASSERT_EQ(command().retention("Ann", "", ""), "");
    EXPECT_EQ(said.str(), "where Ann was is kept for 2d, who looked for 30d\n");
    ASSERT_EQ(command().retention("Ann", "24h", "7d"), "");
    ASSERT_EQ(command().retention("Ann", "90m", ""), "");
    EXPECT_EQ(said.str(), "where Ann was is kept for 90m, who looked for 7d\n");
    for (const char* wrong : {"3d", "49h", "59m", "24", "h", "-5h", "1.5h", "24 h", "999999999999999999999h", "24hh"}) {
        EXPECT_EQ(command().retention("Ann", wrong, "").rfind("--fixes: expected 1h to 48h, found", 0), 0U) << wrong;
    }
    for (const char* wrong : {"31d", "23h", "0d", "7"}) {
        EXPECT_EQ(command().retention("Ann", "", wrong).rfind("--looks: expected 1d to 30d, found", 0), 0U) << wrong;
    }
    ASSERT_EQ(command().retention("Ann", "", ""), "");
    EXPECT_EQ(said.str(), "where Ann was is kept for 90m, who looked for 7d\n");
}

}  // namespace ktr::test
