#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::linux_ {

/// The cards of a text, found but not read, and what of a card is worth reading. Linear in the text's length, whatever
/// it holds: the library that reads the cards is not, so that what it would be slow with is kept from it. A value; any
/// thread.
struct VCardText {
    /// A card beyond this is passed over; bytes.
    static constexpr std::size_t kLargestCard = std::size_t{16} << 20;
    /// What follows these many cards is passed over.
    static constexpr std::size_t kMostCards = 100'000;
    /// Problems that are kept; more would say nothing new.
    static constexpr std::size_t kMostProblems = 100;
    /// Of a card, the properties that are read; further ones are left out.
    static constexpr std::size_t kMostProperties = 1'000;
    /// A property in more parts (between semicolons and commas) is left out.
    static constexpr std::size_t kMostParts = 100;
    /// So is one that is longer, but for pictures: a name of a row's that long takes the main thread seconds to
    /// measure. Bytes.
    static constexpr std::size_t kLongestProperty = std::size_t{4} << 10;

    struct Card {
        std::string_view text;  ///< from BEGIN:VCARD to the end of the line END:VCARD
        std::size_t line = 0;   ///< its first, counted from 1
    };
    struct Problem {
        std::size_t line = 0;
        const char* message = "";
    };
    std::vector<Card> cards;
    std::vector<Problem> problems;

    /// The cards refer to the text.
    static VCardText of(std::string_view text);
    /// The properties of a card that make a contact (names, addresses, numbers, the picture, ...), within the caps.
    static std::string essential(std::string_view card);
};

}  // namespace ktr::linux_
