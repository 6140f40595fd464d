#include "linux/contacts/AddressBooks.h"

#include <filesystem>

#include "linux/contacts/BookPhotos.h"
#include "linux/contacts/ContactFiles.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/qt/FakeAddressBooks.h"

namespace ktr::test {

using linux_::AddressBooks;
using linux_::BookPhotos;
using Manner = FakeAddressBooks::Manner;

class AddressBooksTest : public PlatformTest {
  protected:
    ~AddressBooksTest() override {
        books.reset();
        PrivateBus::disconnect(QStringLiteral("books-client"));
    }
    void open(int answer = 5000) {
        AddressBooks::Pauses pauses;
        pauses.answer = answer;
        pauses.partial = 100;
        pauses.quiet = 20;
        pauses.retry = 100;
        pauses.longest = 400;
        books = std::make_unique<AddressBooks>(
            bus.connect(QStringLiteral("books-client")),
            [this](const std::vector<AddressBooks::Book>& now, bool complete) {
                told = now;
                isComplete = isComplete || complete;
            },
            pauses);
        books->start();
    }
    std::string cards() const {
        std::string all;
        for (const auto& book : told) {
            all += book.name + "{" + book.cards + "}";
        }
        std::erase(all, '\r');
        std::erase(all, '\n');
        return all;
    }
    bool comesTo(const std::string& wanted) {
        return eventually([&] { return cards() == wanted; });
    }

    PrivateBus bus;
    std::unique_ptr<AddressBooks> books;
    std::vector<AddressBooks::Book> told;
    bool isComplete = false;
};

TEST_F(AddressBooksTest, EachEnabledBook_IsReadWithItsName) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann", "Bo"});
    service.set(QStringLiteral("work"), {"Cid"});
    open();
    EXPECT_TRUE(comesTo("local{AnnBo}work{Cid}")) << cards() << ": no calendar, and nothing of an account that is off";
    EXPECT_TRUE(isComplete);
}

TEST_F(AddressBooksTest, Changes_AreFollowed) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    open();
    ASSERT_TRUE(comesTo("local{Ann}"));
    service.set(QStringLiteral("local"), {"Ann", "Bo"});
    EXPECT_TRUE(comesTo("local{AnnBo}"));
    service.set(QStringLiteral("work"), {"Cid"});
    service.enable(QStringLiteral("work"), true);
    EXPECT_TRUE(comesTo("local{AnnBo}work{Cid}"));
    service.enable(QStringLiteral("local"), false);
    EXPECT_TRUE(comesTo("work{Cid}"));
}

TEST_F(AddressBooksTest, NoBusAndNoService_AreNoBooks) {
    books = std::make_unique<AddressBooks>(QDBusConnection(QStringLiteral("none")),
                                           [this](const auto&, bool complete) { isComplete = complete; });
    books->start();
    EXPECT_TRUE(isComplete);
    isComplete = false;
    open();
    EXPECT_TRUE(eventually([&] { return isComplete; }));
    EXPECT_TRUE(told.empty());
}

TEST_F(AddressBooksTest, SilentBook_IsLeftOutAndTriedAgain) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    service.setManner(Manner::Silent, QStringLiteral("Open"));
    open(400);
    EXPECT_TRUE(eventually([&] { return isComplete; })) << "nobody waits for it";
    EXPECT_EQ(cards(), "local{}");
    service.setManner(Manner::Answers);
    EXPECT_TRUE(comesTo("local{Ann}"));
}

TEST_F(AddressBooksTest, BusThatDiesWhileABookIsRead_KeepsNobodyWaiting) {
    auto dying = std::make_unique<PrivateBus>();
    auto service = std::make_unique<FakeAddressBooks>(*dying);
    service->set(QStringLiteral("local"), {"Ann"});
    service->setManner(Manner::Silent, QStringLiteral("Open"));
    books = std::make_unique<AddressBooks>(dying->connect(QStringLiteral("books-client")),
                                           [this](const std::vector<AddressBooks::Book>& now, bool complete) {
                                               told = now;
                                               isComplete = isComplete || complete;
                                           });
    books->start();
    ASSERT_TRUE(comesTo("local{}")) << "it is being read";
    EXPECT_FALSE(isComplete);
    dying.reset();
    EXPECT_TRUE(eventually([&] { return isComplete; }));
    EXPECT_EQ(cards(), "local{}");
}

TEST_F(AddressBooksTest, SilentRegistry_IsTriedAgain) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    service.setManner(Manner::Silent);
    open(400);
    EXPECT_TRUE(eventually([&] { return isComplete; }));
    service.setManner(Manner::Answers);
    EXPECT_TRUE(comesTo("local{Ann}"));
}

TEST_F(AddressBooksTest, LiesAndRefusals_CostNothingThatWasKnown) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    open();
    ASSERT_TRUE(comesTo("local{Ann}"));
    for (const Manner manner : {Manner::Lies, Manner::Refuses}) {
        for (const char* method : {"GetManagedObjects", "OpenAddressBook", "Open", "GetView", "GetContactList"}) {
            service.setManner(manner, QLatin1String(method));
            const int before = service.readings();
            // Everything is asked again, and something of it goes wrong.
            service.enable(QStringLiteral("local"), true);
            service.set(QStringLiteral("local"), {"Ann"});
            wakesIn(150);
            EXPECT_EQ(cards(), "local{Ann}") << method;
            service.setManner(Manner::Answers);
            service.enable(QStringLiteral("local"), true);
            EXPECT_TRUE(eventually([&] { return service.readings() > before && cards() == "local{Ann}"; })) << method;
        }
    }
}

