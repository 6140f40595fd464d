#pragma once

#include <optional>
#include <string>
#include <vector>

namespace ktr::bench {

/// What a row shows.
struct RowTexts {
    std::string name;
    std::string locality;
    std::string distance;
    std::string age;
    bool operator==(const RowTexts&) const = default;
};

struct RowData {
    RowTexts now;
    /// What an update changes the row to.
    RowTexts next;
    std::string initials;
    /// "#rrggbb"
    std::string color;
};

/// A rows file: {"scene": "rows", "width": 400, "scale": 2, "friends": [{"name", "initials", "color", "locality",
/// "distance", "age", "next": {"name", "locality", "distance", "age"}}]}. Width in points.
struct RowsFile {
    double width = 400.0;
    double scale = 2.0;
    std::vector<RowData> friends;
};

/// None, with a line on standard error, for a file that cannot be read as such.
std::optional<RowsFile> readRowsFile(const std::string& path);

}  // namespace ktr::bench
