#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <variant>

#include "serve/CertificateKind.h"
#include "server/http/CertificateAuthority.h"

namespace ktr::serve {

/// The development service's own certificate authority, good for loopback alone (its name constraints allow "localhost"
/// and loopback addresses), kept in a private folder: "ca.pem", "ca-key.pem" (mode 0600), and "token", the app token of
/// the development account. Made when missing or about to expire. Any thread; it reads and writes the disk.
class DevelopmentCertificates {
  public:
    using Pair = server::CertificateAuthority::Pair;

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
    std::optional<server::CertificateAuthority> authority_;
    std::string token_;
};

}  // namespace ktr::serve
