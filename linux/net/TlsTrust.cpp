#include "linux/net/TlsTrust.h"

#include <QSslCertificate>

#include "platform/base/Log.h"

namespace ktr::linux_ {

QSslConfiguration TlsTrust::configuration(const std::vector<std::string>& certificateFiles) {
    QSslConfiguration tls = QSslConfiguration::defaultConfiguration();
    tls.setProtocol(QSsl::TlsV1_2OrLater);
    tls.setPeerVerifyMode(QSslSocket::VerifyPeer);
    // The system's authorities are in it already, each read when it is asked for: setting them would read all.
    for (const std::string& file : certificateFiles) {
        const auto certificates = QSslCertificate::fromPath(QString::fromStdString(file), QSsl::Pem);
        if (certificates.isEmpty()) {
            platform::platformLog().write(platform::LogLevel::Error, "No certificate can be read from %@", file);
        }
        tls.addCaCertificates(certificates);
    }
    return tls;
}

}  // namespace ktr::linux_
