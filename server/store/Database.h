#pragma once

#include <cstdint>
#include <deque>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "server/store/Changes.h"
#include "server/store/DatabaseValue.h"

namespace ktr::server {

/// A connection to a database: SQLite or PostgreSQL. Errors stay: after the first one, `failed` is true and everything
/// fails, until `clear`. One thread at a time.
///
/// Statements are written once for both. Parameters are "$1", "$2", …, bound in that order. What the two call
/// differently stands in braces: {integer} {real} {text} {bytes} for types of columns, {no bytes} for none of
/// them, {strict} and {strict by key} at
/// the end of a table (the second: kept in the order of its primary key), {random bytes} for 16 of them, {shared lock}
/// at the end of a query that decides what a write in the same transaction may do. Beyond that: no reserved words of
/// either ("grant"), no scalar max(a, b), no booleans, a conflict target before DO UPDATE, WHERE before ON CONFLICT in
/// INSERT … SELECT.
class Database {
  public:
    /// Rows that a statement gives, and its values.
    class Rows {
      public:
        virtual ~Rows() = default;
        /// True for as long as there is a row.
        virtual bool next() = 0;
        virtual int columns() const = 0;
        virtual std::string nameOf(int column) const = 0;
        virtual DatabaseValue value(int column) const = 0;
    };

    /// One run of a statement. Values are bound in their order; columns are read by their index.
    class Run {
      public:
        Run(const char* sql, Database& database) : sql_(sql), database_(database) {}
        Run(const Run&) = delete;
        Run& operator=(const Run&) = delete;

        Run& bind(std::int64_t value);
        Run& bind(double value);
        /// Text is UTF-8 without zeros: anything else fails here, since one of the databases would refuse it.
        Run& bind(std::string_view text);
        Run& bindBytes(std::string_view bytes);
        Run& bind(const std::optional<std::int64_t>& value);
        Run& bind(const std::optional<double>& value);
        Run& bind(DatabaseValue value);
        /// True for as long as there is a row.
        bool next();
        /// Runs it to its end; false when that failed. In a transaction the failure may be known later only: with the
        /// next row that is read, `changes`, or `commit`.
        bool run();
        // For `fetch`.
        const char* sql() const { return sql_; }
        const std::vector<DatabaseValue>& values() const { return values_; }
        void give(std::unique_ptr<Rows> rows) { rows_ = std::move(rows); }

        std::int64_t integer(int column) const { return value(column).integer; }
        double real(int column) const { return value(column).real; }
        std::string text(int column) const { return value(column).text; }
        std::optional<std::int64_t> maybeInteger(int column) const;
        std::optional<double> maybeReal(int column) const;
        DatabaseValue value(int column) const { return rows_->value(column); }
        int columns() const { return rows_->columns(); }
        std::string nameOf(int column) const { return rows_->nameOf(column); }

      private:
        const char* sql_;
        Database& database_;
        std::vector<DatabaseValue> values_;
        std::unique_ptr<Rows> rows_;
    };

    virtual ~Database() = default;
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    /// `sql` outlives the run.
    Run statement(const char* sql) { return Run(sql, *this); }
    /// Before several statements that only read are read one after the other, each to its end or destroyed before the
    /// next: a server is asked all of them at once, and answers at once. Where nothing is far away nothing happens.
    virtual void fetch(std::deque<Run>& runs) = 0;
    /// Several statements without values; false when one failed.
    virtual bool execute(const std::string& sql) = 0;

    /// Begins a transaction that will write. False: nothing can be written now, and no transaction is open.
    virtual bool begin() = 0;
    /// Begins a transaction that only reads, as everything is at this moment; `rollback` ends it. False: nothing can be
    /// read now, and no transaction is open.
    virtual bool beginReading() = 0;
    /// Waits until it is known what all statements did; false when one failed.
    virtual bool settle() = 0;
    /// False: nothing of the transaction was kept, unless the connection broke in that very moment. `rollback` follows.
    virtual bool commit() = 0;
    /// Also ends a failed transaction, and clears what failed.
    virtual void rollback() = 0;
    /// Rows changed by the last statement.
    virtual int changes() = 0;
    /// Before a read: clears what failed, and connects again where that is needed.
    virtual void refresh() { clear(); }

    /// Tells other processes that use the same database, with the commit of the transaction, or at once when there is
    /// none; does nothing where they find out by `othersWrote`.
    virtual void announce(const Change& change, std::string_view sender) = 0;
    /// Whether somebody wrote by another connection since this was asked last; false where they announce it.
    virtual bool othersWrote() = 0;

    /// The number of the last migration; 0 in an empty database; none, with a complaint, when it holds something else.
    virtual std::optional<int> schema() = 0;
    virtual void setSchema(int number) = 0;
    /// In a transaction: lets no other process migrate at the same time.
    virtual void lockSchema() = 0;
    /// Outside of a transaction: what was deleted leaves the files, as far as that is in the connection's hands.
    virtual void scrub() = 0;
    /// Whether what is kept is whole and safe: empty, or what is wrong with it.
    virtual std::string check() = 0;

    bool failed() const { return !complaint_.empty(); }
    const std::string& complaint() const { return complaint_; }
    void clear() { complaint_.clear(); }
    /// The first failure stays.
    void note(std::string complaint);

  protected:
    Database() = default;
    virtual std::unique_ptr<Rows> query(const char* sql, const std::vector<DatabaseValue>& values) = 0;
    virtual void perform(const char* sql, const std::vector<DatabaseValue>& values) = 0;
    /// What stands for a word in braces; empty for an unknown one.
    virtual std::string_view inDialect(std::string_view word) const = 0;
    /// With all words in braces replaced.
    std::string translated(std::string_view sql) const;

  private:
    std::string complaint_;
};

}  // namespace ktr::server
