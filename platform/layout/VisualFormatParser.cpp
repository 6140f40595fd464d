#include "platform/layout/VisualFormatParser.h"

#include <charconv>
#include <utility>

namespace ktr::platform {

namespace {

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Letters, "_" and everything beyond ASCII.
bool isNameStart(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' || static_cast<unsigned char>(c) >= 0x80;
}

}  // namespace

VisualFormatError VisualFormatParser::errorAt(std::string_view text, std::size_t offset, std::string expected) {
    std::size_t column = 1;
    for (std::size_t i = 0; i < offset && i < text.size(); ++i) {
        column += (static_cast<unsigned char>(text[i]) & 0xC0U) != 0x80U ? 1 : 0;
    }
    return {offset, column, std::move(expected)};
}

bool VisualFormatParser::fail(const char* expected) {
    error_ = errorAt(text_, at_, std::string("expected ") + expected);
    return false;
}

bool VisualFormatParser::skip(std::string_view token) {
    if (text_.substr(at_, token.size()) != token) {
        return false;
    }
    at_ += token.size();
    return true;
}

std::optional<VisualFormatSyntax> VisualFormatParser::parse() {
    Syntax syntax;
    if (!readOrientation(syntax)) {
        return std::nullopt;
    }
    Syntax::Connection connection;
    if (isNext('|')) {
        syntax.leadingEdge = at_++;
        if (!readConnection(connection)) {
            return std::nullopt;
        }
    }
    for (;;) {
        Syntax::Item item;
        item.before = std::exchange(connection, {});
        if (!readView(item)) {
            return std::nullopt;
        }
        syntax.items.push_back(std::move(item));
        if (at_ == text_.size()) {
            return syntax;
        }
        if (!isNext('-') && !isNext('[') && !isNext('|')) {
            fail("'-', '[', '|' or the end");
            return std::nullopt;
        }
        if (!readConnection(connection)) {
            return std::nullopt;
        }
        if (isNext('|')) {
            syntax.last = std::move(connection);
            syntax.trailingEdge = at_++;
            if (at_ != text_.size()) {
                fail("the end");
                return std::nullopt;
            }
            return syntax;
        }
        if (!isNext('[')) {
            fail("'[' or '|'");
            return std::nullopt;
        }
    }
}

bool VisualFormatParser::readOrientation(Syntax& syntax) {
    if (isNext('H') || isNext('V')) {
        syntax.axis = isNext('H') ? LayoutAxis::Horizontal : LayoutAxis::Vertical;
        ++at_;
        return skip(":") || fail("':'");
    }
    return isNext('|') || isNext('[') || fail("'H:', 'V:', '|' or '['");
}

bool VisualFormatParser::readConnection(Syntax::Connection& connection) {
    if (!skip("-")) {
        return true;
    }
    connection.emplace();
    if (isNext('[') || isNext('|')) {
        return true;
    }
    if (isNext('(')) {
        if (!readPredicates(*connection, "a number or a metric")) {
            return false;
        }
    } else {
        Syntax::Predicate predicate;
        if (!readOperand(predicate.object, "a number, a metric, '(', '[' or '|'", false)) {
            return false;
        }
        connection->push_back(std::move(predicate));
    }
    return skip("-") || fail("'-'");
}

/// "(" predicate {"," predicate} ")"
bool VisualFormatParser::readPredicates(std::vector<Syntax::Predicate>& predicates, const char* object) {
    ++at_;
    do {
        Syntax::Predicate predicate;
        if (!readPredicate(predicate, object)) {
            return false;
        }
        predicates.push_back(std::move(predicate));
    } while (skip(","));
    const bool hasPriority = predicates.back().priority.has_value();
    return skip(")") || fail(hasPriority ? "',' or ')'" : "'@', ',' or ')'");
}

/// [relation] object ["@" priority]
bool VisualFormatParser::readPredicate(Syntax::Predicate& predicate, const char* object) {
    if (skip(">=")) {
        predicate.relation = LayoutRelation::GreaterOrEqual;
    } else if (skip("<=")) {
        predicate.relation = LayoutRelation::LessOrEqual;
    } else if (!skip("==") && (isNext('=') || isNext('<') || isNext('>'))) {
        return fail("'==', '<=' or '>='");
    }
    if (!readOperand(predicate.object, object, true)) {
        return false;
    }
    if (!skip("@")) {
        return true;
    }
    Syntax::Operand priority;
    if (!readOperand(priority, "a priority: a number or a metric", false)) {
        return false;
    }
    predicate.priority = priority;
    return true;
}

bool VisualFormatParser::readOperand(Syntax::Operand& operand, const char* expected, bool maySign) {
    const std::size_t begin = at_;
    const bool isSigned = maySign && isNext('-');
    const std::size_t first = begin + (isSigned ? 1 : 0);
    if (const std::size_t end = endOfNumber(first); end > first) {
        Syntax::Number number{0.0, begin};
        const auto result =
            std::from_chars(text_.data() + begin, text_.data() + end, number.value, std::chars_format::fixed);
        if (result.ec != std::errc()) {
            return fail("a number within range");
        }
        at_ = end;
        operand = number;
        return true;
    }
    if (isSigned) {
        at_ = first;
        return fail("a digit");
    }
    const auto found = name();
    if (!found) {
        return fail(expected);
    }
    operand = *found;
    return true;
}

/// One past the number that begins at `first`, or `first`: digits, and a fraction where digits follow its point. No
/// exponent, so that "8e-" stays a number and what follows it.
std::size_t VisualFormatParser::endOfNumber(std::size_t first) const {
    const auto pastDigits = [this](std::size_t at) {
        while (at < text_.size() && isDigit(text_[at])) {
            ++at;
        }
        return at;
    };
    const std::size_t whole = pastDigits(first);
    if (whole >= text_.size() || text_[whole] != '.') {
        return whole;
    }
    const std::size_t end = pastDigits(whole + 1);
    return end > whole + 1 ? end : whole;
}

bool VisualFormatParser::readView(Syntax::Item& item) {
    if (!skip("[")) {
        return fail("'['");
    }
    const auto found = name();
    if (!found) {
        return fail("a view's name");
    }
    item.view = *found;
    if (isNext('(')) {
        return readPredicates(item.sizes, "a number, a metric or a view's name") && (skip("]") || fail("']'"));
    }
    return skip("]") || fail("'(' or ']'");
}

std::optional<VisualFormatSyntax::Name> VisualFormatParser::name() {
    if (at_ >= text_.size() || !isNameStart(text_[at_])) {
        return std::nullopt;
    }
    const std::size_t begin = at_;
    while (at_ < text_.size() && (isNameStart(text_[at_]) || isDigit(text_[at_]))) {
        ++at_;
    }
    return Syntax::Name{text_.substr(begin, at_ - begin), begin};
}

}  // namespace ktr::platform