TEST_F(AddressBooksTest, ServiceThatDies_LeavesItsCards_AndIsReadWhenItIsBack) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    open();
    ASSERT_TRUE(comesTo("local{Ann}"));
    service.die();
    wakesIn(100);
    EXPECT_EQ(cards(), "local{Ann}");
    service.set(QStringLiteral("local"), {"Anna"});
    service.begin();
    EXPECT_TRUE(comesTo("local{Anna}"));
}

TEST_F(AddressBooksTest, BusThatDiesInTheMiddle_LeavesTheCardsAndNobodyWaiting) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    open(400);
    ASSERT_TRUE(comesTo("local{Ann}"));
    ASSERT_TRUE(eventually([&] { return isComplete; }));
    isComplete = false;
    const int before = service.readings();
    service.setManner(Manner::Silent, QStringLiteral("GetContactList"));
    service.set(QStringLiteral("local"), {"Anna"});
    ASSERT_TRUE(eventually([&] { return service.readings() > before; }));
    bus.die();
    EXPECT_TRUE(eventually([&] { return isComplete; })) << "what was asked is never answered";
    EXPECT_EQ(cards(), "local{Ann}");
}

TEST_F(AddressBooksTest, BusThatDiesBeforeAnythingWasRead_IsToldAsNoBooks) {
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), {"Ann"});
    service.setManner(Manner::Silent, QStringLiteral("GetManagedObjects"));
    open(400);
    wakesIn(100);
    ASSERT_FALSE(isComplete);
    bus.die();
    EXPECT_TRUE(eventually([&] { return isComplete; })) << "the program's start waits for this";
    EXPECT_TRUE(told.empty());
}

TEST_F(AddressBooksTest, HundredThousandCards_AreReadWhole) {
    FakeAddressBooks service(bus);
    std::vector<std::string> all;
    std::size_t bytes = 0;
    for (int i = 0; i < 100000; ++i) {
        all.push_back("BEGIN:VCARD\r\nFN:Person " + std::to_string(i) + "\r\nEND:VCARD");
        bytes += all.back().size() + 2;
    }
    service.set(QStringLiteral("local"), all);
    open(20000);
    ASSERT_TRUE(eventually([&] { return isComplete; }));
    ASSERT_EQ(told.size(), 1U);
    EXPECT_EQ(told.front().cards.size(), bytes);
    EXPECT_NE(told.front().cards.find("FN:Person 99999\r\n"), std::string::npos);
}

class BookPhotosTest : public ::testing::Test {
  protected:
    std::string with(const std::string& photo) const {
        return BookPhotos::withPhotos("BEGIN:VCARD\r\n" + photo + "\r\nFN:Ann\r\nEND:VCARD\r\n",
                                      {folder.path() / "book"});
    }
    static std::string card(const std::string& photo) {
        return "BEGIN:VCARD\r\n" + photo + "\r\nFN:Ann\r\nEND:VCARD\r\n";
    }
    TemporaryFolder folder;
};

TEST_F(BookPhotosTest, OwnFile_IsInTheCard) {
    std::filesystem::create_directories(folder.path() / "book/photos");
    folder.write("book/photos/ann face.jpg", "jpg");
    const std::string uri = "file://" + (folder.path() / "book/photos").string() + "/ann%20face.jpg";
    EXPECT_EQ(with("PHOTO;VALUE=uri:" + uri), card("PHOTO;ENCODING=b:anBn"));
    EXPECT_EQ(with("photo;TYPE=jpeg;value=URI:" + uri.substr(0, 20) + "\r\n " + uri.substr(20)),
              card("PHOTO;ENCODING=b:anBn"))
        << "folded, in any letters";
}

TEST_F(BookPhotosTest, FileOfAnybodyElse_StaysAName) {
    std::filesystem::create_directories(folder.path() / "book");
    folder.write("secret", "secret");
    std::filesystem::create_symlink(folder.path() / "secret", folder.path() / "book/link");
    for (const std::string& uri :
         {"file://" + (folder.path() / "secret").string(), "file://" + (folder.path() / "book/link").string(),
          "file://" + (folder.path() / "book/../secret").string(), "file://" + (folder.path() / "book").string(),
          "file://" + (folder.path() / "book/none").string(), std::string("https://example.org/a.jpg"),
          std::string("file:///dev/zero"), std::string("file://"), std::string("")}) {
        const std::string photo = "PHOTO;VALUE=uri:" + uri;
        EXPECT_EQ(with(photo), card(photo));
    }
}

TEST_F(BookPhotosTest, PhotoInTheCard_StaysAsItIs) {
    const std::string photo = "PHOTO;ENCODING=b;TYPE=JPEG:anBn\r\n anBn";
    EXPECT_EQ(with(photo), card(photo));
}

}  // namespace ktr::test
