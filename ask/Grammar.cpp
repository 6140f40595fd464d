#include "ask/Grammar.h"

#include <algorithm>
#include <utility>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

constexpr std::array<const char*, Grammar::kSlots> kSlotNames{"name", "place", "time", "hour", "minute", "count"};
constexpr std::array<const char*, Grammar::kLists> kListNames{"precision", "every", "spot", "now"};
/// Rules within rules, and brackets in them.
constexpr std::size_t kDeepest = 64;

template <std::size_t kCount>
std::optional<std::uint8_t> indexOf(const std::array<const char*, kCount>& names, const std::string& name) {
    const auto found = std::find(names.begin(), names.end(), name);
    return found == names.end() ? std::nullopt : std::optional(static_cast<std::uint8_t>(found - names.begin()));
}

}  // namespace

/// One reading of one text: for each node the surest way to it, letter by letter.
class Grammar::Run {
  public:
    Run(const Grammar& grammar, const std::u32string& text)
        : nodes_(grammar.nodes_), text_(text), best_(nodes_.size()), seen_(nodes_.size(), 0) {}

    std::vector<Reading> all() {
        std::vector<Way> ways{{0, {}}};
        for (std::size_t at = 0;; ++at) {
            spread(std::move(ways), at);
            if (at == text_.size()) {
                return accepted();
            }
            ways = stepped(at);
        }
    }

  private:
    struct Way {
        std::uint32_t node = 0;
        Reading reading;
    };

    bool isBetweenWords(std::size_t at) const {
        return at == 0 || at == text_.size() || text_[at - 1] == U' ' || FoldedText::isWithoutBlanks(text_[at - 1]) ||
               FoldedText::isWithoutBlanks(text_[at]);
    }

    /// Follows all that reads no letter.
    void spread(std::vector<Way> ways, std::size_t at) {
        ++round_;
        active_.clear();
        // The surest first: few are then found twice.
        std::stable_sort(ways.begin(), ways.end(),
                         [](const Way& one, const Way& other) { return one.reading.letters < other.reading.letters; });
        while (!ways.empty()) {
            Way way = std::move(ways.back());
            ways.pop_back();
            if (seen_[way.node] == round_ && best_[way.node].letters >= way.reading.letters) {
                continue;
            }
            if (seen_[way.node] != round_) {
                seen_[way.node] = round_;
                active_.push_back(way.node);
            }
            best_[way.node] = way.reading;
            if (passes(nodes_[way.node], way.reading, at)) {
                const auto& next = nodes_[way.node].next;
                for (auto one = next.rbegin(); one != next.rend(); ++one) {
                    ways.push_back({*one, way.reading});
                }
            }
        }
    }

    /// Whether a node is left without reading a letter; notes in the reading what it says.
    bool passes(const Node& node, Reading& reading, std::size_t at) const {
        switch (node.kind) {
            case Node::Kind::Split:
                return true;
            case Node::Kind::Blank:
                return isBetweenWords(at);
            case Node::Kind::Value:
                reading.values.at(node.which) = node.value;
                return true;
            case Node::Kind::SlotBegin:
                reading.slots.at(node.which) = {static_cast<std::uint16_t>(at), Span::kNone};
                return at < text_.size() && text_[at] != U' ';
            case Node::Kind::SlotEnd:
                reading.slots.at(node.which).end = static_cast<std::uint16_t>(at);
                return at > 0 && text_[at - 1] != U' ';
            default:
                return false;
        }
    }

    /// Reads one letter.
    std::vector<Way> stepped(std::size_t at) const {
        std::vector<Way> ways;
        const char32_t letter = text_[at];
        for (const std::uint32_t number : active_) {
            const Node& node = nodes_[number];
            Reading reading = best_[number];
            if (node.kind == Node::Kind::Letter && node.letter == letter) {
                ++reading.letters;
            } else if (node.kind == Node::Kind::Slot) {
                if (at - reading.slots.at(node.which).begin >= kLongestSlot) {
                    continue;
                }
            } else if (node.kind != Node::Kind::Blank || letter != U' ') {
                continue;
            }
            for (const std::uint32_t next : node.next) {
                ways.push_back({next, reading});
            }
        }
        return ways;
    }

