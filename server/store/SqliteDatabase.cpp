#include "server/store/SqliteDatabase.h"

#include <fcntl.h>
#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <utility>

namespace ktr::server {

using Type = DatabaseValue::Type;

namespace {

/// How long another process that writes is waited for, milliseconds.
constexpr int kPatience = 5000;
/// Told by SQLite's `file` magic: this store and no other database.
constexpr std::int64_t kApplication = 0x6b747273;

/// Made here, so that nobody else can read it from its first moment on. What is there already is not opened: to close
/// any descriptor of a file gives up all locks that this process has on it, those of another connection as well.
/// Another process would then take itself for the last one, and delete the log into which this one goes on writing.
/// Empty when the file is there.
std::string makeFile(const std::string& file) {
    const int descriptor = ::open(file.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    if (descriptor >= 0) {
        ::close(descriptor);
        return "";
    }
    if (errno != EEXIST) {
        return std::strerror(errno);
    }
    struct stat facts {};
    return ::stat(file.c_str(), &facts) == 0 && S_ISREG(facts.st_mode) ? "" : "is not a file";
}

/// What a column without a value would have, by the word in its table.
Type declaredType(const char* word) {
    const std::string_view type = word == nullptr ? std::string_view() : std::string_view(word);
    return type == "REAL" ? Type::Real : type == "TEXT" ? Type::Text : type == "BLOB" ? Type::Bytes : Type::Integer;
}

void bindValue(sqlite3_stmt* statement, int place, const DatabaseValue& value) {
    if (place == 0 || value.isNone) {
        return;  // a parameter without a value is none
    }
    // Whoever runs it keeps the values until its end.
    const int size = static_cast<int>(value.text.size());
    switch (value.type) {
        case Type::Integer:
            ::sqlite3_bind_int64(statement, place, value.integer);
            break;
        case Type::Real:
            ::sqlite3_bind_double(statement, place, value.real);
            break;
        case Type::Text:
            ::sqlite3_bind_text(statement, place, value.text.data(), size, SQLITE_STATIC);
            break;
        case Type::Bytes:
            ::sqlite3_bind_blob(statement, place, value.text.data(), size, SQLITE_STATIC);
            break;
    }
}

}  // namespace

/// The statement as it steps.
class SqliteDatabase::Cursor final : public Database::Rows {
  public:
    Cursor(sqlite3_stmt* statement, SqliteDatabase& database) : statement_(statement), database_(database) {}
    ~Cursor() override {
        ::sqlite3_reset(statement_);
        ::sqlite3_clear_bindings(statement_);
    }
    Cursor(const Cursor&) = delete;
    Cursor& operator=(const Cursor&) = delete;

    bool next() override {
        if (isOver_) {
            return false;
        }
        const int result = ::sqlite3_step(statement_);
        if (result != SQLITE_ROW && result != SQLITE_DONE) {
            database_.noteError();
        }
        isOver_ = result != SQLITE_ROW;
        return !isOver_;
    }
    int columns() const override { return ::sqlite3_column_count(statement_); }
    std::string nameOf(int column) const override { return ::sqlite3_column_name(statement_, column); }
    DatabaseValue value(int column) const override {
        const auto bytes = [&] {
            const auto* begin = static_cast<const char*>(::sqlite3_column_blob(statement_, column));
            const auto size = static_cast<std::size_t>(::sqlite3_column_bytes(statement_, column));
            return begin == nullptr ? std::string() : std::string(begin, size);
        };
        switch (::sqlite3_column_type(statement_, column)) {
            case SQLITE_INTEGER:
                return DatabaseValue::of(std::int64_t{::sqlite3_column_int64(statement_, column)});
            case SQLITE_FLOAT:
                return DatabaseValue::of(::sqlite3_column_double(statement_, column));
            case SQLITE_TEXT:
                return DatabaseValue::of(Type::Text, bytes());
            case SQLITE_BLOB:
                return DatabaseValue::of(Type::Bytes, bytes());
            default:
                return DatabaseValue::none(declaredType(::sqlite3_column_decltype(statement_, column)));
        }
    }

