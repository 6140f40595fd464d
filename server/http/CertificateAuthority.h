#pragma once

#include <openssl/evp.h>
#include <openssl/x509.h>

#include <filesystem>
#include <memory>
#include <optional>
#include <string>

namespace ktr::server {

/// A certificate authority of one's own in a private folder: "ca.pem" and "ca-key.pem" (mode 0600). Any thread.
class CertificateAuthority {
  public:
    using Certificate = std::shared_ptr<X509>;
    using Key = std::shared_ptr<EVP_PKEY>;
    struct Pair {
        Certificate certificate;
        Key key;
    };
    /// What a server's certificate says.
    struct Terms {
        std::string name;
        std::string alternatives;  ///< such as "DNS:localhost,IP:127.0.0.1"
        long firstDay = -1;        ///< from today
        long lastDay = 7;
    };

    /// An authority for nothing but what `constraints` permits ("critical,permitted;DNS:localhost"). None when the
    /// library cannot make one.
    static std::optional<CertificateAuthority> make(const std::string& name, const std::string& constraints, long days);
    /// The one that lies in the folder, when it is whole and good for two more days. Files that others may change, or
    /// that cannot be read, are a problem.
    static std::optional<CertificateAuthority> read(const std::filesystem::path& folder, std::string& problem);
    /// Empty when done, else what failed.
    std::string write(const std::filesystem::path& folder) const;

    /// A certificate for a server, with a key of its own. None when the library cannot make one.
    std::optional<Pair> issue(const Terms& terms) const;

  private:
    explicit CertificateAuthority(Pair pair) : pair_(std::move(pair)) {}

    Pair pair_;
};

}  // namespace ktr::server
