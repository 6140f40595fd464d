#pragma once

#include <cstddef>
#include <optional>
#include <string_view>
#include <variant>
#include <vector>

#include "platform/layout/LayoutTypes.h"
#include "platform/layout/VisualFormat.h"

namespace ktr::platform {

/// A visual format taken apart: names are not looked up yet. Texts point into the format. Offsets are bytes.
struct VisualFormatSyntax {
    struct Name {
        std::string_view text;
        std::size_t offset;
    };
    struct Number {
        double value;
        std::size_t offset;
    };
    using Operand = std::variant<Number, Name>;

    struct Predicate {
        LayoutRelation relation = LayoutRelation::Equal;
        Operand object;
        std::optional<Operand> priority;
    };
    /// What stands between two items. None: they touch. Without predicates: the standard space.
    using Connection = std::optional<std::vector<Predicate>>;
    struct Item {
        Name view;
        std::vector<Predicate> sizes;
        Connection before;
    };

    LayoutAxis axis = LayoutAxis::Horizontal;
    /// Where the "|" stands.
    std::optional<std::size_t> leadingEdge;
    std::vector<Item> items;
    Connection last;
    std::optional<std::size_t> trailingEdge;
};

/// Reads one format.
class VisualFormatParser {
  public:
    explicit VisualFormatParser(std::string_view text) : text_(text) {}

    /// None after an error.
    std::optional<VisualFormatSyntax> parse();
    const std::optional<VisualFormatError>& error() const { return error_; }

    /// An error at a byte of a format.
    static VisualFormatError errorAt(std::string_view text, std::size_t offset, std::string expected);

  private:
    using Syntax = VisualFormatSyntax;

    bool fail(const char* expected);
    bool isNext(char c) const { return at_ < text_.size() && text_[at_] == c; }
    bool skip(std::string_view token);
    bool readOrientation(Syntax& syntax);
    bool readConnection(Syntax::Connection& connection);
    bool readPredicates(std::vector<Syntax::Predicate>& predicates, const char* object);
    bool readPredicate(Syntax::Predicate& predicate, const char* object);
    bool readOperand(Syntax::Operand& operand, const char* expected, bool maySign);
    std::size_t endOfNumber(std::size_t first) const;
    bool readView(Syntax::Item& item);
    std::optional<Syntax::Name> name();

    std::string_view text_;
    std::size_t at_ = 0;
    std::optional<VisualFormatError> error_;
};

}  // namespace ktr::platform
