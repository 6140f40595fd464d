#include "linux/contacts/ContactFiles.h"

#include <QEventLoop>
#include <QTimer>
#include <set>

#include "linux/contacts/MemoryContactStore.h"
#include "linux/device/QtMainLoop.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::ContactFiles;

class ContactFilesTest : public PlatformTest {
  protected:
    static std::string card(const std::string& name) {
        return "BEGIN:VCARD\r\nVERSION:3.0\r\nFN:" + name + "\r\nN:;" + name + ";;;\r\nEND:VCARD\r\n";
    }
    static bool runUntil(const std::function<bool()>& done, int milliseconds = 20000) {
        QEventLoop loop;
        QTimer tick;
        QObject::connect(&tick, &QTimer::timeout, [&] {
            if (done()) {
                loop.quit();
            }
        });
        QTimer::singleShot(milliseconds, &loop, &QEventLoop::quit);
        tick.start(5);
        loop.exec();
        return done();
    }
    void follow(const ContactFiles::Paths& paths) {
        files->follow(paths, [this](const ContactFiles::Contacts& read) {
            names.clear();
            for (const auto& contact : read) {
                names.push_back(contact->givenName);
            }
            ++changes;
        });
    }

    TemporaryFolder folder;
    std::shared_ptr<linux_::QtMainLoop> loop = std::make_shared<linux_::QtMainLoop>();
    std::unique_ptr<ContactFiles> files = std::make_unique<ContactFiles>(loop);
    std::vector<std::string> names;
    int changes = 0;
};

TEST_F(ContactFilesTest, FileWrittenInPlaceAndFileReplaced_AreReadAgain) {
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    folder.write("cards.vcf", card("Anna"));
    ASSERT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Anna"}; }));
    folder.write("other", card("Otto"));
    std::filesystem::rename(folder.path() / "other", folder.path() / "cards.vcf");
    ASSERT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Otto"}; }));
    folder.write("cards.vcf", card("Ida"));
    EXPECT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Ida"}; })) << "the new file is watched, too";
}

TEST_F(ContactFilesTest, Folder_ACardThatComesAndOneThatGoes) {
    std::filesystem::create_directory(folder.path() / "cards");
    folder.write("cards/a.vcf", card("Ann"));
    follow({(folder.path() / "cards").string()});
    folder.write("cards/b.vcf", card("Bo"));
    ASSERT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Ann", "Bo"}; }));
    std::filesystem::remove(folder.path() / "cards" / "a.vcf");
    ASSERT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Bo"}; }));
    folder.write("cards/b.vcf", card("Bodo"));
    EXPECT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Bodo"}; }));
}

TEST_F(ContactFilesTest, FileThatIsGone_LeavesWhatThereWas_AndOneLine) {
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    std::filesystem::remove(folder.path() / "cards.vcf");
    ASSERT_TRUE(runUntil([&] { return !log->texts(platform::LogLevel::Error).empty(); }));
    for (const auto& line : log->texts(platform::LogLevel::Error)) {
        EXPECT_NE(line.find("the contacts stay as they were"), std::string::npos) << line;
        expectErrorLine(line);
    }
    EXPECT_EQ(changes, 0);
}

TEST_F(ContactFilesTest, GoneWhileReading_IsNotCalledBack) {
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    files->reload();
    files.reset();
    runUntil([] { return false; }, 300);
    EXPECT_EQ(changes, 0);
}

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
