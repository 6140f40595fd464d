#pragma once

#include <QString>
#include <QStringList>
#include <QTemporaryDir>

namespace ktr::test {

/// Certificates made for one run, by the openssl program: an authority, and what a server can show. Names "localhost"
/// and 127.0.0.1 unless it says otherwise.
class TestCertificates {
  public:
    /// Fails the test when the program does.
    TestCertificates();

    QString authority() const { return file("ca.pem"); }
    /// Another one, that signed "foreign".
    QString otherAuthority() const { return file("other.pem"); }
    /// "good", "expired", "wrongname" (other.example alone), "foreign", "selfsigned",
    /// "client" (not for servers); "subject" (localhost in the subject, other.example as the alternative name),
    /// "nonames" (localhost in the subject alone), "names" (localhost alone), "addresses" (127.0.0.1 alone), "text"
    /// (127.0.0.1 as if it were a name).
    QString certificate(const char* kind) const { return file(QString::fromLatin1(kind) + QStringLiteral(".pem")); }
    QString key() const { return file("server.key"); }

  private:
    QString file(const QString& name) const { return folder_.filePath(name); }
    QString file(const char* name) const { return file(QString::fromLatin1(name)); }
    void openssl(const QStringList& arguments) const;
    void authorityNamed(const char* name) const;
    void signedBy(const char* authority, const char* kind, const char* extension, const QStringList& validity,
                  const char* asked = "server.csr") const;

    QTemporaryDir folder_;
};

}  // namespace ktr::test
