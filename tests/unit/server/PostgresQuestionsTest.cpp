// Many questions of one kind reach the server as one.
#include "server/store/PostgresQuestions.h"

#include <gtest/gtest.h>

#include <deque>
#include <string>
#include <vector>

#include "server/store/Database.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Database;
using server::DatabaseValue;
using server::Fix;
using server::PostgresQuestions;
using server::Precision;
using Type = DatabaseValue::Type;

TEST(PostgresQuestionsTest, ValuesAreArrays_AndTheStatementReadsThemByName) {
    const std::vector<DatabaseValue> first{DatabaseValue::of(std::int64_t{7}),
                                           DatabaseValue::of(Type::Text, R"(a "b" \c,{}NULL)")};
    const std::vector<DatabaseValue> second{DatabaseValue::none(Type::Integer), DatabaseValue::of(Type::Text, "")};
    const PostgresQuestions questions("SELECT x FROM y WHERE z = $1 AND ($2 = '' OR $1 > 0)", {&first, &second});
    EXPECT_EQ(questions.sql(),
              "SELECT asked.number, answer.* FROM unnest($1::BIGINT[], $2::TEXT[]) WITH ORDINALITY AS asked (v1, v2, "
              "number) CROSS JOIN LATERAL (SELECT x FROM y WHERE z = asked.v1 AND (asked.v2 = '' OR asked.v1 > 0)) AS "
              "answer");
    ASSERT_EQ(questions.values().size(), 2U);
    EXPECT_EQ(questions.values()[0].text, "{7,NULL}");
    EXPECT_EQ(questions.values()[1].text, R"({"a \"b\" \\c,{}NULL",""})");
}

/// What is asked together is answered as if each had been asked alone.
class StoreQuestions : public StoreContract {
  protected:
    void SetUp() override {
        StoreContract::SetUp();
        if (IsSkipped() || HasFatalFailure()) {
            return;
        }
        std::string complaint;
        database_ = address_.connect(complaint);
        ASSERT_TRUE(database_) << complaint;
    }
    std::unique_ptr<Database> database_;
};
INSTANTIATE_TEST_SUITE_P(Sqlite, StoreQuestions, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreQuestions, ::testing::Values(true));

