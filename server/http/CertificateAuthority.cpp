#include "server/http/CertificateAuthority.h"

#include <openssl/bio.h>
#include <openssl/ec.h>
#include <openssl/pem.h>
#include <openssl/rand.h>
#include <openssl/x509v3.h>
#include <sys/stat.h>

#include <cstdint>
#include <utility>
#include <variant>

#include "documents/AtomicFile.h"
#include "documents/FileReader.h"
#include "documents/FileTrust.h"

namespace ktr::server {

namespace {

using Pair = CertificateAuthority::Pair;
using Certificate = CertificateAuthority::Certificate;
using Key = CertificateAuthority::Key;
using Memory = std::unique_ptr<BIO, decltype(&BIO_free)>;

constexpr long kDay = 86400;
constexpr std::size_t kLargestFile = std::size_t{64} * 1024;

struct Outline {
    const char* name;
    const char* constraints;  ///< basicConstraints
    const char* usage;
    const char* extendedUsage = nullptr;
    const char* names = nullptr;  ///< subjectAltName
    const char* nameConstraints = nullptr;
    long validFrom = -kDay;
    long validTo = 7 * kDay;
};

bool addExtension(X509* certificate, X509* issuer, int kind, const char* text) {
    if (text == nullptr) {
        return true;
    }
    X509V3_CTX context;
    X509V3_set_ctx_nodb(&context);
    X509V3_set_ctx(&context, issuer, certificate, nullptr, nullptr, 0);
    X509_EXTENSION* extension = X509V3_EXT_conf_nid(nullptr, &context, kind, text);
    const bool added = extension != nullptr && X509_add_ext(certificate, extension, -1) == 1;
    X509_EXTENSION_free(extension);
    return added;
}

/// Signed by `issuer`; with none, by itself.
std::optional<Pair> makePair(const Outline& outline, const Pair* issuer) {
    Pair pair{Certificate(X509_new(), X509_free), Key(EVP_EC_gen("P-256"), EVP_PKEY_free)};
    X509* certificate = pair.certificate.get();
    if (certificate == nullptr || !pair.key) {
        return std::nullopt;
    }
    std::uint64_t serial = 0;
    bool made = RAND_bytes(reinterpret_cast<unsigned char*>(&serial), sizeof serial) == 1 &&
                X509_set_version(certificate, X509_VERSION_3) == 1 &&
                ASN1_INTEGER_set_uint64(X509_get_serialNumber(certificate), (serial >> 1U) + 1) == 1 &&
                X509_gmtime_adj(X509_getm_notBefore(certificate), outline.validFrom) != nullptr &&
                X509_gmtime_adj(X509_getm_notAfter(certificate), outline.validTo) != nullptr &&
                X509_set_pubkey(certificate, pair.key.get()) == 1;
    X509_NAME* name = X509_get_subject_name(certificate);
    made = made && X509_NAME_add_entry_by_txt(name, "CN", MBSTRING_UTF8,
                                              reinterpret_cast<const unsigned char*>(outline.name), -1, -1, 0) == 1;
    X509* signer = issuer == nullptr ? certificate : issuer->certificate.get();
    made = made && X509_set_issuer_name(certificate, X509_get_subject_name(signer)) == 1 &&
           addExtension(certificate, signer, NID_basic_constraints, outline.constraints) &&
           addExtension(certificate, signer, NID_key_usage, outline.usage) &&
           addExtension(certificate, signer, NID_ext_key_usage, outline.extendedUsage) &&
           addExtension(certificate, signer, NID_subject_alt_name, outline.names) &&
           addExtension(certificate, signer, NID_name_constraints, outline.nameConstraints) &&
           addExtension(certificate, signer, NID_subject_key_identifier, "hash") &&
           addExtension(certificate, signer, NID_authority_key_identifier, "keyid:always");
    EVP_PKEY* key = issuer == nullptr ? pair.key.get() : issuer->key.get();
    made = made && X509_sign(certificate, key, EVP_sha256()) > 0;
    return made ? std::optional(std::move(pair)) : std::nullopt;
}

std::string textOf(BIO* memory) {
    char* data = nullptr;
    const long size = BIO_get_mem_data(memory, &data);
    return size > 0 ? std::string(data, static_cast<std::size_t>(size)) : std::string();
}

/// Empty for what is not there; what others may change, or what cannot be read, is a problem.
std::string readFile(const std::filesystem::path& file, std::string& problem) {
    const auto refusal = [&](const struct stat& facts) { return documents::FileTrust::problemOf(file, facts); };
    auto read = documents::FileReader::read(file, {kLargestFile, refusal});
    if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
        problem = error->isMissing ? problem : file.string() + ": " + error->reason;
        return "";
    }
    return std::get<std::string>(std::move(read));
}

}  // namespace

