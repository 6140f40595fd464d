#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

#include "server/http/HttpLimits.h"
#include "server/http/HttpRequest.h"

namespace ktr::server {

/// Makes requests of the bytes of one connection, however they are cut. Whatever two readers of HTTP could understand
/// differently is refused: a length beside chunks, two lengths, folded lines, a line that ends with LF alone, blanks
/// before a colon, any coding but chunks, packed bodies, a target that is no path, no Host or two. Trailers are read
/// and dropped. No network; one thread at a time.
class RequestReader {
  public:
    enum class State {
        Header,   ///< more is needed
        Body,     ///< the header is whole, more is needed
        Done,     ///< a request is whole
        Refused,  ///< the connection has to end: what follows could mean anything
    };

    explicit RequestReader(const HttpLimits& limits);
    ~RequestReader();
    RequestReader(const RequestReader&) = delete;
    RequestReader& operator=(const RequestReader&) = delete;

    /// Takes more bytes. Not in `Done`.
    State feed(std::string_view bytes);
    /// After `Done`: begins the next request with what came behind the last one.
    State next();
    State state() const { return state_; }
    /// In `Header`: whether a byte of the request has come.
    bool begun() const { return !waiting_.empty(); }
    /// In `Body`: whether the client waits to be told to go on (RFC 9110, 10.1.1).
    bool wantsContinue() const;
    /// In `Done`: the request, without its peer; once. In `Refused` with the status 413: its header.
    HttpRequest take();
    /// In `Done`: whether the client may send another one.
    bool keepsAlive() const;
    /// In `Refused`: the status, and a sentence for the client.
    int status() const { return status_; }
    const std::string& complaint() const { return complaint_; }

  private:
    struct Parser;
    State readHeader();
    State readBody();
    State checkHeader();
    State refuse(int status, std::string complaint);

    const HttpLimits limits_;
    std::string waiting_;      ///< came, and is not read
    std::size_t scanned_ = 0;  ///< so much of `waiting_` is known to hold no end of a header
    std::size_t bodyBytes_ = 0;
    std::unique_ptr<Parser> parser_;
    HttpRequest request_;
    State state_ = State::Header;
    int status_ = 0;
    std::string complaint_;
};

}  // namespace ktr::server