TEST_P(StoreQuestions, ValuesOfEveryKind_ComeBackAsTheyWere) {
    const std::vector<std::string> texts{"", "NULL", "null", R"("\,{}' $1)", "\\x00", "žluť 🐎", " a b ", "{}"};
    const std::vector<double> reals{0.0, -0.1, 1e300, 5e-324, 50.123456789012345};
    std::deque<Database::Run> runs;
    for (std::size_t i = 0; i < texts.size(); ++i) {
        runs.emplace_back("SELECT $1, $2, $3, $4", *database_)
            .bind(static_cast<std::int64_t>(i) - (std::int64_t{1} << 62))
            .bind(i % 2 == 0 ? std::optional(reals[i / 2]) : std::nullopt)
            .bind(std::string_view(texts[i]))
            .bindBytes(std::string("\0\xff\\\"", i % 5));
    }
    database_->fetch(runs);
    for (std::size_t i = 0; i < texts.size(); ++i, runs.pop_front()) {
        ASSERT_TRUE(runs.front().next()) << i << database_->complaint();
        EXPECT_EQ(runs.front().columns(), 4);
        EXPECT_EQ(runs.front().integer(0), static_cast<std::int64_t>(i) - (std::int64_t{1} << 62));
        EXPECT_EQ(runs.front().maybeReal(1), i % 2 == 0 ? std::optional(reals[i / 2]) : std::nullopt);
        EXPECT_EQ(runs.front().text(2), texts[i]);
        EXPECT_EQ(runs.front().text(3), std::string("\0\xff\\\"", i % 5));
        EXPECT_FALSE(runs.front().next());
    }
}

TEST_P(StoreQuestions, RowsOfEach_AreInItsOrder_AndStatementsMayBeMixed) {
    std::deque<Database::Run> runs;
    for (int i = 0; i < 60; ++i) {
        if (i % 3 == 0) {
            runs.emplace_back("SELECT name FROM person WHERE name <> $1 ORDER BY name DESC", *database_)
                .bind(std::string_view(i % 2 == 0 ? "ann" : "mara"));
        } else {
            runs.emplace_back("SELECT name FROM person WHERE id = $1", *database_)
                .bind(i % 3 == 1 ? ann_ : std::int64_t{0});
        }
    }
    database_->fetch(runs);
    for (int i = 0; i < 60; ++i, runs.pop_front()) {
        std::string names;
        while (runs.front().next()) {
            names += runs.front().text(0) + " ";
        }
        EXPECT_EQ(names, i % 3 != 0 ? (i % 3 == 1 ? "ann " : "") : i % 2 == 0 ? "otto mara " : "otto ann ") << i;
    }
    EXPECT_EQ(database_->complaint(), "");
}

TEST_P(StoreQuestions, WhatFails_FailsForAll_AndTheConnectionGoesOn) {
    std::deque<Database::Run> runs;
    for (int i = 0; i < 3; ++i) {
        runs.emplace_back("SELECT nothing FROM nowhere WHERE id = $1", *database_).bind(std::int64_t{i});
    }
    database_->fetch(runs);
    EXPECT_FALSE(runs.front().next());
    EXPECT_TRUE(database_->failed());
    database_->clear();
    auto row = database_->statement("SELECT 7");
    ASSERT_TRUE(row.next()) << database_->complaint();
    EXPECT_EQ(row.integer(0), 7);
}

/// What a server was asked, from what it writes down itself.
class StoreQuestionsOfALook : public StoreContract {};
INSTANTIATE_TEST_SUITE_P(Postgres, StoreQuestionsOfALook, ::testing::Values(true));

TEST_P(StoreQuestionsOfALook, AreAsManyForAHundredAsForFour) {
    constexpr int kFriends = 100;
    constexpr std::int64_t kLater = kNow + 3600;
    std::vector<std::string> handles;
    for (int i = 0; i < kFriends; ++i) {
        const std::string name = "p" + std::to_string(i);
        handles.push_back(name + "@x.example");
        ASSERT_TRUE(store_->addPerson(name, {handles.back()}, kNow));
        const std::int64_t person = store_->personNamed(name)->id;
        ASSERT_TRUE(store_->grant(person, otto_, {static_cast<Precision>(i % 4), kNow, std::nullopt}));
        ASSERT_TRUE(finished([&](auto done) {
            store_->keep(0, person, {{kNow + 60, kNow + 60, 50.0, 3.0, 9.0}, {kLater, kLater, 51.0, 3.0, 9.0}}, kLater,
                         done);
        }));
    }
    address_.text += "%20-clog_statement%3Dall";
    open();
    const auto questionsFor = [&](std::size_t count) {
        const std::size_t before = PrivatePostgres::shared()->log().size();
        const auto asked =
            store_->asked(otto_, {handles.begin(), handles.begin() + static_cast<std::ptrdiff_t>(count)}, kLater);
        EXPECT_TRUE(asked && asked->size() == count);
        for (const server::Asked& one : *asked) {
            EXPECT_FALSE(one.sharing.fixes.empty()) << one.person << wordOf(one.sharing.grant->precision);
        }
        const std::string log = PrivatePostgres::shared()->log().substr(before);
        int questions = 0;
        for (std::size_t at = log.find("LOG:  execute "); at != std::string::npos;
             at = log.find("LOG:  execute ", at + 1)) {
            ++questions;
        }
        return questions;
    };
    const int ofFew = questionsFor(4);
    EXPECT_GT(ofFew, 1) << "it writes them down";
    EXPECT_LE(ofFew, 6);
    EXPECT_EQ(questionsFor(kFriends), ofFew);
}

}  // namespace ktr::test
