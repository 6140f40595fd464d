#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

struct sqlite3;
struct sqlite3_stmt;

namespace ktr::server {

/// A connection to an SQLite database. Its statements are prepared once. Errors stay: after the first one, `failed` is
/// true and everything fails, until `clear`. One thread at a time.
class Database {
  public:
    /// One run of a statement. Values are bound in their order; columns are read by their index.
    class Run {
      public:
        explicit Run(sqlite3_stmt* statement, Database& database) : statement_(statement), database_(database) {}
        ~Run();
        Run(const Run&) = delete;
        Run& operator=(const Run&) = delete;

        Run& bind(std::int64_t value);
        Run& bind(double value);
        Run& bind(std::string_view text);
        Run& bindBytes(std::string_view bytes);
        Run& bind(const std::optional<std::int64_t>& value);
        Run& bind(const std::optional<double>& value);
        /// True for as long as there is a row.
        bool next();
        /// Runs it to its end; false when that failed.
        bool run();

        std::int64_t integer(int column) const;
        double real(int column) const;
        std::string text(int column) const;
        std::optional<std::int64_t> maybeInteger(int column) const;
        std::optional<double> maybeReal(int column) const;

      private:
        bool isNull(int column) const;

        sqlite3_stmt* statement_;
        Database& database_;
        int bound_ = 0;
    };

    /// Opens the file, and makes it (mode 0600) when it is missing. None, with the reason in `complaint`, when that
    /// fails.
    static std::unique_ptr<Database> open(const std::string& file, std::string& complaint);
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    /// `sql` is a text that does not change: it is known by its address afterwards.
    Run statement(const char* sql);
    /// Several statements without values; false when one failed.
    bool execute(const char* sql);
    /// Rows changed by the last statement.
    int changes() const;

    bool failed() const { return !complaint_.empty(); }
    const std::string& complaint() const { return complaint_; }
    void clear() { complaint_.clear(); }

  private:
    explicit Database(sqlite3* handle) : handle_(handle) {}
    void note();

    sqlite3* handle_;
    std::unordered_map<const char*, sqlite3_stmt*> statements_;
    std::string complaint_;
};

}  // namespace ktr::server
