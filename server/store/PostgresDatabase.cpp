#include "server/store/PostgresDatabase.h"

#include <libpq-fe.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdlib>

#include "server/store/PostgresHearing.h"
#include "server/store/PostgresParameters.h"
#include "server/store/PostgresQuestions.h"

namespace ktr::server {

using Type = DatabaseValue::Type;

namespace {

/// Types as the server numbers them (its catalogue's pg_type).
constexpr Oid kBytes = 17;
constexpr Oid kInteger8 = 20;
constexpr Oid kInteger2 = 21;
constexpr Oid kInteger4 = 23;
constexpr Oid kText = 25;
constexpr Oid kReal4 = 700;
constexpr Oid kReal8 = 701;

/// So many statements are on their way before what the server says of them is read: neither side's buffer fills.
constexpr std::size_t kMostSent = 64;
constexpr std::chrono::seconds kBetweenAttempts{1};
/// Told from other databases by it, and a lock of its own for migrations.
constexpr const char* kMark = "ktr_store";
constexpr const char* kLock = "SELECT pg_advisory_xact_lock(1803842163)";

Oid typeOf(Type type) {
    return type == Type::Integer ? kInteger8 : type == Type::Real ? kReal8 : type == Type::Text ? kText : kBytes;
}

int digitOf(char letter) {
    return letter <= '9' ? letter - '0' : letter - 'a' + 10;
}

/// Bytes as the server writes them: "\x" and hexadecimal digits.
std::string bytesOf(std::string_view text) {
    std::string bytes;
    for (std::size_t at = 2; at + 1 < text.size(); at += 2) {
        bytes += static_cast<char>(digitOf(text[at]) * 16 + digitOf(text[at + 1]));
    }
    return bytes;
}

}  // namespace

/// Rows of a result that has arrived as a whole: all of them, or those that answer one of several questions.
class PostgresDatabase::Table final : public Database::Rows {
  public:
    explicit Table(Result result) : Table(std::move(result), {}, 0) { last_ = ::PQntuples(result_.get()); }
    /// `rows`: their numbers; what is before `first` is no column of theirs.
    Table(std::shared_ptr<pg_result> result, std::vector<int> rows, int first)
        : result_(std::move(result)), rows_(std::move(rows)), first_(first), last_(static_cast<int>(rows_.size())) {}

    bool next() override { return ++row_ < last_; }
    int columns() const override { return ::PQnfields(result_.get()) - first_; }
    std::string nameOf(int column) const override { return ::PQfname(result_.get(), first_ + column); }
    DatabaseValue value(int column) const override {
        const int row = rows_.empty() ? row_ : rows_[static_cast<std::size_t>(row_)];
        return valueOf(result_.get(), row, first_ + column);
    }
    static DatabaseValue valueOf(const pg_result* result, int row, int column);

  private:
    std::shared_ptr<pg_result> result_;
    std::vector<int> rows_;  ///< none: all
    int first_;
    int last_;
    int row_ = -1;
};

DatabaseValue PostgresDatabase::Table::valueOf(const pg_result* result, int row, int column) {
    const std::string_view text(::PQgetvalue(result, row, column),
                                static_cast<std::size_t>(::PQgetlength(result, row, column)));
    DatabaseValue value = DatabaseValue::none(Type::Text);
    switch (::PQftype(result, column)) {
        case kInteger2:
        case kInteger4:
        case kInteger8:
            value.type = Type::Integer;
            std::from_chars(text.data(), text.data() + text.size(), value.integer);
            break;
        case kReal4:
        case kReal8:
            value.type = Type::Real;
            // Written by the server with as many digits as it takes, in the "C" locale's way. It ends with a zero.
            std::from_chars(text.data(), text.data() + text.size(), value.real);
            break;
        case kBytes:
            value.type = Type::Bytes;
            value.text = bytesOf(text);
            break;
        default:
            value.text = text;
            break;
    }
    value.isNone = ::PQgetisnull(result, row, column) != 0;
    return value;
}

/// Values as the library wants them: numbers as text, text and bytes as they are.
class PostgresDatabase::Parameters {
  public:
    explicit Parameters(const std::vector<DatabaseValue>& values) : numbers(values.size()) {
        for (std::size_t i = 0; i < values.size(); ++i) {
            const DatabaseValue& value = values[i];
            const bool isNumber = value.type == Type::Integer || value.type == Type::Real;
            std::array<char, 32>& digits = numbers[i];
            if (isNumber && !value.isNone) {
                char* const last = digits.data() + digits.size() - 1;
                *(value.type == Type::Integer ? std::to_chars(digits.data(), last, value.integer).ptr
                                              : std::to_chars(digits.data(), last, value.real).ptr) = '\0';
            }
            types.push_back(typeOf(value.type));
            data.push_back(value.isNone ? nullptr : isNumber ? digits.data() : value.text.c_str());
            lengths.push_back(static_cast<int>(value.text.size()));
            forms.push_back(isNumber ? 0 : 1);
        }
    }
    int count() const { return static_cast<int>(data.size()); }

