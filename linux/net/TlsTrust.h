#pragma once

#include <QList>
#include <QSslConfiguration>
#include <string>
#include <vector>

#include "linux/net/Origin.h"

class QSslCertificate;
class QSslError;

namespace ktr::linux_ {

/// What every connection of this program demands of the other side: TLS 1.2 or newer and a certificate that the system,
/// or one of the given files, vouches for, and that is made out to the host. Nothing switches that off. Any thread.
class TlsTrust {
  public:
    /// `certificateFiles` (PEM) are trusted besides the system's. One that cannot be read is an error line in the log.
    /// It reads the disk.
    static QSslConfiguration configuration(const std::vector<std::string>& certificateFiles);

    /// Whether the certificate's alternative names hold the host (RFC 6125, section 6.4; RFC 9525: a name in the
    /// subject is none). "*" stands for one whole label, the first; an address has to be there as an address.
    static bool isFor(const QSslCertificate& certificate, const Origin& origin);

    /// What is wrong with a certificate, in words for a log line; the chain's names are not in it.
    static std::string reasonOf(const QList<QSslError>& errors);
};

}  // namespace ktr::linux_
