#include "linux/contacts/UserContacts.h"

#include <QElapsedTimer>
#include <QEventLoop>
#include <QTimer>
#include <algorithm>
#include <filesystem>

#include "linux/device/QtMainLoop.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/qt/FakeAddressBooks.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::UserContacts;

namespace {

const QString kLocal = QStringLiteral("local");
const QString kWork = QStringLiteral("work");

}  // namespace

class UserContactsTest : public PlatformTest {
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
    UserContactsTest() : data("XDG_DATA_HOME", folder.path().c_str()) {}
    static std::vector<std::string> namesOf(const UserContacts::Contacts& contacts) {
        std::vector<std::string> names;
        for (const auto& contact : contacts) {
            names.push_back(contact->givenName);
        }
        return names;
    }
    void follow(const UserContacts::Paths& paths) {
        contacts = std::make_unique<UserContacts>(loop, paths, bus.address().toStdString());
        names = namesOf(contacts->first(20.0, error));
        contacts->follow([this](const UserContacts::Contacts& read) {
            names = namesOf(read);
            ++changes;
        });
    }

    TemporaryFolder folder;
    std::shared_ptr<linux_::QtMainLoop> loop = std::make_shared<linux_::QtMainLoop>();
    PrivateBus bus;
    EnvironmentVariable data;
    std::unique_ptr<UserContacts> contacts;
    std::string error;
    std::vector<std::string> names;
    int changes = 0;
};

TEST_F(UserContactsTest, FileWrittenInPlaceAndFileReplaced_AreReadAgain) {
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

TEST_F(UserContactsTest, Folder_ACardThatComesAndOneThatGoes) {
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

TEST_F(UserContactsTest, FileThatIsGone_LeavesWhatThereWas_AndOneLine) {
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    EXPECT_EQ(names, std::vector<std::string>{"Ann"}) << "read before anybody waits for it";
    std::filesystem::remove(folder.path() / "cards.vcf");
    ASSERT_TRUE(runUntil([&] { return !log->texts(platform::LogLevel::Error).empty(); }));
    for (const auto& line : log->texts(platform::LogLevel::Error)) {
        EXPECT_NE(line.find("the contacts stay as they were"), std::string::npos) << line;
        expectErrorLine(line);
    }
    EXPECT_EQ(changes, 0);
}

TEST_F(UserContactsTest, GoneWhileReading_IsNotCalledBack) {
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    folder.write("cards.vcf", card("Anna"));
    contacts.reset();
    runUntil([] { return false; }, 300);
    EXPECT_EQ(changes, 0);
}

TEST_F(UserContactsTest, MissingPath_IsToldAtOnce) {
    follow({"/nonexistent/contacts"});
    EXPECT_EQ(error, "/nonexistent/contacts: no such file or folder");
}

TEST_F(UserContactsTest, AddressBooks_StandBesideTheFiles) {
    FakeAddressBooks service(bus);
    service.set(kLocal, {card("Bea"), card("Cid")});
    service.set(kWork, {card("Dan")});
    folder.write("cards.vcf", card("Ann"));
    follow({(folder.path() / "cards.vcf").string()});
    EXPECT_EQ(names, (std::vector<std::string>{"Ann", "Bea", "Cid", "Dan"}));
    service.set(kWork, {card("Dan"), card("Eve")});
    EXPECT_TRUE(runUntil([&] { return names.size() == 5 && names.back() == "Eve"; }));
}

// The start waits for its second and no longer; what comes later is told.
TEST_F(UserContactsTest, AddressBookWithCardsThatAreNone_GivesTheOthers) {
    FakeAddressBooks service(bus);
    service.set(kLocal, {card("Ann"), "garbage", "BEGIN:VCARD\r\nFN:half", std::string(1, '\x01'), "", card("Bo")});
    follow({});
    EXPECT_TRUE(runUntil([&] {
        return std::find(names.begin(), names.end(), "Ann") != names.end() &&
               std::find(names.begin(), names.end(), "Bo") != names.end();
    })) << names.size();
    for (const auto& line : log->texts(platform::LogLevel::Error)) {
        EXPECT_NE(line.find("card"), std::string::npos) << line;
        expectErrorLine(line);
    }
}

TEST_F(UserContactsTest, AddressBookThatTakesItsTime_IsNotWaitedFor) {
    FakeAddressBooks service(bus);
    service.set(kLocal, {card("Bea")});
    service.setManner(FakeAddressBooks::Manner::Silent, QStringLiteral("GetContactList"));
    folder.write("cards.vcf", card("Ann"));
    contacts = std::make_unique<UserContacts>(loop, UserContacts::Paths{(folder.path() / "cards.vcf").string()},
                                              bus.address().toStdString());
    QElapsedTimer clock;
    clock.start();
    EXPECT_EQ(namesOf(contacts->first(0.3, error)), std::vector<std::string>{"Ann"});
    EXPECT_LT(clock.elapsed(), 5000);
    contacts->follow([this](const UserContacts::Contacts& read) { names = namesOf(read); });
    service.speak();
    EXPECT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Ann", "Bea"}; }));
    clock.start();
    contacts.reset();
    EXPECT_LT(clock.elapsed(), 2000);
}

TEST_F(UserContactsTest, AddressBooksThatAreSwitchedOff_AreNotAsked_AndComeAndGoLive) {
    FakeAddressBooks service(bus);
    service.set(kLocal, {card("Ann")});
    contacts = std::make_unique<UserContacts>(loop, UserContacts::Paths{}, bus.address().toStdString(), false);
    names = namesOf(contacts->first(20.0, error));
    contacts->follow([this](const UserContacts::Contacts& read) { names = namesOf(read); });
    EXPECT_TRUE(names.empty());
    contacts->setUsesBooks(true);
    EXPECT_TRUE(runUntil([&] { return names == std::vector<std::string>{"Ann"}; }));
    contacts->setUsesBooks(false);
    EXPECT_TRUE(runUntil([&] { return names.empty(); }));
}

}  // namespace ktr::test
