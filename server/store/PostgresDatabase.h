#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "server/store/Database.h"

struct pg_conn;
struct pg_result;

namespace ktr::server {

/// A connection to a PostgreSQL server (14 or later). In a transaction, statements are sent one after the other without
/// waiting for what the server says of them; what they did is known when a row is read, and at the commit. A lost
/// connection is made again by `refresh` and `begin`, at most once a second. One thread at a time.
class PostgresDatabase final : public Database {
  public:
    /// `address`: "postgresql://…", as the server's own tools take it. None, with the reason in `complaint`, when
    /// nobody answers there.
    static std::unique_ptr<PostgresDatabase> open(const std::string& address, std::string& complaint);
    ~PostgresDatabase() override;

    void fetch(std::deque<Run>& runs) override;
    bool execute(const std::string& sql) override;
    bool begin() override;
    bool beginReading() override;
    bool settle() override;
    bool commit() override;
    void rollback() override;
    int changes() override;
    void refresh() override;
    void announce(const Change& change, std::string_view sender) override;
    bool othersWrote() override { return false; }
    std::optional<int> schema() override;
    void setSchema(int number) override;
    void lockSchema() override;
    void scrub() override {}  // the server does that in its own time
    std::string check() override;

  protected:
    std::unique_ptr<Rows> query(const char* sql, const std::vector<DatabaseValue>& values) override;
    void perform(const char* sql, const std::vector<DatabaseValue>& values) override;
    std::string_view inDialect(std::string_view word) const override;

  private:
    class Table;
    class Parameters;
    struct Prepared {
        std::string name;
        bool isSent = false;
        bool isReady = false;
    };
    struct FreeResult {
        void operator()(pg_result* result) const;
    };
    using Result = std::unique_ptr<pg_result, FreeResult>;

    explicit PostgresDatabase(pg_conn* connection) : connection_(connection) {}
    bool start(const char* beginning);
    bool setUp();
    void connectAgain();
    bool isConnected() const;
    /// Whether it did what it was asked; else it notes what the server says.
    bool accept(const pg_result* result);
    Result finish(pg_result* result);
    Prepared& prepared(const char* sql);
    void send(const char* sql, const std::vector<DatabaseValue>& values);
    /// Reads what the server says of everything that was sent; the last one's result. `each` gets those of runs.
    using Each = std::function<void(Result)>;
    Result drain(const Each& each = nullptr);
    /// Leaves the state in which statements are sent without waiting.
    void endPipeline(const Each& each = nullptr);
    void fetchOnce(std::deque<Run>& runs);
    /// To each its rows of the answer to all of them.
    static void give(const std::vector<Run*>& runs, Result result);
    Result ask(const char* sql, const std::vector<DatabaseValue>& values);

    pg_conn* connection_;
    std::unordered_map<std::string, Prepared> statements_;
    std::deque<Prepared*> sent_;  ///< what the server has not answered: preparations, and none for a run
    bool inTransaction_ = false;
    bool inPipeline_ = false;
    int changes_ = 0;
    std::chrono::steady_clock::time_point lastAttempt_;
};

}  // namespace ktr::server
