#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <variant>
#include <vector>

#include "platform/base/Api.h"

namespace ktr::platform {

class Dictionary;

/// A value as JSON knows it. Bool, integer and real are distinct; null is a value, absence is not one.
/// Containers are shared and immutable: copying a Value is cheap. Any thread.
class KTR_API Value {
  public:
    using Array = std::vector<Value>;
    enum class Kind { Null, Bool, Integer, Real, String, Array, Dictionary };

    Value() = default;
    Value(std::nullptr_t) {}
    Value(bool value) : data_(value) {}
    Value(int value) : data_(static_cast<std::int64_t>(value)) {}
    Value(std::int64_t value) : data_(value) {}
    Value(double value) : data_(value) {}
    Value(const char* value) : data_(std::string(value)) {}
    Value(std::string value) : data_(std::move(value)) {}
    Value(Array value);
    Value(Dictionary value);

    Kind kind() const { return static_cast<Kind>(data_.index()); }
    bool isNull() const { return kind() == Kind::Null; }
    /// Integer or real; a bool is no number.
    bool isNumber() const { return kind() == Kind::Integer || kind() == Kind::Real; }

    /// None when the value is of another kind. The pointers live as long as the Value.
    std::optional<bool> boolean() const;
    std::optional<std::int64_t> integer() const;
    /// An integer or a real, as a double.
    std::optional<double> number() const;
    const std::string* string() const;
    const Array* array() const;
    const Dictionary* dictionary() const;

    /// The textual description: true and false 1 and 0, integers decimal, whole reals without a fraction, other reals
    /// the shortest text that reads back the same, null "<null>", strings as they stand, containers compact JSON.
    std::string description() const;

    bool operator==(const Value& other) const;

  private:
    std::variant<std::monostate, bool, std::int64_t, double, std::string, std::shared_ptr<const Array>,
                 std::shared_ptr<const Dictionary>>
        data_;
};

/// String keys and values, in order of insertion; tells absent, null and present apart.
class KTR_API Dictionary {
  public:
    using Entry = std::pair<std::string, Value>;

    Dictionary() = default;
    Dictionary(std::initializer_list<Entry> entries);

    /// None when absent. Valid until the dictionary is changed.
    const Value* find(std::string_view key) const;
    bool contains(std::string_view key) const { return find(key) != nullptr; }
    /// Overwrites in place, or appends.
    void set(std::string key, Value value);
    void remove(std::string_view key);

    std::size_t size() const { return entries_.size(); }
    bool empty() const { return entries_.empty(); }
    std::vector<Entry>::const_iterator begin() const { return entries_.begin(); }
    std::vector<Entry>::const_iterator end() const { return entries_.end(); }

    /// The same keys with the same values; order does not count.
    bool operator==(const Dictionary& other) const;

  private:
    std::optional<std::size_t> indexOf(std::string_view key) const;

    std::vector<Entry> entries_;
    /// Made when the dictionary outgrows a linear search.
    std::unordered_map<std::string, std::size_t> index_;
};

}  // namespace ktr::platform
