#include "linux/contacts/VCardContactStore.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <set>

#include "tests/support/RecordingLogSink.h"

namespace ktr::linux_ {

namespace {

class VCardContactStoreTest : public ::testing::Test {
  protected:
    auto load(const std::filesystem::path& path) {
        return VCardContactStore::load(path, std::make_shared<PhonenumberLibrary>(), "GB", log);
    }
    test::RecordingLogSink log;
    QTemporaryDir folder;
};

}  // namespace

TEST_F(VCardContactStoreTest, AMalformedCard_IsLoggedWithFileAndLine) {
    QFile file(folder.filePath(QStringLiteral("all.vcf")));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write("BEGIN:VCARD\nFN:Ann\nEND:VCARD\nBEGIN:VCARD\nNOTE:\nEND:VCARD\n");
    file.close();
    const auto loaded = load(file.fileName().toStdString());
    ASSERT_NE(loaded.result, nullptr);
    EXPECT_EQ(loaded.result->contacts().size(), 1u);
    EXPECT_EQ(log.texts(platform::LogLevel::Error),
              std::vector<std::string>{file.fileName().toStdString() +
                                       ":4: contact passed over: the card holds neither a name nor an address nor a "
                                       "number"});
}

TEST_F(VCardContactStoreTest, AMissingPath_IsAnErrorAndNoStore) {
    const auto loaded = load("/nonexistent/contacts");
    EXPECT_EQ(loaded.result, nullptr);
    ASSERT_TRUE(loaded.error.has_value());
    EXPECT_EQ(*loaded.error, "/nonexistent/contacts: no such file or folder");
}

TEST_F(VCardContactStoreTest, TheDemoContacts_AllLoad) {
    const auto loaded = load(KTR_SOURCE_DIR "/resources/scenarios/contacts");
    ASSERT_NE(loaded.result, nullptr);
    EXPECT_TRUE(log.texts().empty()) << log.texts().front();
    const auto& contacts = loaded.result->contacts();
    EXPECT_EQ(contacts.size(), 40u);
    std::set<std::string> identifiers;
    int photos = 0;
    for (const auto& contact : contacts) {
        identifiers.insert(contact->identifier);
        EXPECT_FALSE(contact->storedFullName.empty());
        EXPECT_FALSE(contact->emailAddresses.empty() && contact->phoneNumbers.empty()) << contact->storedFullName;
        if (contact->imageData) {
            ++photos;
            EXPECT_LE(contact->imageData->size(), 20u * 1024u);
            EXPECT_EQ((*contact->imageData)[1], 'P');
        }
    }
    EXPECT_EQ(identifiers.size(), contacts.size());
    EXPECT_EQ(photos, 6);
}

TEST_F(VCardContactStoreTest, TheDemoContacts_AreFoundByTheirHandles) {
    const auto store = load(KTR_SOURCE_DIR "/resources/scenarios/contacts").result;
    ASSERT_NE(store, nullptr);
    const auto byEmail = store->unifiedContactsMatchingEmailAddress("L.Haddad@mail.example", {}).result;
    ASSERT_EQ(byEmail.size(), 1u);
    EXPECT_EQ(byEmail[0]->storedFullName, "ليلى حداد");
    const auto byPhone = store->unifiedContactsMatchingPhoneNumber("+441632960018", {}).result;
    ASSERT_EQ(byPhone.size(), 1u);
    EXPECT_EQ(byPhone[0]->storedFullName, "Peter Quillfeather");
}

}  // namespace ktr::linux_
