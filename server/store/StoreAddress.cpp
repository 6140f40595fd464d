#include "server/store/StoreAddress.h"

#include "server/store/PostgresDatabase.h"
#include "server/store/Secret.h"
#include "server/store/SqliteDatabase.h"

namespace ktr::server {

namespace {

constexpr std::string_view kMemory = "memory:";

}  // namespace

StoreAddress StoreAddress::inMemory() {
    return {std::string(kMemory) + std::to_string(Secret::number())};
}

bool StoreAddress::isServer(std::string_view text) {
    return text.rfind("postgresql://", 0) == 0 || text.rfind("postgres://", 0) == 0;
}

bool StoreAddress::isFolder() const {
    return !isServer(text) && text.rfind(kMemory, 0) != 0;
}

std::string StoreAddress::name() const {
    return isServer(text) ? "the database server" : isFolder() ? text + "/service.db" : "the store in memory";
}

std::unique_ptr<Database> StoreAddress::connect(std::string& complaint) const {
    std::unique_ptr<Database> database;
    std::string problem;
    if (isServer(text)) {
        database = PostgresDatabase::open(text, problem);
    } else {
        database = isFolder() ? SqliteDatabase::open(name(), problem) : SqliteDatabase::openInMemory(text, problem);
    }
    if (!database) {
        complaint = name() + ": " + problem;
    }
    return database;
}

}  // namespace ktr::server