std::optional<CertificateAuthority> CertificateAuthority::make(const std::string& name, const std::string& constraints,
                                                               long days) {
    Outline outline{name.c_str(), "critical,CA:TRUE,pathlen:0", "critical,keyCertSign,cRLSign"};
    outline.nameConstraints = constraints.c_str();
    outline.validTo = days * kDay;
    auto pair = makePair(outline, nullptr);
    return pair ? std::optional(CertificateAuthority(std::move(*pair))) : std::nullopt;
}

std::optional<CertificateAuthority> CertificateAuthority::read(const std::filesystem::path& folder,
                                                               std::string& problem) {
    const std::string certificateText = readFile(folder / "ca.pem", problem);
    const std::string keyText = readFile(folder / "ca-key.pem", problem);
    const Memory certificateMemory(BIO_new_mem_buf(certificateText.data(), static_cast<int>(certificateText.size())),
                                   BIO_free);
    const Memory keyMemory(BIO_new_mem_buf(keyText.data(), static_cast<int>(keyText.size())), BIO_free);
    Pair pair{Certificate(PEM_read_bio_X509(certificateMemory.get(), nullptr, nullptr, nullptr), X509_free),
              Key(PEM_read_bio_PrivateKey(keyMemory.get(), nullptr, nullptr, nullptr), EVP_PKEY_free)};
    if (!pair.certificate || !pair.key || X509_check_private_key(pair.certificate.get(), pair.key.get()) != 1) {
        return std::nullopt;
    }
    int days = 0;
    int seconds = 0;
    if (ASN1_TIME_diff(&days, &seconds, nullptr, X509_get0_notAfter(pair.certificate.get())) != 1 || days < 2) {
        return std::nullopt;
    }
    return CertificateAuthority(std::move(pair));
}

std::string CertificateAuthority::write(const std::filesystem::path& folder) const {
    const Memory certificate(BIO_new(BIO_s_mem()), BIO_free);
    const Memory key(BIO_new(BIO_s_mem()), BIO_free);
    if (PEM_write_bio_X509(certificate.get(), pair_.certificate.get()) != 1 ||
        PEM_write_bio_PrivateKey(key.get(), pair_.key.get(), nullptr, nullptr, 0, nullptr, nullptr) != 1) {
        return "the certificates cannot be written as PEM";
    }
    if (auto failure = documents::AtomicFile::write(folder / "ca-key.pem", textOf(key.get()), 0600); !failure.empty()) {
        return failure;
    }
    return documents::AtomicFile::write(folder / "ca.pem", textOf(certificate.get()), 0644);
}

std::optional<Pair> CertificateAuthority::issue(const Terms& terms) const {
    Outline outline{terms.name.c_str(), "critical,CA:FALSE", "critical,digitalSignature"};
    outline.extendedUsage = "serverAuth";
    outline.names = terms.alternatives.c_str();
    outline.validFrom = terms.firstDay * kDay;
    outline.validTo = terms.lastDay * kDay;
    return makePair(outline, &pair_);
}

}  // namespace ktr::server
