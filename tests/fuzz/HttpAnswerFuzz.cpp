// Any bytes as an answer of HTTP, in pieces: the parser ends, keeps little, and what it takes for an answer has one.
#include <cstdint>
#include <string_view>

#include "linux/net/AnswerParser.h"
#include "tests/fuzz/Require.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using ktr::fuzz::require;
    using ktr::linux_::AnswerParser;
    constexpr std::size_t kMost = 1000;
    if (size == 0) {
        return 0;
    }
    // The first byte says how large the pieces are.
    const std::size_t piece = data[0] == 0 ? size : data[0];
    std::string_view rest(reinterpret_cast<const char*>(data) + 1, size - 1);
    AnswerParser parser(kMost);
    while (!rest.empty() && parser.state() == AnswerParser::State::Incomplete) {
        parser.feed(rest.substr(0, piece));
        rest.remove_prefix(piece < rest.size() ? piece : rest.size());
    }
    if (parser.end() == AnswerParser::State::Whole) {
        const int status = parser.status();
        require(status >= 200 && status <= 999, "an answer has a final status");
        require(parser.trouble().empty(), "nothing is wrong with it");
        require(parser.takeBody().size() <= kMost, "no body is beyond the limit");
        parser.field("Location");
    } else {
        require(!parser.trouble().empty(), "what is no answer is said to be none");
    }
    return 0;
}
