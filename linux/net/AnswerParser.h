#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace ktr::linux_ {

/// Reads one answer of HTTP/1.1 (RFC 9112) from the bytes of a connection, strictly and with little memory, whatever
/// comes. Interim answers such as 103 Early Hints (RFC 8297) are passed over.
class AnswerParser {
  public:
    enum class State {
        Incomplete,
        Whole,
        Broken,    ///< no HTTP, or cut off
        TooLarge,  ///< beyond one of the limits
    };
    /// Bytes of a status line, of a block of header fields, of a line that announces a chunk, and of the fields behind
    /// the last chunk: each of them.
    static constexpr std::size_t kLargestHead = std::size_t{32} * 1024;
    static constexpr std::size_t kMostFields = 200;
    static constexpr int kMostInterimAnswers = 8;

    /// `maximumBytes`: of the body.
    explicit AnswerParser(std::size_t maximumBytes);
    ~AnswerParser();
    AnswerParser(const AnswerParser&) = delete;
    AnswerParser& operator=(const AnswerParser&) = delete;

    /// More bytes of the connection. What follows a whole answer is not read.
    State feed(std::string_view bytes);
    /// The connection has ended, which may be how the answer ends.
    State end();

    State state() const { return state_; }
    /// What is wrong, in words for a log line; empty unless broken or too large.
    const std::string& trouble() const { return trouble_; }
    /// Of a whole answer.
    int status() const;
    /// The value of the first field of this name in any case; empty without one.
    std::string field(std::string_view name) const;
    std::string takeBody();
    /// What has come of the body of an answer with status 200 and has not been taken yet, before it is whole.
    std::string takePiece();

  private:
    struct Parser;
    void restart();
    State give(State state, const char* trouble);
    /// Looks at the header of the answer once it is there.
    void headArrived();

    std::size_t maximumBytes_;
    std::unique_ptr<Parser> parser_;
    std::string pending_;  ///< what the parser has not taken yet
    int interimAnswers_ = 0;
    bool headIsChecked_ = false;
    State state_ = State::Incomplete;
    std::string trouble_;
};

}  // namespace ktr::linux_
