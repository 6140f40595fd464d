#pragma once

#include <openssl/ssl.h>

#include <cstddef>
#include <memory>
#include <string_view>

namespace ktr::server {

/// The bytes of one accepted connection, with TLS or without. It never waits: what cannot be done now says what to wait
/// for. It does not own the descriptor. One thread at a time.
class ByteSocket {
  public:
    enum class Result {
        Some,        ///< `count` bytes
        WaitToRead,  ///< try again when the descriptor can be read
        WaitToWrite,
        End,  ///< the other side has ended, or failed
    };
    struct Outcome {
        Result result = Result::End;
        std::size_t count = 0;
    };

    /// `descriptor` does not block. Without a context: without TLS.
    ByteSocket(int descriptor, SSL_CTX* context);

    /// Also makes the TLS connection first.
    Outcome read(char* to, std::size_t room);
    Outcome write(std::string_view bytes);
    /// Tells the other side that nothing follows; it may still send.
    void endWriting();
    /// What is under way is lost on both sides.
    void reset();

  private:
    Outcome tlsOutcome(int result);

    int descriptor_;
    std::unique_ptr<SSL, decltype(&SSL_free)> tls_;
};

}  // namespace ktr::server