    std::vector<std::array<char, 32>> numbers;
    std::vector<Oid> types;
    std::vector<const char*> data;
    std::vector<int> lengths;
    std::vector<int> forms;
};

void PostgresDatabase::FreeResult::operator()(pg_result* result) const {
    ::PQclear(result);
}

std::unique_ptr<PostgresDatabase> PostgresDatabase::open(const std::string& address, std::string& complaint) {
    const PostgresParameters parameters(address);
    std::unique_ptr<PostgresDatabase> database(
        new PostgresDatabase(::PQconnectdbParams(parameters.names.data(), parameters.values.data(), 1)));
    if (!database->isConnected() || !database->setUp()) {
        complaint = database->failed() ? database->complaint() : ::PQerrorMessage(database->connection_);
        while (!complaint.empty() && complaint.back() == '\n') {
            complaint.pop_back();
        }
        return nullptr;
    }
    return database;
}

PostgresDatabase::~PostgresDatabase() {
    ::PQfinish(connection_);
}

bool PostgresDatabase::isConnected() const {
    return ::PQstatus(connection_) == CONNECTION_OK;
}

bool PostgresDatabase::setUp() {
    ::PQsetNoticeProcessor(
        connection_, [](void*, const char*) {}, nullptr);
    // An answer follows its commit, and the commit is on the server's disk, whatever the server's own settings say.
    return execute(
        "SET client_encoding TO 'UTF8'; SET statement_timeout TO '30s'; SET lock_timeout TO '10s';"
        "SET idle_in_transaction_session_timeout TO '60s';"
        // Every question here is short: compiling one takes longer than it does.
        // Of somebody's many fixes the last one is wanted: an index gives it at once, and a bitmap all of them to be
        // sorted.
        "SET jit TO off; SET enable_bitmapscan TO off;"
        "SELECT set_config('synchronous_commit', 'on', false) "
        "WHERE current_setting('synchronous_commit') IN ('off', 'local')");
}

void PostgresDatabase::connectAgain() {
    const auto now = std::chrono::steady_clock::now();
    if (now - lastAttempt_ < kBetweenAttempts) {
        return note("the connection to the database is lost");
    }
    lastAttempt_ = now;
    inTransaction_ = inPipeline_ = false;
    statements_.clear();
    sent_.clear();
    ::PQreset(connection_);
    if (!isConnected()) {
        return note(::PQerrorMessage(connection_));
    }
    setUp();
}

void PostgresDatabase::refresh() {
    clear();
    if (!isConnected()) {
        connectAgain();
    }
}

std::string_view PostgresDatabase::inDialect(std::string_view word) const {
    if (word == "integer" || word == "real" || word == "text") {
        // Names in the order of their bytes, as the other database has them.
        return word == "integer" ? "BIGINT" : word == "real" ? "DOUBLE PRECISION" : "TEXT COLLATE \"C\"";
    }
    return word == "bytes"          ? "BYTEA"
           : word == "shared lock"  ? "FOR SHARE"
           : word == "no bytes"     ? "''"
           : word == "random bytes" ? "uuid_send(gen_random_uuid())"
                                    : "";
}

bool PostgresDatabase::accept(const pg_result* result) {
    const ExecStatusType status = ::PQresultStatus(result);
    const bool isGood = status == PGRES_COMMAND_OK || status == PGRES_TUPLES_OK || status == PGRES_PIPELINE_SYNC;
    if (!isGood) {
        note(result == nullptr ? ::PQerrorMessage(connection_) : ::PQresultErrorMessage(result));
    }
    return isGood;
}

PostgresDatabase::Result PostgresDatabase::finish(pg_result* result) {
    Result kept(result);
    if (accept(result)) {
        changes_ = std::atoi(::PQcmdTuples(result));
    }
    return kept;
}

PostgresDatabase::Prepared& PostgresDatabase::prepared(const char* sql) {
    Prepared& entry = statements_[sql];
    if (entry.name.empty()) {
        entry.name = "s" + std::to_string(statements_.size());
    }
    return entry;
}

PostgresDatabase::Result PostgresDatabase::ask(const char* sql, const std::vector<DatabaseValue>& values) {
    Prepared& entry = prepared(sql);
    const Parameters parameters(values);
    if (!entry.isReady) {
        const Result made(::PQprepare(connection_, entry.name.c_str(), translated(sql).c_str(), parameters.count(),
                                      parameters.types.data()));
        if (!accept(made.get())) {
            return nullptr;
        }
        entry.isReady = entry.isSent = true;
    }
    return finish(::PQexecPrepared(connection_, entry.name.c_str(), parameters.count(), parameters.data.data(),
                                   parameters.lengths.data(), parameters.forms.data(), 0));
}

void PostgresDatabase::send(const char* sql, const std::vector<DatabaseValue>& values) {
    if (!inPipeline_ && ::PQenterPipelineMode(connection_) != 1) {
        return note(::PQerrorMessage(connection_));
    }
    inPipeline_ = true;
    Prepared& entry = prepared(sql);
    const Parameters parameters(values);
    if (!entry.isSent) {
        if (::PQsendPrepare(connection_, entry.name.c_str(), translated(sql).c_str(), parameters.count(),
                            parameters.types.data()) != 1) {
            return note(::PQerrorMessage(connection_));
        }
        entry.isSent = true;
        sent_.push_back(&entry);
    }
    if (::PQsendQueryPrepared(connection_, entry.name.c_str(), parameters.count(), parameters.data.data(),
                              parameters.lengths.data(), parameters.forms.data(), 0) != 1) {
        return note(::PQerrorMessage(connection_));
    }
    sent_.push_back(nullptr);
}

PostgresDatabase::Result PostgresDatabase::drain(const Each& each) {
    Result last;
    if (!sent_.empty()) {
        ::PQsendFlushRequest(connection_);
        ::PQflush(connection_);
    }
    while (!sent_.empty()) {
        Prepared* const preparing = sent_.front();
        sent_.pop_front();
        last = finish(::PQgetResult(connection_));
        const bool isGood = ::PQresultStatus(last.get()) == PGRES_COMMAND_OK;
        if (preparing != nullptr) {
            preparing->isReady = preparing->isSent = isGood;
        }
        if (!last) {
            sent_.clear();  // the connection is lost
            break;
        }
        const Result none(::PQgetResult(connection_));
        if (preparing == nullptr && each) {
            each(std::move(last));
        }
    }
    return last;
}

void PostgresDatabase::endPipeline(const Each& each) {
    if (!inPipeline_) {
        return;
    }
    inPipeline_ = false;
    const bool isSynced = ::PQpipelineSync(connection_) == 1;
    drain(each);
    if (isSynced && isConnected()) {
        finish(::PQgetResult(connection_));
    }
    if (::PQexitPipelineMode(connection_) != 1) {
        note(::PQerrorMessage(connection_));
    }
}

std::unique_ptr<Database::Rows> PostgresDatabase::query(const char* sql, const std::vector<DatabaseValue>& values) {
    Result result;
    if (inTransaction_) {
        send(sql, values);
        result = drain();
    } else {
        result = ask(sql, values);
        if (failed() && !isConnected()) {
            // The server was started again, or closed what was idle: a question can be asked twice.
            refresh();
            result = failed() ? nullptr : ask(sql, values);
        }
    }
    return result && !failed() ? std::make_unique<Table>(std::move(result)) : nullptr;
}

void PostgresDatabase::give(const std::vector<Run*>& runs, Result result) {
    const std::shared_ptr<pg_result> shared(std::move(result));
    std::vector<std::vector<int>> rows(runs.size());
    for (int row = 0; row < ::PQntuples(shared.get()); ++row) {
        rows[static_cast<std::size_t>(Table::valueOf(shared.get(), row, 0).integer) - 1].push_back(row);
    }
    for (std::size_t i = 0; i < runs.size(); ++i) {
        runs[i]->give(std::make_unique<Table>(shared, std::move(rows[i]), 1));
    }
}

void PostgresDatabase::fetchOnce(std::deque<Run>& runs) {
    std::vector<std::vector<Run*>> alike;
    for (Run& run : runs) {
        const auto same = std::find_if(alike.begin(), alike.end(), [&](const std::vector<Run*>& some) {
            return std::string_view(some.front()->sql()) == run.sql();
        });
        (same == alike.end() ? alike.emplace_back() : *same).push_back(&run);
    }
    for (const std::vector<Run*>& some : alike) {
        std::vector<const std::vector<DatabaseValue>*> values;
        for (const Run* run : some) {
            values.push_back(&run->values());
        }
        const PostgresQuestions questions(some.front()->sql(), values);
        send(questions.sql().c_str(), questions.values());
    }
    auto next = alike.begin();
    const Each each = [&](Result result) { give(*next++, std::move(result)); };
    if (inTransaction_) {
        drain(each);
    } else {
        endPipeline(each);
    }
}

void PostgresDatabase::fetch(std::deque<Run>& runs) {
    if (failed() || runs.empty()) {
        return;
    }
    fetchOnce(runs);
    if (failed() && !isConnected() && !inTransaction_) {
        // As of a single one: a question can be asked twice.
        refresh();
        if (!failed()) {
            fetchOnce(runs);
        }
    }
}

void PostgresDatabase::perform(const char* sql, const std::vector<DatabaseValue>& values) {
    if (!inTransaction_) {
        ask(sql, values);
        return;
    }
    send(sql, values);
    if (sent_.size() >= kMostSent) {
        drain();
    }
}

bool PostgresDatabase::execute(const std::string& sql) {
    endPipeline();
    if (!failed()) {
        finish(::PQexec(connection_, translated(sql).c_str()));
    }
    return !failed();
}

bool PostgresDatabase::start(const char* beginning) {
    refresh();
    if (!failed() && !execute(beginning) && !isConnected()) {
        refresh();
        if (!failed()) {
            execute(beginning);
        }
    }
    inTransaction_ = !failed();
    return inTransaction_;
}

bool PostgresDatabase::begin() {
    return start("BEGIN");
}

bool PostgresDatabase::beginReading() {
    return start("BEGIN ISOLATION LEVEL REPEATABLE READ READ ONLY");
}

bool PostgresDatabase::settle() {
    endPipeline();
    return !failed();
}

bool PostgresDatabase::commit() {
    if (!settle()) {
        return false;
    }
    const Result result = finish(::PQexec(connection_, "COMMIT"));
    inTransaction_ = false;
    return !failed() && std::string_view(::PQcmdStatus(result.get())) == "COMMIT";
}

void PostgresDatabase::rollback() {
    endPipeline();
    clear();
    inTransaction_ = false;
    if (isConnected() && ::PQtransactionStatus(connection_) != PQTRANS_IDLE) {
        execute("ROLLBACK");
    }
    clear();
}

int PostgresDatabase::changes() {
    drain();
    return changes_;
}

void PostgresDatabase::announce(const Change& change, std::string_view sender) {
    static_assert(std::string_view(PostgresHearing::kChannel) == "ktr_changes");
    for (const std::string& line : change.lines(sender, PostgresHearing::kLongestLine)) {
        statement("SELECT pg_notify('ktr_changes', $1)").bind(std::string_view(line)).run();
    }
}

std::optional<int> PostgresDatabase::schema() {
    {
        auto row = statement(
            "SELECT to_regclass('ktr_store') IS NOT NULL, "
            "(SELECT count(*) FROM pg_tables WHERE schemaname = current_schema())");
        if (!row.next()) {
            return std::nullopt;
        }
        if (row.text(0) != "t") {
            if (row.integer(1) == 0) {
                return 0;
            }
            note("is no store of this service: it has tables of something else");
            return std::nullopt;
        }
    }
    auto row = statement("SELECT version FROM ktr_store");
    return row.next() ? std::optional(static_cast<int>(row.integer(0))) : std::nullopt;
}

void PostgresDatabase::setSchema(int number) {
    const std::string mark = kMark;
    execute("CREATE TABLE IF NOT EXISTS " + mark + " (version BIGINT NOT NULL); DELETE FROM " + mark +
            "; INSERT INTO " + mark + " VALUES (" + std::to_string(number) + ")");
}

void PostgresDatabase::lockSchema() {
    execute(kLock);
}

std::string PostgresDatabase::check() {
    auto row = statement("SELECT current_setting('fsync'), current_setting('full_page_writes')");
    if (row.next() && (row.text(0) != "on" || row.text(1) != "on")) {
        return "the server is told to write nothing through to its disk (fsync, full_page_writes)";
    }
    return complaint();
}

}  // namespace ktr::server
