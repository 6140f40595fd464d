#include "linux/net/TlsTrust.h"

#include <QSslCertificate>

#include "documents/FileReader.h"
#include "documents/FileTrust.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

/// The whole of a system's authorities is a fifth of this.
constexpr std::size_t kLargestFile = std::size_t{1} << 20;

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
            platform::platformLog().write(platform::LogLevel::Error, "certificates: %@: %@",
                                          platform::FormatArgument(file).shown(),
                                          platform::FormatArgument(reason).shown());
        }
        tls.addCaCertificates(certificates);
    }
    return tls;
}

}  // namespace ktr::linux_
