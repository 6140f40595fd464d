#pragma once

#include <openssl/evp.h>
#include <openssl/x509.h>

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <variant>

#include "serve/CertificateKind.h"

namespace ktr::serve {

/// The development service's own certificate authority, good for loopback alone (its name constraints allow "localhost"
/// and loopback addresses), kept in a private folder: "ca.pem", "ca-key.pem" (mode 0600), and "token", the app token of
/// the development account. Made when missing or about to expire. Any thread; it reads and writes the disk.
class DevelopmentCertificates {
  public:
    using Certificate = std::shared_ptr<X509>;
    using Key = std::shared_ptr<EVP_PKEY>;
    struct Pair {
        Certificate certificate;
        Key key;
    };

    /// The authority of this folder, or one line that says what failed.
    static std::variant<DevelopmentCertificates, std::string> prepare(const std::filesystem::path& folder);

    /// A certificate for "localhost", 127.0.0.1 and ::1, valid for a week. None when the library cannot make one.
    std::optional<Pair> makeServerCertificate(CertificateKind kind) const;
    std::filesystem::path authorityFile() const { return folder_ / "ca.pem"; }
    std::filesystem::path tokenFile() const { return folder_ / "token"; }
    const std::string& token() const { return token_; }

  private:
    DevelopmentCertificates() = default;

    std::filesystem::path folder_;
    Pair authority_;
    std::string token_;
};

}  // namespace ktr::serve
