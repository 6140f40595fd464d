#pragma once

#include <string>
#include <vector>

namespace ktr::documents {

/// A contact as a vCard (RFC 2426, version 3.0). A value.
struct VCard {
    std::string whole;  ///< the name as one text
    std::string last = {};
    std::string first = {};
    std::vector<std::string> emails = {};
    std::vector<std::string> phones = {};

    /// From BEGIN to END with its line's end; UTF-8.
    std::string text() const;
};

}  // namespace ktr::documents
