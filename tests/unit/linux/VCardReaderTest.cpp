#include "linux/contacts/VCardReader.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <QFile>
#include <QImage>
#include <QTemporaryDir>

#include "tests/support/qt/Pictures.h"

namespace ktr::linux_ {

namespace {

using platform::Bytes;
using platform::LabeledText;

class VCardReaderTest : public ::testing::Test {
  protected:
    VCardReader::Result read(const std::string& text) { return reader.readText(text, "people.vcf"); }
    /// The only contact of a card with these lines between its frame.
    std::shared_ptr<platform::Contact> one(const std::string& lines) {
        const auto result = read("BEGIN:VCARD\r\n" + lines + "END:VCARD\r\n");
        EXPECT_TRUE(result.problems.empty());
        EXPECT_EQ(result.contacts.size(), 1u);
        return result.contacts.empty() ? std::make_shared<platform::Contact>() : result.contacts.front();
    }
    std::shared_ptr<platform::Contact> withPhoto(const Bytes& photo) {
        const QByteArray data(reinterpret_cast<const char*>(photo.data()), static_cast<qsizetype>(photo.size()));
        return one("VERSION:4.0\r\nFN:A\r\nPHOTO:data:image/png;base64," + data.toBase64().toStdString() + "\r\n");
    }
    void write(const char* name, const QByteArray& text) {
        QFile file(folder.filePath(QString::fromLatin1(name)));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
    }
    std::filesystem::path path(const char* name = "") const {
        return std::filesystem::path(folder.path().toStdString()) / name;
    }
    VCardReader reader;
    QTemporaryDir folder;
};

}  // namespace

TEST_F(VCardReaderTest, Version3_GivesNamesHandlesAndLabels) {
    const auto contact =
        one("VERSION:3.0\r\nUID:ann-1\r\nFN:Ann Marsh\r\nN:Marsh;Ann;Jo;Dr.;jr.\r\nNICKNAME:Annie\r\n"
            "ORG:Harbour Office;Pilots\r\nTITLE:Pilot\r\nEMAIL;TYPE=INTERNET,HOME:ann@harbour.example\r\n"
            "TEL;TYPE=CELL:+44 1632 960001\r\nTEL;TYPE=WORK:01632 960002\r\n");
    EXPECT_EQ(contact->identifier, "ann-1");
    EXPECT_EQ(contact->storedFullName, "Ann Marsh");
    EXPECT_EQ(contact->familyName, "Marsh");
    EXPECT_EQ(contact->givenName, "Ann");
    EXPECT_EQ(contact->middleName, "Jo");
    EXPECT_EQ(contact->namePrefix, "Dr.");
    EXPECT_EQ(contact->nameSuffix, "jr.");
    EXPECT_EQ(contact->nickname, "Annie");
    EXPECT_EQ(contact->organizationName, "Harbour Office");
    EXPECT_EQ(contact->departmentName, "Pilots");
    EXPECT_EQ(contact->jobTitle, "Pilot");
    EXPECT_EQ(contact->emailAddresses, (std::vector<LabeledText>{{"_$!<home>!$_", "ann@harbour.example"}}));
    EXPECT_EQ(contact->phoneNumbers,
              (std::vector<LabeledText>{{"_$!<mobile>!$_", "+44 1632 960001"}, {"_$!<work>!$_", "01632 960002"}}));
    EXPECT_FALSE(contact->imageDataAvailable);
}

TEST_F(VCardReaderTest, Version4_LosesTheSchemesOfItsHandles) {
    const auto contact =
        one("VERSION:4.0\r\nFN:ليلى حداد\r\nTEL;VALUE=uri;TYPE=cell:tel:+44-1632-960002;ext=7\r\n"
            "EMAIL:mailto:l.haddad@mail.example\r\n");
    EXPECT_EQ(contact->storedFullName, "ليلى حداد");
    EXPECT_EQ(contact->identifier, "");
    ASSERT_EQ(contact->phoneNumbers.size(), 1u);
    EXPECT_EQ(contact->phoneNumbers[0].value, "+44-1632-960002");
    ASSERT_EQ(contact->emailAddresses.size(), 1u);
    EXPECT_EQ(contact->emailAddresses[0].value, "l.haddad@mail.example");
}

TEST_F(VCardReaderTest, EscapedAndFoldedValues_AreRestored) {
    const auto contact =
        one("VERSION:3.0\r\nFN:Marsh\\, Ann\r\n  Jo\r\nitem1.TEL:1632960001\r\nitem1.X-ABLabel:Boat\r\n");
    EXPECT_EQ(contact->storedFullName, "Marsh, Ann Jo");
    EXPECT_EQ(contact->phoneNumbers, (std::vector<LabeledText>{{"Boat", "1632960001"}}));
}

TEST_F(VCardReaderTest, EncodedBytesThatAreNoText_AreReplaced) {
    const auto contact =
        one("VERSION:2.1\r\nFN;ENCODING=QUOTED-PRINTABLE:J=C3=B6rg=FF!\r\n"
            "TEL;ENCODING=b:zDEA\r\n");
    EXPECT_EQ(contact->storedFullName, "Jörg\uFFFD!");
    EXPECT_EQ(contact->phoneNumbers, (std::vector<LabeledText>{{"", "\uFFFD1"}}));
}

TEST_F(VCardReaderTest, Base64Photo_GivesImageAndThumbnail) {
    const auto contact = one("VERSION:3.0\r\nFN:A\r\nPHOTO;ENCODING=b;TYPE=PNG:aGVs\r\n bG8=\r\n");
    EXPECT_EQ(contact->imageData, (Bytes{'h', 'e', 'l', 'l', 'o'}));
    EXPECT_EQ(contact->thumbnailImageData, contact->imageData);
    EXPECT_TRUE(contact->imageDataAvailable);
}

TEST_F(VCardReaderTest, DataUriPhoto_GivesImageAndThumbnail) {
    const auto contact = one("VERSION:4.0\r\nFN:A\r\nPHOTO:data:image/png;base64,aGVsbG8=\r\n");
    EXPECT_EQ(contact->imageData, (Bytes{'h', 'e', 'l', 'l', 'o'}));
    EXPECT_TRUE(contact->imageDataAvailable);
}

TEST_F(VCardReaderTest, PhotoElsewhere_IsNotFetched) {
    const auto contact = one("VERSION:4.0\r\nFN:A\r\nPHOTO;VALUE=uri:https://harbour.example/ann.png\r\n");
    EXPECT_EQ(contact->imageData, std::nullopt);
    EXPECT_FALSE(contact->imageDataAvailable);
}

TEST_F(VCardReaderTest, AHugePhoto_GetsASmallThumbnail) {
    const Bytes png = test::encoded(test::noise(1200, 600), "PNG");
    const auto contact = withPhoto(png);
    EXPECT_EQ(contact->imageData, png);
    ASSERT_TRUE(contact->thumbnailImageData.has_value());
    const auto& bytes = *contact->thumbnailImageData;
    const auto thumbnail = QImage::fromData(bytes.data(), static_cast<int>(bytes.size()));
    EXPECT_EQ(thumbnail.size(), QSize(512, 256));
    EXPECT_LT(bytes.size(), png.size());
}

TEST_F(VCardReaderTest, AHugePhotoThatCannotBeRead_GivesNoThumbnail) {
    const auto contact = withPhoto(Bytes(600000, 'x'));
    EXPECT_TRUE(contact->imageData.has_value());
    EXPECT_EQ(contact->thumbnailImageData, std::nullopt);
}

TEST_F(VCardReaderTest, ADrawingAsAHugePhoto_ShowsNoFileOfThisMachine) {
    QImage face(10, 10, QImage::Format_RGB32);
    face.fill(Qt::red);
    const QString other = folder.filePath(QStringLiteral("face.png"));
    ASSERT_TRUE(face.save(other));
    const QString pipe = folder.filePath(QStringLiteral("pipe"));
    ASSERT_EQ(mkfifo(pipe.toUtf8().constData(), 0600), 0);
    for (const QString& file : {other, pipe}) {
        const std::string drawing =
            R"(<svg xmlns="http://www.w3.org/2000/svg" xmlns:xlink="http://www.w3.org/1999/xlink" width="10" height="10">)"
            R"(<image width="10" height="10" xlink:href=")" +
            file.toStdString() + R"("/><!--)" + std::string(600000, 'x') + "--></svg>";
        EXPECT_EQ(withPhoto(Bytes(drawing.begin(), drawing.end()))->thumbnailImageData, std::nullopt);
    }
}

