#include "tiles/SqliteMbtiles.h"

#include <sqlite3.h>

#include <array>
#include <chrono>
#include <cstddef>
#include <filesystem>
#include <string_view>
#include <system_error>
#include <utility>

#include "documents/ComputingTime.h"

namespace ktr::tiles {

namespace {

/// Milliseconds to wait for somebody who writes.
constexpr int kBusyWait = 250;
/// Time for one question, computed (a look-up takes a millisecond, a file without an index a few hundred) and by the
/// clock (a disk may have to wake up). A single step may copy or compare megabytes, so that their number says little.
constexpr std::chrono::seconds kMostComputing(1);
constexpr std::chrono::seconds kMostTime(10);
constexpr int kStepsBetweenLooks = 16;
/// What one question may add to SQLite's memory; bytes.
constexpr sqlite3_int64 kMostMemory = 48LL << 20;
constexpr std::size_t kMostMetadataRows = 256;
constexpr int kLongestMetadata = 1 << 20;

struct CloseDatabase {
    void operator()(sqlite3* database) const { sqlite3_close_v2(database); }
};
struct FinalizeStatement {
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using Database = std::unique_ptr<sqlite3, CloseDatabase>;
using Statement = std::unique_ptr<sqlite3_stmt, FinalizeStatement>;

/// Only reading of tables and views is allowed: no functions, no recursion, no attaching, no pragmas.
int authorize(void* /*unused*/, int action, const char* /*first*/, const char* /*second*/, const char* /*database*/,
              const char* /*view*/) {
    return action == SQLITE_SELECT || action == SQLITE_READ ? SQLITE_OK : SQLITE_DENY;
}

/// What a question has used so far.
struct Budget {
    std::chrono::nanoseconds computed{};
    std::chrono::steady_clock::time_point begun;
    sqlite3_int64 memory = 0;
    /// A question was given up: whoever wrote the file knows more of that kind. It is asked nothing any more.
    bool isExceeded = false;

    static int look(void* self) {
        auto* budget = static_cast<Budget*>(self);
        budget->isExceeded = budget->isExceeded || documents::computingTime() - budget->computed > kMostComputing ||
                             std::chrono::steady_clock::now() - budget->begun > kMostTime ||
                             sqlite3_memory_used() - budget->memory > kMostMemory;
        return budget->isExceeded ? 1 : 0;
    }
    /// False when there is nothing left to begin with.
    bool begin() {
        computed = documents::computingTime();
        begun = std::chrono::steady_clock::now();
        memory = sqlite3_memory_used();
        return !isExceeded;
    }
};

/// Why a database is not opened; empty when it may be. A pipe would be waited for, also in the place of one of the
/// files that the library looks for beside the database, wherever a link to it leads.
std::string objection(const std::string& path) {
    std::error_code failed;
    const std::filesystem::path file = std::filesystem::canonical(path, failed);
    if (failed) {
        return failed.message();
    }
    if (!std::filesystem::is_regular_file(file, failed)) {
        return failed ? failed.message() : "not a file";
    }
    for (const char* end : {"-journal", "-wal", "-shm"}) {
        const std::string beside = file.string() + end;
        if (std::filesystem::exists(beside, failed) && !std::filesystem::is_regular_file(beside, failed)) {
            return "not a file: " + beside;
        }
    }
    return "";
}

class OpenMbtiles final : public MbtilesFile {
  public:
    /// False, with a reason in `error`.
    bool open(const std::string& path, std::string& error);

    const std::map<std::string, std::string>& metadata() const override { return metadata_; }
    std::optional<int> finestLevel() override { return levelBy("DESC"); }
    std::optional<int> coarsestLevel() override { return levelBy("ASC"); }
    std::optional<platform::Bytes> tile(const TileKey& key) override;

  private:
    bool connect(const std::string& name, int flags, std::string& error);
    void harden();
    Statement prepare(const std::string& query);
    std::optional<int> levelBy(const std::string& order);
    bool readMetadata();

