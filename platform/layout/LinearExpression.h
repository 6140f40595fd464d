#pragma once

#include <cstdint>
#include <vector>

namespace ktr::platform {

/// Names a variable of one Solver (and of its copies).
using VariableId = std::uint32_t;

/// coefficient * variable.
struct Term {
    VariableId variable = 0;
    double coefficient = 1.0;
};

/// A sum of terms and a constant. A variable may occur in several terms; they add up.
class LinearExpression {
  public:
    LinearExpression() = default;
    LinearExpression(double constant) : constant_(constant) {}  // NOLINT: a number is an expression
    LinearExpression(Term term) : terms_{term} {}               // NOLINT: so is a term
    static LinearExpression of(VariableId variable) { return Term{variable, 1.0}; }

    const std::vector<Term>& terms() const { return terms_; }
    double constant() const { return constant_; }

    LinearExpression& operator+=(const LinearExpression& other) {
        terms_.insert(terms_.end(), other.terms_.begin(), other.terms_.end());
        constant_ += other.constant_;
        return *this;
    }
    LinearExpression& operator*=(double factor) {
        for (Term& term : terms_) {
            term.coefficient *= factor;
        }
        constant_ *= factor;
        return *this;
    }
    friend LinearExpression operator+(LinearExpression a, const LinearExpression& b) { return a += b; }
    friend LinearExpression operator-(LinearExpression a, LinearExpression b) { return a += (b *= -1.0); }
    friend LinearExpression operator*(double factor, LinearExpression a) { return a *= factor; }

  private:
    std::vector<Term> terms_;
    double constant_ = 0.0;
};

}  // namespace ktr::platform