TEST_F(VCardReaderTest, MalformedCards_AreNamedByLineAndTheRestLoads) {
    const auto result = read(
        "BEGIN:VCARD\nVERSION:3.0\nFN:First\nEND:VCARD\n"
        "BEGIN:VCARD\nVERSION:3.0\nFN:No end\n"
        "BEGIN:VCARD\nVERSION:3.0\nNOTE:says nothing\nEND:VCARD\n"
        "\nstray words\nmore\n"
        "begin:vcard\nVERSION:3.0\nFN:Last\nend:vcard\n"
        "BEGIN:VCARD\nFN:Cut o");
    ASSERT_EQ(result.contacts.size(), 2u);
    EXPECT_EQ(result.contacts[0]->storedFullName, "First");
    EXPECT_EQ(result.contacts[1]->storedFullName, "Last");
    ASSERT_EQ(result.problems.size(), 4u);
    EXPECT_EQ(result.problems[0].line, 5u);
    EXPECT_EQ(result.problems[1].line, 8u);
    EXPECT_EQ(result.problems[2].line, 13u);
    EXPECT_EQ(result.problems[3].line, 19u);
    EXPECT_EQ(result.problems[3].file, "people.vcf");
    EXPECT_EQ(result.problems[3].message, "the card has no END:VCARD");
}

