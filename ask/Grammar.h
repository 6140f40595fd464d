#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <limits>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "ask/Template.h"

namespace ktr::ask {

/// Templates compiled into one automaton that reads a text once, whatever it is: the work is bounded by the product of
/// its lengths. Immutable once it is compiled; any thread.
class Grammar {
  public:
    /// What a template leaves open. A letter of it is no evidence for the template.
    enum class Slot : std::uint8_t { Name, Place, Time, Hour, Minute, Count };
    static constexpr std::size_t kSlots = 6;
    /// What a template has words for.
    enum class List : std::uint8_t { Precision, Every, Spot, Now };
    static constexpr std::size_t kLists = 4;

    /// The longest text, and the longest slot, that is read, letters.
    static constexpr std::size_t kLongestText = 240;
    static constexpr std::size_t kLongestSlot = 80;
    /// The most parts that an automaton has.
    static constexpr std::size_t kMostNodes = 60000;

    struct Span {
        static constexpr std::uint16_t kNone = std::numeric_limits<std::uint16_t>::max();
        std::uint16_t begin = kNone;
        std::uint16_t end = kNone;
        bool isThere() const { return begin != kNone; }
    };
    /// One way to read a text as a whole.
    struct Reading {
        std::uint32_t group = 0;   ///< of the template
        std::int32_t letters = 0;  ///< that the template named: the more, the surer
        std::array<Span, kSlots> slots;
        std::array<std::int8_t, kLists> values{-1, -1, -1, -1};  ///< which of a list's; -1: none
    };
    using Rules = std::map<std::string, Template::Part>;
    /// By list: a part for each value.
    using Lists = std::array<std::vector<Template::Part>, kLists>;

    /// Slots and lists are written by these names: "name", "place", "time", "hour", "minute", "count"; "precision",
    /// "every", "spot", "now".
    Grammar(Rules rules, Lists lists);
    /// Empty, or what is wrong: an unknown slot or rule, a rule that uses itself, too much of it.
    std::string add(std::uint32_t group, const Template::Part& part);

    /// For each template that says all of a text its surest reading; the surest template first.
    std::vector<Reading> read(const std::u32string& text) const;
    std::size_t size() const { return nodes_.size(); }

  private:
    struct Node {
        enum class Kind : std::uint8_t { Letter, Blank, Split, SlotBegin, Slot, SlotEnd, Value, Accept };
        Kind kind = Kind::Split;
        std::uint8_t which = 0;  ///< slot or list
        std::int8_t value = 0;
        char32_t letter = 0;  ///< or the group of an acceptance
        std::vector<std::uint32_t> next = {};
    };
    class Run;
    using Ends = std::vector<std::uint32_t>;

    std::uint32_t make(Node node, const Ends& before);
    /// Adds a part behind `before`; what it ends with.
    Ends compile(const Template::Part& part, Ends before, std::size_t depth);
    Ends compileNamed(const Template::Part& part, const Ends& before, std::size_t depth);

    Rules rules_;
    Lists lists_;
    std::vector<Node> nodes_;
    std::string complaint_;
};

}  // namespace ktr::ask
