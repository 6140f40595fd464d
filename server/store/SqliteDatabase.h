#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "server/store/Database.h"

struct sqlite3;
struct sqlite3_stmt;

namespace ktr::server {

/// A database in an SQLite file. Its statements are prepared once; a commit is on the disk; what is deleted is
/// overwritten. Other processes may use the file at the same time. One thread at a time.
class SqliteDatabase final : public Database {
  public:
    /// Opens the file, and makes it (mode 0600) when it is missing. None, with the reason in `complaint`, when that
    /// fails.
    static std::unique_ptr<SqliteDatabase> open(const std::string& file, std::string& complaint);
    /// All connections of this process with the same name have the same database, which is gone with the last of them.
    static std::unique_ptr<SqliteDatabase> openInMemory(const std::string& name, std::string& complaint);
    ~SqliteDatabase() override;

    void fetch(std::deque<Run>&) override {}
    bool execute(const std::string& sql) override;
    bool begin() override;
    bool beginReading() override;
    bool settle() override { return !failed(); };
    bool commit() override;
    void rollback() override;
    int changes() override;
    void announce(const Change&, std::string_view) override {}
    bool othersWrote() override;
    std::optional<int> schema() override;
    void setSchema(int number) override;
    void lockSchema() override {}  // a transaction that will write has the file for itself
    void scrub() override;
    std::string check() override;

  protected:
    std::unique_ptr<Rows> query(const char* sql, const std::vector<DatabaseValue>& values) override;
    void perform(const char* sql, const std::vector<DatabaseValue>& values) override;
    std::string_view inDialect(std::string_view word) const override;

  private:
    class Cursor;
    struct Prepared {
        sqlite3_stmt* statement = nullptr;
        /// Where "$1", "$2", … are: SQLite numbers them in the order in which they appear.
        std::vector<int> places;
    };

    explicit SqliteDatabase(sqlite3* handle) : handle_(handle) {}
    static std::unique_ptr<SqliteDatabase> connect(const std::string& file, std::string& complaint, const char* system);
    void noteError();
    Prepared* prepared(const char* sql);
    std::optional<std::int64_t> number(const char* sql);

    sqlite3* handle_;
    std::int64_t lastVersion_ = 0;
    std::unordered_map<std::string, Prepared> statements_;
};

}  // namespace ktr::server