TEST_F(VCardReaderTest, ByteOrderMarkLoneCarriageReturnsAndBadUtf8_AreCopedWith) {
    const auto result = read(
        "\xef\xbb\xbf"
        "BEGIN:VCARD\rVERSION:3.0\rFN:Ann\xff\rEND:VCARD\r");
    EXPECT_TRUE(result.problems.empty());
    ASSERT_EQ(result.contacts.size(), 1u);
    EXPECT_EQ(result.contacts[0]->storedFullName, "Ann\uFFFD");
}

TEST_F(VCardReaderTest, AFoldedLineThatReadsLikeAnEnd_IsPartOfItsValue) {
    const auto result = read("BEGIN:VCARD\r\nVERSION:3.0\r\nFN:Ann\r\nNOTE:x\r\n END:VCARD\r\nEND:VCARD\r\n");
    EXPECT_TRUE(result.problems.empty());
    EXPECT_EQ(result.contacts.size(), 1u);
}

TEST_F(VCardReaderTest, ACardBeyondTheCap_IsPassedOver) {
    const auto result = read("BEGIN:VCARD\nFN:Big\nNOTE:" + std::string(VCardText::kLargestCard, 'x') +
                             "\nEND:VCARD\nBEGIN:VCARD\nFN:Small\nEND:VCARD\n");
    ASSERT_EQ(result.contacts.size(), 1u);
    EXPECT_EQ(result.contacts[0]->storedFullName, "Small");
    ASSERT_EQ(result.problems.size(), 1u);
    EXPECT_EQ(result.problems[0].line, 1u);
}

TEST_F(VCardReaderTest, AnEmptyText_HasNoContactsAndNoProblems) {
    EXPECT_TRUE(read("").contacts.empty());
    EXPECT_TRUE(read("\r\n\r\n").problems.empty());
}

TEST_F(VCardReaderTest, AFolder_GivesItsFilesByName) {
    write("b.vcf", "BEGIN:VCARD\nFN:Second\nEND:VCARD\n");
    write("a.VCF", "BEGIN:VCARD\nFN:First\nEND:VCARD\n");
    write("notes.txt", "no card");
    const auto result = reader.read(path());
    EXPECT_EQ(result.error, std::nullopt);
    ASSERT_EQ(result.contacts.size(), 2u);
    EXPECT_EQ(result.contacts[0]->storedFullName, "First");
    EXPECT_EQ(result.contacts[1]->storedFullName, "Second");
}

TEST_F(VCardReaderTest, AMissingPath_IsAnErrorThatNamesIt) {
    const auto result = reader.read(path("nowhere"));
    ASSERT_TRUE(result.error.has_value());
    EXPECT_NE(result.error->find("nowhere"), std::string::npos);
    EXPECT_NE(result.error->find("no such file or folder"), std::string::npos);
}

TEST_F(VCardReaderTest, WhatIsNoFile_IsSaidAndNotWaitedFor) {
    const auto pipe = path("pipe.vcf");
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_EQ(reader.read(pipe).error, pipe.string() + ": this is a pipe, not a file");
    EXPECT_EQ(reader.read("/dev/zero").error, "/dev/zero: this is a device, not a file");
    write("ann.vcf", "BEGIN:VCARD\nFN:Ann\nEND:VCARD\n");
    const auto result = reader.read(path());
    EXPECT_EQ(result.contacts.size(), 1U);
    ASSERT_EQ(result.problems.size(), 1U);
    EXPECT_EQ(result.problems[0].file, pipe);
}

TEST_F(VCardReaderTest, AnEmptyFolder_IsAnEmptyStore) {
    const auto result = reader.read(path());
    EXPECT_EQ(result.error, std::nullopt);
    EXPECT_TRUE(result.contacts.empty());
}

}  // namespace ktr::linux_
