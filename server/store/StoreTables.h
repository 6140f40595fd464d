#pragma once

#include <array>
#include <span>
#include <string_view>

namespace ktr::server {

/// A table of the store, and whose it is. A value.
struct StoreTable {
    std::string_view name;
    /// Whether a backup has it: not where people were, who looked, and what lasts minutes.
    bool inBackup = true;
    /// Columns that name a person, the one whose row it is first. What refers to a person goes with the person.
    std::array<std::string_view, 2> people{};
    /// Columns that an export leaves out: what opens something.
    std::array<std::string_view, 3> secrets{};
};

/// All tables, each after those that it refers to. Whoever makes a table says here what becomes of it; a test looks for
/// those that are missing. Any thread.
class StoreTables {
  public:
    static std::span<const StoreTable> all();
};

}  // namespace ktr::server
