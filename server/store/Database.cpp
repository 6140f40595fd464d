#include "server/store/Database.h"

#include <fcntl.h>
#include <sqlite3.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace ktr::server {

namespace {

/// How long another process that writes is waited for, milliseconds.
constexpr int kPatience = 5000;

}  // namespace

std::unique_ptr<Database> Database::open(const std::string& file, std::string& complaint) {
    // Made here, so that nobody else can read it from its first moment on.
    const int descriptor = ::open(file.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NONBLOCK, 0600);
    if (descriptor < 0) {
        complaint = file + ": " + std::strerror(errno);
        return nullptr;
    }
    ::close(descriptor);
    sqlite3* handle = nullptr;
    const int result = ::sqlite3_open_v2(file.c_str(), &handle, SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX, nullptr);
    std::unique_ptr<Database> database(new Database(handle));
    if (result != SQLITE_OK) {
        complaint = file + ": " + ::sqlite3_errstr(result);
        return nullptr;
    }
    ::sqlite3_busy_timeout(handle, kPatience);
    // An answer follows its commit, and the commit is on the disk. What is deleted is overwritten.
    if (!database->execute("PRAGMA journal_mode=WAL; PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON;"
                           "PRAGMA secure_delete=ON; PRAGMA journal_size_limit=67108864; PRAGMA trusted_schema=OFF;")) {
        complaint = file + ": " + database->complaint();
        return nullptr;
    }
    return database;
}

Database::~Database() {
    for (const auto& [sql, statement] : statements_) {
        ::sqlite3_finalize(statement);
    }
    ::sqlite3_close(handle_);
}

void Database::note() {
    if (complaint_.empty()) {
        complaint_ = ::sqlite3_errmsg(handle_);
    }
}

bool Database::execute(const char* sql) {
    if (::sqlite3_exec(handle_, sql, nullptr, nullptr, nullptr) != SQLITE_OK) {
        note();
    }
    return !failed();
}

int Database::changes() const {
    return ::sqlite3_changes(handle_);
}

Database::Run Database::statement(const char* sql) {
    sqlite3_stmt*& statement = statements_[sql];
    if (statement == nullptr &&
        ::sqlite3_prepare_v3(handle_, sql, -1, SQLITE_PREPARE_PERSISTENT, &statement, nullptr) != SQLITE_OK) {
        note();
    }
    return Run(statement, *this);
}

Database::Run::~Run() {
    if (statement_ != nullptr) {
        ::sqlite3_reset(statement_);
        ::sqlite3_clear_bindings(statement_);
    }
}

Database::Run& Database::Run::bind(std::int64_t value) {
    ::sqlite3_bind_int64(statement_, ++bound_, value);
    return *this;
}

Database::Run& Database::Run::bind(double value) {
    ::sqlite3_bind_double(statement_, ++bound_, value);
    return *this;
}

Database::Run& Database::Run::bind(std::string_view text) {
    ::sqlite3_bind_text(statement_, ++bound_, text.data(), static_cast<int>(text.size()), SQLITE_TRANSIENT);
    return *this;
}

Database::Run& Database::Run::bindBytes(std::string_view bytes) {
    ::sqlite3_bind_blob(statement_, ++bound_, bytes.data(), static_cast<int>(bytes.size()), SQLITE_TRANSIENT);
    return *this;
}

Database::Run& Database::Run::bind(const std::optional<std::int64_t>& value) {
    if (value) {
        return bind(*value);
    }
    ::sqlite3_bind_null(statement_, ++bound_);
    return *this;
}

Database::Run& Database::Run::bind(const std::optional<double>& value) {
    if (value) {
        return bind(*value);
    }
    ::sqlite3_bind_null(statement_, ++bound_);
    return *this;
}

bool Database::Run::next() {
    if (statement_ == nullptr || database_.failed()) {
        return false;
    }
    const int result = ::sqlite3_step(statement_);
    if (result != SQLITE_ROW && result != SQLITE_DONE) {
        database_.note();
    }
    return result == SQLITE_ROW;
}

bool Database::Run::run() {
    while (next()) {
    }
    return !database_.failed();
}

bool Database::Run::isNull(int column) const {
    return ::sqlite3_column_type(statement_, column) == SQLITE_NULL;
}

std::int64_t Database::Run::integer(int column) const {
    return ::sqlite3_column_int64(statement_, column);
}

double Database::Run::real(int column) const {
    return ::sqlite3_column_double(statement_, column);
}

std::string Database::Run::text(int column) const {
    const auto* bytes = static_cast<const char*>(::sqlite3_column_blob(statement_, column));
    const int size = ::sqlite3_column_bytes(statement_, column);
    return bytes == nullptr ? std::string() : std::string(bytes, static_cast<std::size_t>(size));
}

std::optional<std::int64_t> Database::Run::maybeInteger(int column) const {
    return isNull(column) ? std::nullopt : std::optional(integer(column));
}

std::optional<double> Database::Run::maybeReal(int column) const {
    return isNull(column) ? std::nullopt : std::optional(real(column));
}

}  // namespace ktr::server
