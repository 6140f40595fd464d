#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace ktr::ask {

/// A sentence template as it is written (docs/asking.md): words, "[optional]", "(one|other)", "{slot}", "<rule>". Any
/// thread.
class Template {
  public:
    /// A part, and what it is made of.
    struct Part {
        enum class Kind {
            Words,         ///< `text`: folded letters, blanks as they were written
            Sequence,      ///< all `parts`, one after the other
            Alternatives,  ///< one of `parts`
            Slot,          ///< whatever stands there, called `name`
            Rule,          ///< what the rule called `name` says
        };
        Kind kind = Kind::Sequence;
        std::u32string text = {};
        std::string name = {};
        std::vector<Part> parts = {};
    };
    struct Error {
        std::size_t column = 1;  ///< in bytes, from 1
        std::string message;
    };

    static constexpr std::size_t kLongest = 4000;  ///< bytes
    static constexpr std::size_t kDeepest = 16;    ///< nesting

    /// What is wrong with it is an error; never throws, whatever the text.
    static std::variant<Part, Error> read(std::string_view text);
};

}  // namespace ktr::ask
