#include "server/http/ByteSocket.h"

#include <openssl/err.h>
#include <sys/socket.h>

#include <algorithm>
#include <cerrno>
#include <limits>

namespace ktr::server {

namespace {

int fitting(std::size_t size) {
    return static_cast<int>(std::min<std::size_t>(size, std::numeric_limits<int>::max()));
}

ByteSocket::Outcome plainOutcome(ssize_t count, ByteSocket::Result wait) {
    if (count > 0) {
        return {ByteSocket::Result::Some, static_cast<std::size_t>(count)};
    }
    const bool later = count < 0 && (errno == EAGAIN || errno == EWOULDBLOCK);
    return {later ? wait : ByteSocket::Result::End, 0};
}

}  // namespace

ByteSocket::ByteSocket(int descriptor, SSL_CTX* context)
    : descriptor_(descriptor), tls_(context == nullptr ? nullptr : SSL_new(context), SSL_free) {
    if (tls_) {
        SSL_set_fd(tls_.get(), descriptor);
        SSL_set_accept_state(tls_.get());
    }
}

ByteSocket::Outcome ByteSocket::tlsOutcome(int result) {
    if (result > 0) {
        return {Result::Some, static_cast<std::size_t>(result)};
    }
    const int error = SSL_get_error(tls_.get(), result);
    ERR_clear_error();
    return {error == SSL_ERROR_WANT_READ    ? Result::WaitToRead
            : error == SSL_ERROR_WANT_WRITE ? Result::WaitToWrite
                                            : Result::End,
            0};
}

ByteSocket::Outcome ByteSocket::read(char* to, std::size_t room) {
    if (tls_) {
        ERR_clear_error();
        return tlsOutcome(SSL_read(tls_.get(), to, fitting(room)));
    }
    ssize_t count = 0;
    do {
        count = ::recv(descriptor_, to, room, 0);
    } while (count < 0 && errno == EINTR);
    return plainOutcome(count, Result::WaitToRead);
}

ByteSocket::Outcome ByteSocket::write(std::string_view bytes) {
    if (tls_) {
        ERR_clear_error();
        return tlsOutcome(SSL_write(tls_.get(), bytes.data(), fitting(bytes.size())));
    }
    ssize_t count = 0;
    do {
        count = ::send(descriptor_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
    } while (count < 0 && errno == EINTR);
    return plainOutcome(count, Result::WaitToWrite);
}

void ByteSocket::endWriting() {
    if (tls_) {
        SSL_shutdown(tls_.get());
        ERR_clear_error();
    }
    ::shutdown(descriptor_, SHUT_WR);
}

void ByteSocket::reset() {
    const linger atOnce{1, 0};
    ::setsockopt(descriptor_, SOL_SOCKET, SO_LINGER, &atOnce, sizeof atOnce);
}

}  // namespace ktr::server