    Budget budget_;
    Database database_;
    Statement tile_;
    std::map<std::string, std::string> metadata_;
};

void OpenMbtiles::harden() {
    sqlite3* database = database_.get();
    sqlite3_busy_timeout(database, kBusyWait);
    sqlite3_extended_result_codes(database, 1);
    sqlite3_db_config(database, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(database, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
    sqlite3_db_config(database, SQLITE_DBCONFIG_ENABLE_TRIGGER, 0, nullptr);
    sqlite3_db_config(database, SQLITE_DBCONFIG_ENABLE_LOAD_EXTENSION, 0, nullptr);
    sqlite3_db_config(database, SQLITE_DBCONFIG_ENABLE_FTS3_TOKENIZER, 0, nullptr);
    // What must not land in a file lands in memory, which the budget watches. Pages are never mapped: a file that is
    // cut while it is read would end the process.
    sqlite3_exec(database,
                 "PRAGMA temp_store=MEMORY; PRAGMA mmap_size=0; PRAGMA query_only=1; PRAGMA cell_size_check=1", nullptr,
                 nullptr, nullptr);
    static constexpr std::array<std::pair<int, int>, 9> kLimits = {{{SQLITE_LIMIT_LENGTH, int{kLargestTile}},
                                                                    {SQLITE_LIMIT_SQL_LENGTH, 16384},
                                                                    {SQLITE_LIMIT_COLUMN, 64},
                                                                    {SQLITE_LIMIT_EXPR_DEPTH, 32},
                                                                    {SQLITE_LIMIT_COMPOUND_SELECT, 8},
                                                                    {SQLITE_LIMIT_VDBE_OP, 20000},
                                                                    {SQLITE_LIMIT_ATTACHED, 0},
                                                                    {SQLITE_LIMIT_TRIGGER_DEPTH, 1},
                                                                    {SQLITE_LIMIT_WORKER_THREADS, 0}}};
    for (const auto& [limit, value] : kLimits) {
        sqlite3_limit(database, limit, value);
    }
    sqlite3_set_authorizer(database, &authorize, nullptr);
    sqlite3_progress_handler(database, kStepsBetweenLooks, &Budget::look, &budget_);
}

Statement OpenMbtiles::prepare(const std::string& query) {
    if (!budget_.begin()) {
        return nullptr;
    }
    sqlite3_stmt* statement = nullptr;
    sqlite3_prepare_v2(database_.get(), query.c_str(), static_cast<int>(query.size()), &statement, nullptr);
    return Statement(statement);
}

bool OpenMbtiles::connect(const std::string& name, int flags, std::string& error) {
    tile_.reset();
    sqlite3* opened = nullptr;
    const int status = sqlite3_open_v2(name.c_str(), &opened, SQLITE_OPEN_READONLY | flags, nullptr);
    database_.reset(opened);
    if (status != SQLITE_OK || !opened) {
        error = opened ? sqlite3_errmsg(opened) : sqlite3_errstr(status);
        return false;
    }
    harden();
    tile_ = prepare("SELECT tile_data FROM tiles WHERE zoom_level=?1 AND tile_column=?2 AND tile_row=?3 LIMIT 1");
    if (!tile_) {
        error = sqlite3_errmsg(database_.get());
        return false;
    }
    return true;
}

bool OpenMbtiles::open(const std::string& path, std::string& error) {
    // A name that begins like an address would be read as one.
    const std::string plain = path.starts_with('/') ? path : "./" + path;
    if (!connect(plain, 0, error)) {
        const int code = database_ ? sqlite3_errcode(database_.get()) & 0xFF : SQLITE_NOMEM;
        if (code != SQLITE_CANTOPEN && code != SQLITE_READONLY) {
            return false;
        }
        // A database with a write-ahead log in a folder that is not ours to write: as it stands.
        std::string address = "file:";
        for (const char letter : plain) {
            if (letter == '?' || letter == '#' || letter == '%') {
                static constexpr std::string_view kDigits = "0123456789ABCDEF";
                const auto byte = static_cast<unsigned char>(letter);
                address += {'%', kDigits[byte >> 4], kDigits[byte & 15]};
            } else {
                address += letter;
            }
        }
        if (!connect(address + "?immutable=1", SQLITE_OPEN_URI, error)) {
            return false;
        }
    }
    if (!readMetadata()) {
        error = sqlite3_errmsg(database_.get());
        return false;
    }
    return true;
}

/// A file without the table is read all the same; one that is damaged or locked is not.
bool OpenMbtiles::readMetadata() {
    const Statement rows = prepare("SELECT name, value FROM metadata LIMIT 256");
    if (!rows) {
        const int code = sqlite3_errcode(database_.get()) & 0xFF;
        return code == SQLITE_ERROR || code == SQLITE_AUTH;
    }
    int status = sqlite3_step(rows.get());
    for (std::size_t row = 0; status == SQLITE_ROW && row < kMostMetadataRows; ++row) {
        const auto text = [&](int column) {
            const auto* data = reinterpret_cast<const char*>(sqlite3_column_text(rows.get(), column));
            const int size = sqlite3_column_bytes(rows.get(), column);
            return data && size <= kLongestMetadata ? std::string(data, static_cast<std::size_t>(size)) : std::string();
        };
        const std::string name = text(0);
        if (!name.empty()) {
            metadata_.emplace(name, text(1));
        }
        status = sqlite3_step(rows.get());
    }
    return status == SQLITE_ROW || status == SQLITE_DONE || (status & 0xFF) == SQLITE_TOOBIG;
}

std::optional<int> OpenMbtiles::levelBy(const std::string& order) {
    const Statement rows = prepare("SELECT zoom_level FROM tiles ORDER BY zoom_level " + order + " LIMIT 1");
    if (!rows || sqlite3_step(rows.get()) != SQLITE_ROW || sqlite3_column_type(rows.get(), 0) != SQLITE_INTEGER) {
        return std::nullopt;
    }
    return sqlite3_column_int(rows.get(), 0);
}

std::optional<platform::Bytes> OpenMbtiles::tile(const TileKey& key) {
    if (key.z < 0 || key.z > 30 || !budget_.begin()) {
        return std::nullopt;
    }
    sqlite3_stmt* statement = tile_.get();
    sqlite3_bind_int(statement, 1, key.z);
    sqlite3_bind_int(statement, 2, key.x);
    sqlite3_bind_int(statement, 3, (1 << key.z) - 1 - key.y);
    std::optional<platform::Bytes> found;
    if (sqlite3_step(statement) == SQLITE_ROW) {
        const auto* data = static_cast<const std::uint8_t*>(sqlite3_column_blob(statement, 0));
        const auto size = static_cast<std::size_t>(sqlite3_column_bytes(statement, 0));
        if (data && size <= kLargestTile) {
            found = platform::Bytes(data, data + size);
        }
    }
    sqlite3_reset(statement);
    return found;
}

}  // namespace

std::shared_ptr<MbtilesFile> SqliteMbtiles::open(const std::string& path, std::string& error) {
    if (error = objection(path); !error.empty()) {
        return nullptr;
    }
    auto opened = std::make_shared<OpenMbtiles>();
    return opened->open(path, error) ? opened : nullptr;
}

}  // namespace ktr::tiles