  private:
    sqlite3_stmt* statement_;
    SqliteDatabase& database_;
    bool isOver_ = false;
};

std::unique_ptr<SqliteDatabase> SqliteDatabase::open(const std::string& file, std::string& complaint) {
    complaint = makeFile(file);
    return complaint.empty() ? connect(file, complaint, nullptr) : nullptr;
}

std::unique_ptr<SqliteDatabase> SqliteDatabase::openInMemory(const std::string& name, std::string& complaint) {
    // The slash makes it one for all connections.
    return connect("/" + name, complaint, "memdb");
}

std::unique_ptr<SqliteDatabase> SqliteDatabase::connect(const std::string& file, std::string& complaint,
                                                        const char* system) {
    sqlite3* handle = nullptr;
    const int result = ::sqlite3_open_v2(file.c_str(), &handle, SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX, system);
    std::unique_ptr<SqliteDatabase> database(new SqliteDatabase(handle));
    if (result != SQLITE_OK) {
        complaint = ::sqlite3_errstr(result);
        return nullptr;
    }
    ::sqlite3_busy_timeout(handle, kPatience);
    // An answer follows its commit, and the commit is on the disk. What is deleted is overwritten.
    if (!database->execute("PRAGMA journal_mode=WAL; PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON;"
                           "PRAGMA secure_delete=ON; PRAGMA journal_size_limit=67108864; PRAGMA trusted_schema=OFF;")) {
        complaint = database->complaint();
        return nullptr;
    }
    return database;
}

SqliteDatabase::~SqliteDatabase() {
    for (const auto& [sql, prepared] : statements_) {
        ::sqlite3_finalize(prepared.statement);
    }
    ::sqlite3_close(handle_);
}

void SqliteDatabase::noteError() {
    note(::sqlite3_errmsg(handle_));
}

std::string_view SqliteDatabase::inDialect(std::string_view word) const {
    if (word == "integer" || word == "real" || word == "text") {
        return word == "integer" ? "INTEGER" : word == "real" ? "REAL" : "TEXT";
    }
    return word == "bytes"           ? "BLOB"
           : word == "strict"        ? "STRICT"
           : word == "strict by key" ? "STRICT, WITHOUT ROWID"
           : word == "no bytes"      ? "x''"
           : word == "random bytes"  ? "randomblob(16)"
                                     : "";
}

SqliteDatabase::Prepared* SqliteDatabase::prepared(const char* sql) {
    Prepared& entry = statements_[sql];
    if (entry.statement != nullptr) {
        return &entry;
    }
    const std::string text = translated(sql);
    if (::sqlite3_prepare_v3(handle_, text.c_str(), -1, SQLITE_PREPARE_PERSISTENT, &entry.statement, nullptr) !=
        SQLITE_OK) {
        noteError();
        return nullptr;
    }
    for (int number = 1; number <= ::sqlite3_bind_parameter_count(entry.statement); ++number) {
        const std::string name = "$" + std::to_string(number);
        entry.places.push_back(::sqlite3_bind_parameter_index(entry.statement, name.c_str()));
    }
    return &entry;
}

std::unique_ptr<Database::Rows> SqliteDatabase::query(const char* sql, const std::vector<DatabaseValue>& values) {
    const Prepared* entry = prepared(sql);
    if (entry == nullptr) {
        return nullptr;
    }
    for (std::size_t i = 0; i < values.size() && i < entry->places.size(); ++i) {
        bindValue(entry->statement, entry->places[i], values[i]);
    }
    return std::make_unique<Cursor>(entry->statement, *this);
}

void SqliteDatabase::perform(const char* sql, const std::vector<DatabaseValue>& values) {
    if (const auto rows = query(sql, values)) {
        while (rows->next()) {
        }
    }
}

bool SqliteDatabase::execute(const std::string& sql) {
    if (!failed() && ::sqlite3_exec(handle_, translated(sql).c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) {
        noteError();
    }
    return !failed();
}

bool SqliteDatabase::begin() {
    return execute("BEGIN IMMEDIATE");
}

bool SqliteDatabase::beginReading() {
    return execute("BEGIN");
}

bool SqliteDatabase::commit() {
    return execute("COMMIT");
}

void SqliteDatabase::rollback() {
    clear();
    // Some failures have ended it already.
    if (::sqlite3_get_autocommit(handle_) == 0) {
        execute("ROLLBACK");
    }
    clear();
}

int SqliteDatabase::changes() {
    return ::sqlite3_changes(handle_);
}

std::optional<std::int64_t> SqliteDatabase::number(const char* sql) {
    auto row = statement(sql);
    return row.next() ? row.maybeInteger(0) : std::nullopt;
}

bool SqliteDatabase::othersWrote() {
    // Changes with what other connections write, and never with what this one does.
    const std::int64_t version = number("PRAGMA data_version").value_or(lastVersion_);
    return std::exchange(lastVersion_, version) != version;
}

std::optional<int> SqliteDatabase::schema() {
    const auto version = number("PRAGMA user_version");
    const auto application = number("PRAGMA application_id");
    const auto tables = number("SELECT count(*) FROM sqlite_schema");
    if (!version || !application || !tables) {
        return std::nullopt;
    }
    if (*version == 0 && *application == 0 && *tables == 0) {
        return 0;
    }
    if (*application != kApplication) {
        note("is no store of this service");
        return std::nullopt;
    }
    return static_cast<int>(*version);
}

void SqliteDatabase::setSchema(int number) {
    execute("PRAGMA application_id = " + std::to_string(kApplication) +
            "; PRAGMA user_version = " + std::to_string(number));
}

void SqliteDatabase::scrub() {
    // The log in front of the file still has pages as they were.
    execute("PRAGMA wal_checkpoint(TRUNCATE)");
}

std::string SqliteDatabase::check() {
    for (const char* question : {"PRAGMA integrity_check", "PRAGMA foreign_key_check"}) {
        auto row = statement(question);
        if (row.next() && row.text(0) != "ok") {
            return row.text(0);
        }
    }
    return complaint();
}

}  // namespace ktr::server
