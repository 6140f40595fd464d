#include <QFile>
#include <QTemporaryDir>

#include "linux/contacts/ContactFiles.h"
#include "linux/contacts/MemoryContactStore.h"
#include "linux/contacts/UserContacts.h"
#include "linux/device/QtMainLoop.h"
#include "tests/contract/ContactStoreContract.h"
#include "tests/support/qt/FakeAddressBooks.h"

namespace ktr::test {

namespace {

using platform::ContactStore;

std::shared_ptr<ContactStore> inMemory(const ContactStore::Contacts& contacts) {
    return std::make_shared<linux_::MemoryContactStore>(contacts, std::make_shared<linux_::PhonenumberLibrary>(), "gb");
}

/// The same contacts, written as vCards.
std::vector<std::string> cardsOf(const ContactStore::Contacts& contacts) {
    std::vector<std::string> cards;
    for (const auto& contact : contacts) {
        std::string card =
            "BEGIN:VCARD\r\nVERSION:4.0\r\nUID:" + contact->identifier + "\r\nFN:" + contact->storedFullName;
        for (const auto& email : contact->emailAddresses) {
            card += "\r\nEMAIL:" + email.value;
        }
        for (const auto& phone : contact->phoneNumbers) {
            card += "\r\nTEL;VALUE=text:" + phone.value;
        }
        cards.push_back(card + "\r\nEND:VCARD\r\n");
    }
    return cards;
}

std::shared_ptr<ContactStore> fromVCards(const ContactStore::Contacts& contacts) {
    const QTemporaryDir folder;
    QFile file(folder.filePath(QStringLiteral("all.vcf")));
    EXPECT_TRUE(file.open(QIODevice::WriteOnly));
    for (const std::string& card : cardsOf(contacts)) {
        file.write(QByteArray::fromStdString(card));
    }
    file.close();
    std::string error;
    const auto read = linux_::ContactFiles::read({file.fileName().toStdString()}, error);
    EXPECT_TRUE(read) << error;
    return inMemory(read.value_or(ContactStore::Contacts()));
}

/// And as the desktop's address book has them.
std::shared_ptr<ContactStore> fromAddressBook(const ContactStore::Contacts& contacts) {
    const PrivateBus bus;
    FakeAddressBooks service(bus);
    service.set(QStringLiteral("local"), cardsOf(contacts));
    std::string error;
    const auto loop = std::make_shared<linux_::QtMainLoop>();
    linux_::UserContacts read(loop, {}, bus.address().toStdString());
    constexpr double kPatience = 20.0;
    return inMemory(read.first(kPatience, error));
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(Linux, ContactStoreContract,
                         ::testing::Values(ContactStoreCase{"MemoryContactStore", inMemory},
                                           ContactStoreCase{"VCards", fromVCards},
                                           ContactStoreCase{"AddressBook", fromAddressBook}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