    std::vector<Reading> accepted() {
        std::sort(active_.begin(), active_.end());
        std::vector<Reading> readings;
        for (const std::uint32_t number : active_) {
            if (nodes_[number].kind == Node::Kind::Accept) {
                readings.push_back(best_[number]);
                readings.back().group = nodes_[number].letter;
            }
        }
        std::stable_sort(readings.begin(), readings.end(),
                         [](const Reading& one, const Reading& other) { return one.letters > other.letters; });
        return readings;
    }

    const std::vector<Node>& nodes_;
    const std::u32string& text_;
    std::vector<Reading> best_;
    std::vector<std::uint32_t> seen_;  ///< in which round `best_` was written
    std::uint32_t round_ = 0;
    std::vector<std::uint32_t> active_;
};

Grammar::Grammar(Rules rules, Lists lists) : rules_(std::move(rules)), lists_(std::move(lists)) {
    nodes_.emplace_back();
}

std::uint32_t Grammar::make(Node node, const Ends& before) {
    if (nodes_.size() >= kMostNodes) {
        complaint_ = "the templates are too many";
        return 0;
    }
    const auto number = static_cast<std::uint32_t>(nodes_.size());
    nodes_.push_back(std::move(node));
    for (const std::uint32_t one : before) {
        nodes_[one].next.push_back(number);
    }
    return number;
}

Grammar::Ends Grammar::compileNamed(const Template::Part& part, const Ends& before, std::size_t depth) {
    if (part.kind == Template::Part::Kind::Rule) {
        const auto rule = rules_.find(part.name);
        if (rule == rules_.end()) {
            complaint_ = "there is no rule \"" + part.name + "\"";
            return before;
        }
        return compile(rule->second, before, depth + 1);
    }
    if (const auto list = indexOf(kListNames, part.name)) {
        Ends ends;
        const auto& values = lists_.at(*list);
        for (std::size_t value = 0; value < values.size(); ++value) {
            Node mark{Node::Kind::Value};
            mark.which = *list;
            mark.value = static_cast<std::int8_t>(value);
            const Ends marked = compile(values[value], {make(mark, before)}, depth + 1);
            ends.insert(ends.end(), marked.begin(), marked.end());
        }
        return ends;
    }
    const auto slot = indexOf(kSlotNames, part.name);
    if (!slot) {
        complaint_ = "there is no slot \"" + part.name + "\"";
        return before;
    }
    const std::uint32_t begin = make({Node::Kind::SlotBegin, *slot}, before);
    const std::uint32_t loop = make({Node::Kind::Slot, *slot}, {begin});
    nodes_[loop].next.push_back(loop);
    return {make({Node::Kind::SlotEnd, *slot}, {loop})};
}

Grammar::Ends Grammar::compile(const Template::Part& part, Ends before, std::size_t depth) {
    using Kind = Template::Part::Kind;
    if (!complaint_.empty()) {
        return before;
    }
    if (depth > kDeepest) {
        complaint_ = "a rule uses itself, or brackets are nested too deeply";
        return before;
    }
    switch (part.kind) {
        case Kind::Words:
            for (const char32_t letter : part.text) {
                Node node{letter == U' ' ? Node::Kind::Blank : Node::Kind::Letter};
                node.letter = letter;
                before = {make(node, before)};
            }
            return before;
        case Kind::Sequence:
            for (const Template::Part& one : part.parts) {
                before = compile(one, before, depth + 1);
            }
            return before;
        case Kind::Alternatives: {
            // All ways in and out pass one node: what follows is linked once.
            const std::uint32_t in = make({}, before);
            Ends ends;
            for (const Template::Part& one : part.parts) {
                const Ends some = compile(one, {in}, depth + 1);
                ends.insert(ends.end(), some.begin(), some.end());
            }
            return {make({}, ends)};
        }
        case Kind::Slot:
        case Kind::Rule:
            return compileNamed(part, before, depth);
    }
    return before;
}

std::string Grammar::add(std::uint32_t group, const Template::Part& part) {
    complaint_.clear();
    const Ends ends = compile(part, {0}, 0);
    Node accept{Node::Kind::Accept};
    accept.letter = group;
    make(accept, ends);
    return complaint_;
}

std::vector<Grammar::Reading> Grammar::read(const std::u32string& text) const {
    if (text.empty() || text.size() > kLongestText) {
        return {};
    }
    return Run(*this, text).all();
}

}  // namespace ktr::ask
