#include "linux/net/TlsTrust.h"

#include <QHostAddress>
#include <QSslCertificate>
#include <QSslError>
#include <algorithm>

#include "documents/FileReader.h"
#include "documents/FileTrust.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// The whole of a system's authorities is a fifth of this.
constexpr std::size_t kLargestFile = std::size_t{1} << 20;

bool isNameFor(const QString& name, const QString& host) {
    if (!name.startsWith(QLatin1String("*."))) {
        return name.compare(host, Qt::CaseInsensitive) == 0;
    }
    const QString rest = name.mid(1);
    const auto dot = host.indexOf(u'.');
    // "*.org" would stand for everybody.
    return dot > 0 && rest.count(u'.') > 1 && rest.compare(host.mid(dot), Qt::CaseInsensitive) == 0;
}

const char* wordsFor(QSslError::SslError error) {
    switch (error) {
        case QSslError::CertificateExpired:
            return "its certificate has expired";
        case QSslError::CertificateNotYetValid:
            return "its certificate is not valid yet";
        case QSslError::HostNameMismatch:
            return "its certificate is for other names";
        case QSslError::SelfSignedCertificate:
            return "its certificate vouches for itself";
        case QSslError::SelfSignedCertificateInChain:
        case QSslError::UnableToGetIssuerCertificate:
        case QSslError::UnableToGetLocalIssuerCertificate:
        case QSslError::UnableToVerifyFirstCertificate:
        case QSslError::CertificateUntrusted:
            return "nobody who is trusted vouches for its certificate";
        case QSslError::InvalidPurpose:
            return "its certificate is not for servers";
        case QSslError::InvalidCaCertificate:
        case QSslError::PathLengthExceeded:
        case QSslError::AuthorityIssuerSerialNumberMismatch:
        case QSslError::SubjectIssuerMismatch:
            return "somebody vouches for its certificate who may not";
        case QSslError::CertificateSignatureFailed:
        case QSslError::UnableToDecryptCertificateSignature:
        case QSslError::UnableToDecodeIssuerPublicKey:
            return "its certificate was not signed by whom it names";
        case QSslError::CertificateRevoked:
        case QSslError::CertificateBlacklisted:
        case QSslError::CertificateRejected:
            return "its certificate is revoked";
        case QSslError::InvalidNotBeforeField:
        case QSslError::InvalidNotAfterField:
            return "its certificate has no legible dates";
        case QSslError::NoPeerCertificate:
            return "it shows no certificate";
        default:
            return nullptr;
    }
}

}  // namespace

QSslConfiguration TlsTrust::configuration(const std::vector<std::string>& certificateFiles) {
    QSslConfiguration tls = QSslConfiguration::defaultConfiguration();
    tls.setProtocol(QSsl::TlsV1_2OrLater);
    tls.setPeerVerifyMode(QSslSocket::VerifyPeer);
    // The system's authorities are in it already, each read when it is asked for: setting them would read all.
    for (const std::string& file : certificateFiles) {
        // Whoever can change it decides who is believed to be the account's host.
        const auto refusal = [&](const struct stat& facts) { return documents::FileTrust::problemOf(file, facts); };
        const auto read = documents::FileReader::read(file, {kLargestFile, refusal});
        const auto* text = std::get_if<std::string>(&read);
        const auto certificates = text == nullptr
                                      ? QList<QSslCertificate>()
                                      : QSslCertificate::fromData(QByteArray::fromStdString(*text), QSsl::Pem);
        if (certificates.isEmpty()) {
            const std::string reason =
                text != nullptr ? "it holds none in PEM" : std::get<documents::FileReader::Error>(read).reason;
            platform::areaLog(platform::LogArea::Net)
                .write(platform::LogLevel::Error, "certificates: %@: %@", platform::FormatArgument(file).shown(),
                       platform::FormatArgument(reason).shown());
        }
        tls.addCaCertificates(certificates);
    }
    return tls;
}

bool TlsTrust::isFor(const QSslCertificate& certificate, const Origin& origin) {
    const auto names = certificate.subjectAlternativeNames();
    const QString host = QString::fromStdString(origin.host);
    if (origin.isAddress()) {
        const auto addresses = names.values(QSsl::IpAddressEntry);
        return std::any_of(addresses.begin(), addresses.end(), [address = QHostAddress(host)](const QString& name) {
            return QHostAddress(name) == address;
        });
    }
    const auto hosts = names.values(QSsl::DnsEntry);
    return std::any_of(hosts.begin(), hosts.end(), [&host](const QString& name) { return isNameFor(name, host); });
}

std::string TlsTrust::reasonOf(const QList<QSslError>& errors) {
    std::string reason;
    for (const QSslError& error : errors) {
        const char* own = wordsFor(error.error());
        const std::string words = own != nullptr ? own : "its certificate: " + error.errorString().toStdString();
        if (reason.find(words) == std::string::npos) {
            reason += (reason.empty() ? "" : ", ") + words;
        }
    }
    return reason.empty() ? "it could not prove who it is" : reason;
}

}  // namespace ktr::linux_
