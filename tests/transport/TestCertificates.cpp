#include "tests/transport/TestCertificates.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QProcess>

namespace ktr::test {

namespace {

QString text(const char* latin1) {
    return QString::fromLatin1(latin1);
}

void write(const QString& path, const char* content) {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(content);
}

}  // namespace

TestCertificates::TestCertificates() {
    write(file("server.ext"), "subjectAltName=DNS:localhost,IP:127.0.0.1\nextendedKeyUsage=serverAuth\n");
    write(file("wrong.ext"), "subjectAltName=DNS:other.example\nextendedKeyUsage=serverAuth\n");
    write(file("client.ext"), "subjectAltName=DNS:localhost,IP:127.0.0.1\nextendedKeyUsage=clientAuth\n");
    write(file("nonames.ext"), "extendedKeyUsage=serverAuth\n");
    write(file("names.ext"), "subjectAltName=DNS:localhost\nextendedKeyUsage=serverAuth\n");
    write(file("addresses.ext"), "subjectAltName=IP:127.0.0.1\nextendedKeyUsage=serverAuth\n");
    write(file("text.ext"), "subjectAltName=DNS:127.0.0.1\nextendedKeyUsage=serverAuth\n");
    authorityNamed("ca");
    authorityNamed("other");
    openssl({text("ecparam"), text("-name"), text("prime256v1"), text("-genkey"), text("-noout"), text("-out"), key()});
    openssl({text("req"), text("-new"), text("-key"), key(), text("-subj"), text("/CN=localhost"), text("-out"),
             file("server.csr")});
    // A name in the subject counts as well.
    openssl({text("req"), text("-new"), text("-key"), key(), text("-subj"), text("/CN=other.example"), text("-out"),
             file("wrong.csr")});
    const QStringList month{text("-days"), text("30")};
    signedBy("ca", "good", "server.ext", month);
    signedBy("ca", "expired", "server.ext", {text("-days"), text("-1")});
    signedBy("ca", "wrongname", "wrong.ext", month, "wrong.csr");
    signedBy("ca", "client", "client.ext", month);
    signedBy("ca", "subject", "wrong.ext", month);
    signedBy("ca", "nonames", "nonames.ext", month);
    signedBy("ca", "names", "names.ext", month);
    signedBy("ca", "addresses", "addresses.ext", month);
    signedBy("ca", "text", "text.ext", month);
    signedBy("other", "foreign", "server.ext", month);
    openssl({text("req"), text("-x509"), text("-key"), key(), text("-subj"), text("/CN=localhost"), text("-days"),
             text("30"), text("-addext"), text("subjectAltName=DNS:localhost,IP:127.0.0.1"), text("-out"),
             file("selfsigned.pem")});
}

void TestCertificates::openssl(const QStringList& arguments) const {
    QProcess process;
    process.setProcessChannelMode(QProcess::MergedChannels);
    process.start(text("openssl"), arguments);
    ASSERT_TRUE(process.waitForFinished()) << "openssl is missing";
    ASSERT_EQ(process.exitCode(), 0) << process.readAll().toStdString();
}

void TestCertificates::authorityNamed(const char* name) const {
    const QString stem = text(name);
    const QString keyFile = file(stem + text(".key"));
    openssl(
        {text("ecparam"), text("-name"), text("prime256v1"), text("-genkey"), text("-noout"), text("-out"), keyFile});
    openssl({text("req"), text("-x509"), text("-new"), text("-key"), keyFile, text("-subj"),
             text("/CN=Test authority ") + stem, text("-days"), text("30"), text("-addext"),
             text("keyUsage=critical,keyCertSign"), text("-out"), file(stem + text(".pem"))});
}

void TestCertificates::signedBy(const char* authority, const char* kind, const char* extension,
                                const QStringList& validity, const char* asked) const {
    const QString stem = text(authority);
    openssl(QStringList{text("x509"), text("-req"), text("-in"), file(asked), text("-CA"), file(stem + text(".pem")),
                        text("-CAkey"), file(stem + text(".key")), text("-CAcreateserial"), text("-extfile"),
                        file(extension), text("-out"), file(text(kind) + text(".pem"))} +
            validity);
}

}  // namespace ktr::test
