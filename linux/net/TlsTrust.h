#pragma once

#include <QSslConfiguration>
#include <string>
#include <vector>

namespace ktr::linux_ {

/// What every connection of this program demands of the other side: TLS 1.2 or newer and a certificate that the system,
/// or one of the given files, vouches for. Nothing switches that off. Any thread; it reads the disk.
class TlsTrust {
  public:
    /// `certificateFiles` (PEM) are trusted besides the system's. One that cannot be read is an error line in the log.
    static QSslConfiguration configuration(const std::vector<std::string>& certificateFiles);
};

}  // namespace ktr::linux_
