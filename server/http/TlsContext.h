#pragma once

#include <openssl/ssl.h>

#include <memory>
#include <string>

namespace ktr::server {

/// What the edge proves itself with: TLS 1.2 or newer, without renegotiation and without kept sessions. Any thread.
class TlsContext {
  public:
    using Context = std::shared_ptr<SSL_CTX>;

    /// None when the two do not belong together or the library refuses them.
    static Context make(X509* certificate, EVP_PKEY* key);
    /// From files in PEM: the certificate with those that lead to its authority, and the key. None, with the reason in
    /// `complaint`, when they cannot be used.
    static Context read(const std::string& certificateFile, const std::string& keyFile, std::string& complaint);
};

}  // namespace ktr::server
