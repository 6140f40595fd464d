#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>
#include <utility>
#include <variant>
#include <vector>

#include "ask/FoldedText.h"
#include "ask/Language.h"
#include "ask/Person.h"

namespace ktr::ask {

/// Finds people by what somebody calls them: whole name, first or last name, nickname, e-mail address, phone number, a
/// relative's word ("mum"), in the forms that the language gives names. Never guesses: what fits two people names both,
/// and what is only near is offered, not taken. Any thread.
class People {
  public:
    /// Each person once: entries of one name that share a handle are one.
    explicit People(std::vector<Person> people);
    ~People();
    People(const People&) = delete;
    People& operator=(const People&) = delete;

    const std::vector<Person>& all() const { return people_; }

    /// Nobody has this name; those whose names are nearest, at most three.
    struct Unknown {
        std::string name;  ///< as it was written
        std::vector<std::size_t> near;
    };
    /// Several have it.
    struct Ambiguous {
        std::string name;
        std::vector<std::size_t> people;
    };
    /// Everybody who is named, each once, in the order of the text.
    using Found = std::vector<std::size_t>;
    using Result = std::variant<Found, Ambiguous, Unknown>;

    /// Who a text names: one, or several with the language's "and" between them. `chosen`: a handle; of several who
    /// have a name, the one with this handle is meant.
    Result find(const std::string& text, const Language& language, const std::string& chosen = {}) const;

    static constexpr std::size_t kMostNear = 3;
    static constexpr std::size_t kMostNamed = 50;  ///< people in one question

  private:
    using Numbers = std::vector<std::size_t>;

    void add(const std::u32string& name, std::size_t person);
    void addNames(std::size_t person);
    /// Everybody whom exactly this calls so; none for nobody.
    Numbers called(const std::u32string& name, const Language& language) const;
    Numbers inItsOwnForm(const std::u32string& name) const;
    Numbers byNumber(const std::u32string& name) const;
    Numbers relatives(const std::u32string& name, const Language& language) const;
    /// By how names sound in Latin letters, when the scripts differ.
    Numbers transliterated(const std::u32string& name) const;
    bool findSome(const std::u32string& text, std::size_t begin, std::size_t end, const Language& language,
                  std::size_t left, std::vector<std::pair<std::size_t, std::size_t>>& pieces) const;
    Unknown unknownIn(const FoldedText& folded, std::size_t begin, const Language& language) const;
    Numbers near(const std::u32string& name) const;

    std::vector<Person> people_;
    std::map<std::u32string, Numbers> byName_;
    std::map<std::string, std::size_t> byDigits_;
    struct Latin;
    mutable std::unique_ptr<Latin> latin_;
    mutable std::once_flag latinOnce_;
};

}  // namespace ktr::ask
