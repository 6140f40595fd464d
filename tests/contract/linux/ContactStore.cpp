#include <QFile>
#include <QTemporaryDir>

#include "linux/contacts/ContactFiles.h"
#include "linux/contacts/MemoryContactStore.h"
#include "tests/contract/ContactStoreContract.h"

namespace ktr::test {

namespace {

using platform::ContactStore;

std::shared_ptr<ContactStore> inMemory(const ContactStore::Contacts& contacts) {
    return std::make_shared<linux_::MemoryContactStore>(contacts, std::make_shared<linux_::PhonenumberLibrary>(), "gb");
}

/// The same contacts, written as vCards and read back.
std::shared_ptr<ContactStore> fromVCards(const ContactStore::Contacts& contacts) {
    const QTemporaryDir folder;
    QFile file(folder.filePath(QStringLiteral("all.vcf")));
    EXPECT_TRUE(file.open(QIODevice::WriteOnly));
    for (const auto& contact : contacts) {
        std::string card =
            "BEGIN:VCARD\r\nVERSION:4.0\r\nUID:" + contact->identifier + "\r\nFN:" + contact->storedFullName;
        for (const auto& email : contact->emailAddresses) {
            card += "\r\nEMAIL:" + email.value;
        }
        for (const auto& phone : contact->phoneNumbers) {
            card += "\r\nTEL;VALUE=text:" + phone.value;
        }
        file.write(QByteArray::fromStdString(card + "\r\nEND:VCARD\r\n"));
    }
    file.close();
    std::string error;
    const auto read = linux_::ContactFiles::read({file.fileName().toStdString()}, error);
    EXPECT_TRUE(read) << error;
    return inMemory(read.value_or(ContactStore::Contacts()));
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(Linux, ContactStoreContract,
                         ::testing::Values(ContactStoreCase{"MemoryContactStore", inMemory},
                                           ContactStoreCase{"VCards", fromVCards}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
