#include "server/http/TlsContext.h"

#include <openssl/err.h>

#include <cstring>

namespace ktr::server {

namespace {

/// We speak one protocol; a client that asks for others as well is told so.
int chooseProtocol(SSL*, const unsigned char** chosen, unsigned char* length, const unsigned char* offered,
                   unsigned int offeredLength, void*) {
    static constexpr unsigned char kOurs[] = "\x08http/1.1";
    unsigned char* found = nullptr;
    if (SSL_select_next_proto(&found, length, kOurs, sizeof kOurs - 1, offered, offeredLength) !=
        OPENSSL_NPN_NEGOTIATED) {
        return SSL_TLSEXT_ERR_NOACK;
    }
    *chosen = found;
    return SSL_TLSEXT_ERR_OK;
}

TlsContext::Context makeEmpty() {
    TlsContext::Context context(SSL_CTX_new(TLS_server_method()), SSL_CTX_free);
    if (!context || SSL_CTX_set_min_proto_version(context.get(), TLS1_2_VERSION) != 1) {
        return nullptr;
    }
    SSL_CTX_set_options(context.get(), SSL_OP_NO_RENEGOTIATION | SSL_OP_NO_COMPRESSION | SSL_OP_IGNORE_UNEXPECTED_EOF);
    SSL_CTX_set_session_cache_mode(context.get(), SSL_SESS_CACHE_OFF);
    // A thousand resting phones keep a thousand connections: 19 kB each instead of 70.
    SSL_CTX_set_mode(context.get(),
                     SSL_MODE_RELEASE_BUFFERS | SSL_MODE_ENABLE_PARTIAL_WRITE | SSL_MODE_ACCEPT_MOVING_WRITE_BUFFER);
    SSL_CTX_set_alpn_select_cb(context.get(), chooseProtocol, nullptr);
    return context;
}

}  // namespace

TlsContext::Context TlsContext::make(X509* certificate, EVP_PKEY* key) {
    Context context = makeEmpty();
    const bool usable = context && SSL_CTX_use_certificate(context.get(), certificate) == 1 &&
                        SSL_CTX_use_PrivateKey(context.get(), key) == 1;
    ERR_clear_error();
    return usable ? context : nullptr;
}

TlsContext::Context TlsContext::read(const std::string& certificateFile, const std::string& keyFile,
                                     std::string& complaint) {
    Context context = makeEmpty();
    if (!context) {
        complaint = "TLS cannot be used";
    } else if (SSL_CTX_use_certificate_chain_file(context.get(), certificateFile.c_str()) != 1) {
        complaint = certificateFile + ": no certificate can be read from it";
    } else if (SSL_CTX_use_PrivateKey_file(context.get(), keyFile.c_str(), SSL_FILETYPE_PEM) != 1) {
        complaint = keyFile + ": no key of that certificate can be read from it";
    }
    ERR_clear_error();
    return complaint.empty() ? context : nullptr;
}

}  // namespace ktr::server
