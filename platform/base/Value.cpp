#include "platform/base/Value.h"

#include "platform/base/Json.h"

namespace ktr::platform {

namespace {
constexpr std::size_t kLinearSearchLimit = 16;
}

Value::Value(Array value) : data_(std::make_shared<const Array>(std::move(value))) {}
Value::Value(Dictionary value) : data_(std::make_shared<const Dictionary>(std::move(value))) {}

std::optional<bool> Value::boolean() const {
    const bool* value = std::get_if<bool>(&data_);
    return value != nullptr ? std::optional<bool>(*value) : std::nullopt;
}

std::optional<std::int64_t> Value::integer() const {
    const std::int64_t* value = std::get_if<std::int64_t>(&data_);
    return value != nullptr ? std::optional<std::int64_t>(*value) : std::nullopt;
}

std::optional<double> Value::number() const {
    if (const double* real = std::get_if<double>(&data_)) {
        return *real;
    }
    if (const std::int64_t* whole = std::get_if<std::int64_t>(&data_)) {
        return static_cast<double>(*whole);
    }
    return std::nullopt;
}

const std::string* Value::string() const {
    return std::get_if<std::string>(&data_);
}

const Value::Array* Value::array() const {
    const auto* value = std::get_if<std::shared_ptr<const Array>>(&data_);
    return value != nullptr ? value->get() : nullptr;
}

const Dictionary* Value::dictionary() const {
    const auto* value = std::get_if<std::shared_ptr<const Dictionary>>(&data_);
    return value != nullptr ? value->get() : nullptr;
}

std::string Value::description() const {
    switch (kind()) {
        case Kind::Null:
            return "<null>";
        case Kind::Bool:
            return *boolean() ? "1" : "0";
        case Kind::String:
            return *string();
        default:
            return writeJson(*this);
    }
}

bool Value::operator==(const Value& other) const {
    if (kind() != other.kind()) {
        return false;
    }
    if (const Array* mine = array()) {
        return *mine == *other.array();
    }
    if (const Dictionary* mine = dictionary()) {
        return *mine == *other.dictionary();
    }
    return data_ == other.data_;
}

Dictionary::Dictionary(std::initializer_list<Entry> entries) {
    for (const Entry& entry : entries) {
        set(entry.first, entry.second);
    }
}

std::optional<std::size_t> Dictionary::indexOf(std::string_view key) const {
    if (!index_.empty()) {
        const auto found = index_.find(std::string(key));
        return found != index_.end() ? std::optional<std::size_t>(found->second) : std::nullopt;
    }
    for (std::size_t i = 0; i < entries_.size(); ++i) {
        if (entries_[i].first == key) {
            return i;
        }
    }
    return std::nullopt;
}

const Value* Dictionary::find(std::string_view key) const {
    const auto at = indexOf(key);
    return at ? &entries_[*at].second : nullptr;
}

void Dictionary::set(std::string key, Value value) {
    if (const auto at = indexOf(key)) {
        entries_[*at].second = std::move(value);
        return;
    }
    entries_.emplace_back(std::move(key), std::move(value));
    if (!index_.empty()) {
        index_.emplace(entries_.back().first, entries_.size() - 1);
    } else if (entries_.size() > kLinearSearchLimit) {
        for (std::size_t i = 0; i < entries_.size(); ++i) {
            index_.emplace(entries_[i].first, i);
        }
    }
}

void Dictionary::remove(std::string_view key) {
    const auto at = indexOf(key);
    if (!at) {
        return;
    }
    entries_.erase(entries_.begin() + static_cast<std::ptrdiff_t>(*at));
    index_.clear();
    if (entries_.size() > kLinearSearchLimit) {
        for (std::size_t i = 0; i < entries_.size(); ++i) {
            index_.emplace(entries_[i].first, i);
        }
    }
}

bool Dictionary::operator==(const Dictionary& other) const {
    if (size() != other.size()) {
        return false;
    }
    for (const Entry& entry : entries_) {
        const Value* theirs = other.find(entry.first);
        if (theirs == nullptr || !(*theirs == entry.second)) {
            return false;
        }
    }
    return true;
}

}  // namespace ktr::platform
