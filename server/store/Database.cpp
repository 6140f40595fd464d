#include "server/store/Database.h"

#include "platform/base/Utf8.h"

namespace ktr::server {

using Type = DatabaseValue::Type;

void Database::note(std::string complaint) {
    if (complaint_.empty()) {
        complaint_ = complaint.empty() ? "failed for an unknown reason" : std::move(complaint);
    }
}

std::string Database::translated(std::string_view sql) const {
    std::string text;
    for (std::size_t at = 0; at < sql.size();) {
        const std::size_t open = sql.find('{', at);
        const std::size_t close = open == std::string_view::npos ? open : sql.find('}', open);
        if (close == std::string_view::npos) {
            return text.append(sql.substr(at));
        }
        text.append(sql.substr(at, open - at)).append(inDialect(sql.substr(open + 1, close - open - 1)));
        at = close + 1;
    }
    return text;
}

Database::Run& Database::Run::bind(DatabaseValue value) {
    values_.push_back(std::move(value));
    return *this;
}

Database::Run& Database::Run::bind(std::int64_t value) {
    return bind(DatabaseValue::of(value));
}

Database::Run& Database::Run::bind(double value) {
    return bind(DatabaseValue::of(value));
}

Database::Run& Database::Run::bind(std::string_view text) {
    if (text.find('\0') != std::string_view::npos || !platform::isValidUtf8(text)) {
        database_.note("a text is no UTF-8");
    }
    return bind(DatabaseValue::of(Type::Text, std::string(text)));
}

Database::Run& Database::Run::bindBytes(std::string_view bytes) {
    return bind(DatabaseValue::of(Type::Bytes, std::string(bytes)));
}

Database::Run& Database::Run::bind(const std::optional<std::int64_t>& value) {
    return bind(value ? DatabaseValue::of(*value) : DatabaseValue::none(Type::Integer));
}

Database::Run& Database::Run::bind(const std::optional<double>& value) {
    return bind(value ? DatabaseValue::of(*value) : DatabaseValue::none(Type::Real));
}

bool Database::Run::next() {
    if (!rows_ && !database_.failed()) {
        rows_ = database_.query(sql_, values_);
    }
    return rows_ && !database_.failed() && rows_->next();
}

bool Database::Run::run() {
    if (rows_) {
        while (next()) {
        }
    } else if (!database_.failed()) {
        database_.perform(sql_, values_);
    }
    return !database_.failed();
}

std::optional<std::int64_t> Database::Run::maybeInteger(int column) const {
    const DatabaseValue found = value(column);
    return found.isNone ? std::nullopt : std::optional(found.integer);
}

std::optional<double> Database::Run::maybeReal(int column) const {
    const DatabaseValue found = value(column);
    return found.isNone ? std::nullopt : std::optional(found.real);
}

}  // namespace ktr::server
