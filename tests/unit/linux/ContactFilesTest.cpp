#include "linux/contacts/ContactFiles.h"

#include <algorithm>
#include <set>

#include "linux/contacts/MemoryContactStore.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::ContactFiles;

class ContactFilesTest : public PlatformTest {
  protected:
    TemporaryFolder folder;
};

TEST_F(ContactFilesTest, MalformedCard_IsLoggedWithFileAndLine) {
    folder.write("all.vcf", "BEGIN:VCARD\nFN:Ann\nEND:VCARD\nBEGIN:VCARD\nNOTE:\nEND:VCARD\n");
    const std::string path = (folder.path() / "all.vcf").string();
    const std::string line =
        path + ":4: contact passed over: the card holds neither a name nor an address nor a number";
    expectErrorLine(line);
    std::string error;
    const auto read = ContactFiles::read({path}, error);
    ASSERT_TRUE(read);
    EXPECT_EQ(read->size(), 1U);
    EXPECT_EQ(log->texts(platform::LogLevel::Error), std::vector<std::string>{line});
}

TEST_F(ContactFilesTest, MissingPath_IsAnErrorAndNoContacts) {
    std::string error;
    EXPECT_FALSE(ContactFiles::read({"/nonexistent/contacts"}, error));
    EXPECT_EQ(error, "/nonexistent/contacts: no such file or folder");
}

TEST_F(ContactFilesTest, EachCardFileThatIsRead_IsWatched) {
    folder.write("ANN.VCF", "BEGIN:VCARD\nFN:Ann\nEND:VCARD\n");
    folder.write("notes.txt", "");
    std::string error;
    const auto read = ContactFiles::read({folder.path().string()}, error);
    ASSERT_TRUE(read) << error;
    EXPECT_EQ(read->size(), 1U);
    const auto watched = ContactFiles::watched({folder.path().string()});
    EXPECT_EQ(std::count(watched.begin(), watched.end(), (folder.path() / "ANN.VCF").string()), 1);
    EXPECT_EQ(std::count(watched.begin(), watched.end(), (folder.path() / "notes.txt").string()), 0);
}

TEST_F(ContactFilesTest, DemoContacts_AreAllReadAndFoundByTheirHandles) {
    std::string error;
    const auto read = ContactFiles::read({KTR_SOURCE_DIR "/resources/scenarios/contacts"}, error);
    ASSERT_TRUE(read) << error;
    linux_::MemoryContactStore store(*read, std::make_shared<linux_::PhonenumberLibrary>(), "GB");
    EXPECT_EQ(store.contacts().size(), 40U);
    std::set<std::string> identifiers;
    int photos = 0;
    for (const auto& contact : store.contacts()) {
        identifiers.insert(contact->identifier);
        EXPECT_FALSE(contact->storedFullName.empty());
        EXPECT_FALSE(contact->emailAddresses.empty() && contact->phoneNumbers.empty()) << contact->storedFullName;
        if (contact->imageData) {
            ++photos;
            EXPECT_LE(contact->imageData->size(), 20U * 1024U);
            EXPECT_EQ((*contact->imageData)[1], 'P');
        }
    }
    EXPECT_EQ(identifiers.size(), store.contacts().size());
    EXPECT_EQ(photos, 6);
    const auto byEmail = store.unifiedContactsMatchingEmailAddress("L.Haddad@mail.example", {}).result;
    ASSERT_EQ(byEmail.size(), 1U);
    EXPECT_EQ(byEmail[0]->storedFullName, "ليلى حداد");
    const auto byPhone = store.unifiedContactsMatchingPhoneNumber("+441632960018", {}).result;
    ASSERT_EQ(byPhone.size(), 1U);
    EXPECT_EQ(byPhone[0]->storedFullName, "Peter Quillfeather");
}

}  // namespace ktr::test
