#include "serve/DevelopmentCertificates.h"

#include "documents/AtomicFile.h"
#include "documents/FileLock.h"
#include "documents/FileSteps.h"
#include "documents/FileTrust.h"
#include "linux/configuration/TokenFile.h"
#include "server/store/Secret.h"

namespace ktr::serve {

namespace {

using server::CertificateAuthority;

std::optional<CertificateAuthority> makeAuthority() {
    // A key that leaks must not speak for anything but loopback.
    return CertificateAuthority::make("ktr development authority",
                                      "critical,permitted;DNS:localhost,permitted;IP:127.0.0.0/255.0.0.0,"
                                      "permitted;IP:0:0:0:0:0:0:0:1/FFFF:FFFF:FFFF:FFFF:FFFF:FFFF:FFFF:FFFF",
                                      30);
}

}  // namespace

std::variant<DevelopmentCertificates, std::string> DevelopmentCertificates::prepare(
    const std::filesystem::path& folder) {
    if (auto failure = documents::AtomicFile::makeFolder(folder); !failure.empty()) {
        return failure;
    }
    // Whoever can change what lies here decides whom the configurations that name it trust.
    if (const auto problem = documents::FileTrust::problemOfFolder(folder); !problem.empty()) {
        return folder.string() + ": the folder is refused: " + problem;
    }
    // Two services that start together agree on one authority.
    const documents::FileLock lock(folder / "lock");
    if (!lock.isHeld()) {
        return folder.string() + ": cannot be locked: " + lock.problem();
    }
    DevelopmentCertificates certificates;
    certificates.folder_ = documents::FileSteps::absolute(folder).lexically_normal();
    std::string problem;
    auto authority = CertificateAuthority::read(folder, problem);
    if (!problem.empty()) {
        return problem;
    }
    if (authority) {
        certificates.authority_ = *authority;
    } else {
        authority = makeAuthority();
        if (!authority) {
            return std::string("the certificate authority cannot be made");
        }
        if (auto failure = authority->write(folder); !failure.empty()) {
            return failure;
        }
        certificates.authority_ = *authority;
    }
    const auto token = linux_::TokenFile::read(certificates.tokenFile());
    if (const auto* known = std::get_if<std::string>(&token)) {
        certificates.token_ = *known;
        return certificates;
    }
    if (const auto& error = std::get<linux_::TokenFile::Error>(token); !error.missing) {
        return error.text;
    }
    certificates.token_ = server::Secret::make().value_or("");
    if (certificates.token_.empty()) {
        return std::string("the system gives no random numbers for a token");
    }
    if (auto failure = documents::AtomicFile::write(certificates.tokenFile(), certificates.token_ + "\n", 0600);
        !failure.empty()) {
        return failure;
    }
    return certificates;
}

std::optional<DevelopmentCertificates::Pair> DevelopmentCertificates::makeServerCertificate(
    CertificateKind kind) const {
    CertificateAuthority::Terms terms{"ktr serve", "DNS:localhost,IP:127.0.0.1,IP:0:0:0:0:0:0:0:1"};
    switch (kind) {
        case CertificateKind::Good:
            break;
        case CertificateKind::Expired:
            terms.firstDay = -3;
            terms.lastDay = -1;
            break;
        case CertificateKind::WrongHost:
            terms.alternatives = "DNS:elsewhere.localhost";
            break;
        case CertificateKind::Foreign:
            const auto stranger = makeAuthority();
            return stranger ? stranger->issue(terms) : std::nullopt;
    }
    return authority_->issue(terms);
}

}  // namespace ktr::serve
