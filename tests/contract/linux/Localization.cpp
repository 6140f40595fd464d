#include <QByteArray>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include "linux/locale/QtLocalization.h"
#include "tests/contract/LocalizationContract.h"

namespace ktr::test {

namespace {

/// Keeps its compiled texts on disk as long as it lives.
struct CompiledLocalization : linux_::QtLocalization {
    CompiledLocalization() : QtLocalization("de-AT") {}
    QTemporaryDir folder;
};

std::shared_ptr<platform::Localization> compiled(const LocalizationTexts& texts) {
    auto made = std::make_shared<CompiledLocalization>();
    for (const auto& [language, entries] : texts) {
        std::string source = R"(<?xml version="1.0" encoding="utf-8"?><!DOCTYPE TS><TS version="2.1" language=")" +
                             language + R"("><context><name>Localizable</name>)";
        for (const auto& [key, text] : entries) {
            source += "<message><source>" + QString::fromStdString(key).toHtmlEscaped().toStdString() +
                      "</source><translation>" + text + "</translation></message>";
        }
        source += "</context></TS>";
        const QString base = made->folder.filePath(QString::fromStdString("texts_" + language));
        QFile file(base + QLatin1String(".ts"));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(QByteArray::fromStdString(source));
        file.close();
        EXPECT_EQ(QProcess::execute(QStringLiteral(KTR_LRELEASE), {QStringLiteral("-silent"), file.fileName(),
                                                                   QStringLiteral("-qm"), base + QLatin1String(".qm")}),
                  0);
    }
    EXPECT_TRUE(made->addBundle("org.example", made->folder.path().toStdString(), "texts"));
    return made;
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(QtLocalization, LocalizationContract,
                         ::testing::Values(LocalizationCase{"QtLocalization", compiled}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
