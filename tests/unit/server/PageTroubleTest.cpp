// People's pages while the store cannot be written or read.
#include <gtest/gtest.h>
#include <sqlite3.h>

#include "tests/unit/server/PageFixture.h"

namespace ktr::test {

using server::HttpResponse;
using server::Precision;

class PageTroubleTest : public PageFixture {
  protected:
    /// On the store's file, as somebody else.
    void execute(const std::string& sql) {
        sqlite3* other = nullptr;
        const std::string file = (folder_.path() / "data" / "service.db").string();
        ASSERT_EQ(::sqlite3_open(file.c_str(), &other), SQLITE_OK);
        EXPECT_EQ(::sqlite3_exec(other, sql.c_str(), nullptr, nullptr, nullptr), SQLITE_OK) << ::sqlite3_errmsg(other);
        ::sqlite3_close(other);
    }
    static constexpr const char* kTables[] = {"person", "device", "share", "browser", "sign_in", "place"};
};

TEST_F(PageTroubleTest, WhatCannotBeWritten_IsNotSaidToBeDone) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    ASSERT_TRUE(store_->setPlace(mara_, {0, "Home", "", 50.0, 8.0, 150.0, false}));
    ASSERT_TRUE(store_->addSignIn(mara_, "second", now_));
    const auto grant = leasGrant();
    const std::string device = std::to_string(store_->devicesOf(mara_).front().id);
    const std::string place = std::to_string(store_->placesOf(mara_).front().id);
    for (const std::string table : kTables) {
        for (const std::string what : {"INSERT", "UPDATE", "DELETE"}) {
            execute("CREATE TRIGGER full_" + table + what + " BEFORE " + what + " ON " + table +
                    " BEGIN SELECT RAISE(ABORT, 'full'); END");
        }
    }
    for (const auto& [target, fields] :
         {std::pair(std::string("/me/visible"), "state=off"), std::pair(std::string("/me/out"), ""),
          std::pair(std::string("/me/phone"), ""), std::pair(std::string("/me/delete"), ""),
          std::pair(std::string("/me/settings"), "language=en&zone=UTC&places=3600&looks=86400"),
          std::pair(std::string("/me/share/with"), "who=Ann&exactness=town&until=changed"),
          std::pair("/me/devices/" + device + "/end", ""), std::pair("/me/places/" + place + "/remove", ""),
          std::pair(address(), "exactness=town&until=changed"), std::pair(address("/stop"), ""),
          std::pair(address("/keep"), "")}) {
        EXPECT_EQ(post(target, fields).status, 503) << target;
    }
    EXPECT_EQ(send(request("POST", "/me/in", "link=second")).status, 503) << "and the link is not spent";
    for (const std::string table : kTables) {
        for (const std::string what : {"INSERT", "UPDATE", "DELETE"}) {
            execute("DROP TRIGGER full_" + table + what);
        }
    }
    EXPECT_FALSE(store_->person(mara_)->hidden);
    EXPECT_EQ(leasGrant(), grant);
    EXPECT_EQ(store_->devicesOf(mara_).size(), 1U);
    EXPECT_EQ(get("/me").status, 200) << "still signed in";
    EXPECT_EQ(post("/me/visible", "state=off").status, 303);
    EXPECT_EQ(send(request("POST", "/me/in", "link=second")).status, 303);
}

TEST_F(PageTroubleTest, WhatCannotBeRead_IsNotSaidToBeNothing) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    execute("ALTER TABLE share RENAME TO gone");
    EXPECT_EQ(get("/me").status, 503) << "not that nobody sees her";
    EXPECT_EQ(get(address()).status, 503);
    EXPECT_EQ(post(address("/stop")).status, 503) << "not that it has ended";
    execute("ALTER TABLE gone RENAME TO share");
    EXPECT_TRUE(has(get("/me"), "One person can see where you are."));
    execute("ALTER TABLE browser RENAME TO gone");
    EXPECT_EQ(get("/me").status, 503) << "not that she is signed out";
    execute("ALTER TABLE gone RENAME TO browser");
    EXPECT_EQ(get("/me").status, 200);
}

TEST_F(PageTroubleTest, NamesThatAreNoText_AreNobodys) {
    signIn();
    EXPECT_EQ(post("/me/share", "who=a%00b").status, 400);
    EXPECT_EQ(post("/me/share", "who=%ff").status, 400);
}

}  // namespace ktr::test
