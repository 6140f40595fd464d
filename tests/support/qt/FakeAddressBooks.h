#pragma once

#include <gtest/gtest.h>

#include <QDBusMetaType>
#include <QDBusObjectPath>
#include <QMap>
#include <QStringList>
#include <QThread>
#include <QVariantMap>
#include <algorithm>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

/// The desktop's address-book service on a private bus, on a thread of its own; it can be silent, lie, refuse and die.
class FakeAddressBooks {
  public:
    using Interfaces = QMap<QString, QVariantMap>;
    using Objects = QMap<QDBusObjectPath, Interfaces>;
    enum class Manner { Answers, Silent, Lies, Refuses };

    explicit FakeAddressBooks(const PrivateBus& bus)
        : name_(QStringLiteral("address-books-%1").arg(reinterpret_cast<quintptr>(this))),
          connection_(bus.connect(name_)),
          service_([this](const QDBusMessage& message, const QDBusConnection&) { return answer(message); }) {
        qDBusRegisterMetaType<Interfaces>();
        qDBusRegisterMetaType<Objects>();
        EXPECT_TRUE(
            connection_.registerVirtualObject(QStringLiteral("/org/gnome"), &service_, QDBusConnection::SubPath));
        service_.moveToThread(&thread_);
        thread_.start();
        begin();
    }
    ~FakeAddressBooks() {
        thread_.quit();
        thread_.wait();
        PrivateBus::disconnect(name_);
    }

    /// What a book holds from now on; it says that something has changed. A new one is enabled.
    void set(const QString& book, const std::vector<std::string>& cards) {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            books_[book].cards = cards;
        }
        connection_.send(QDBusMessage::createSignal(kViews + book,
                                                    QStringLiteral("org.gnome.evolution.dataserver.AddressBookView"),
                                                    QStringLiteral("ObjectsModified")));
    }
    void enable(const QString& book, bool enabled) {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            books_[book].isEnabled = enabled;
        }
        auto signal = QDBusMessage::createSignal(QStringLiteral("/org/gnome/evolution/dataserver/SourceManager"),
                                                 QStringLiteral("org.freedesktop.DBus.ObjectManager"),
                                                 QStringLiteral("InterfacesAdded"));
        connection_.send(signal);
    }
    /// From this call on; what was not answered before stays so. Of all calls, or of one.
    void setManner(Manner manner, const QString& method = {}) {
        const std::lock_guard<std::mutex> lock(mutex_);
        manner_ = manner;
        method_ = method;
    }
    void speak() {
        std::vector<QDBusMessage> unanswered;
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            manner_ = Manner::Answers;
            unanswered.swap(unanswered_);
        }
        for (const QDBusMessage& message : unanswered) {
            answer(message);
        }
    }
    void begin() {
        for (const char* name : {"Sources5", "AddressBook10"}) {
            EXPECT_TRUE(
                connection_.registerService(QLatin1String("org.gnome.evolution.dataserver.") + QLatin1String(name)));
        }
    }
    void die() {
        for (const char* name : {"Sources5", "AddressBook10"}) {
            connection_.unregisterService(QLatin1String("org.gnome.evolution.dataserver.") + QLatin1String(name));
        }
    }
    /// How often the cards of any book were asked for.
    int readings() const {
        const std::lock_guard<std::mutex> lock(mutex_);
        return readings_;
    }

  private:
    struct Book {
        std::vector<std::string> cards;
        bool isEnabled = true;
    };

    Objects objects() const {
        Objects objects;
        int number = 0;
        const auto add = [&](const QString& uid, const QString& data) {
            const QDBusObjectPath path(
                QStringLiteral("/org/gnome/evolution/dataserver/SourceManager/Source_%1").arg(++number));
            objects[path][QStringLiteral("org.gnome.evolution.dataserver.Source")] = {{QStringLiteral("UID"), uid},
                                                                                      {QStringLiteral("Data"), data}};
        };
        add(QStringLiteral("a-calendar"), QStringLiteral("[Data Source]\nDisplayName=Days\n\n[Calendar]\n"));
        add(QStringLiteral("account-off"), QStringLiteral("[Data Source]\nEnabled=false\n"));
        add(QStringLiteral("of-account-off"),
            QStringLiteral("[Data Source]\nParent=account-off\nEnabled=true\n\n[Address Book]\n"));
        for (const auto& [uid, book] : books_) {
            add(uid, QStringLiteral("[Data Source]\nDisplayName=%1\nDisplayName[de]=Buch\nEnabled=%2\n\n"
                                    "[Address Book]\nBackendName=local\n")
                         .arg(uid, book.isEnabled ? QStringLiteral("true") : QStringLiteral("false")));
        }
        return objects;
    }

    bool answer(const QDBusMessage& message) {
        const std::lock_guard<std::mutex> lock(mutex_);
        const QString method = message.member();
        readings_ += method == QLatin1String("GetContactList") ? 1 : 0;
        if (manner_ != Manner::Answers && (method_.isEmpty() || method_ == method)) {
            switch (manner_) {
                case Manner::Silent:
                    message.setDelayedReply(true);
                    unanswered_.push_back(message);
                    return true;
                case Manner::Lies:
                    return connection_.send(message.createReply({42, QStringLiteral("not a path"), 7.5}));
                default:
                    return connection_.send(
                        message.createErrorReply(QStringLiteral("org.example.No"), QStringLiteral("no")));
            }
        }
        return connection_.send(message.createReply(rightAnswer(message, method)));
    }
    QVariantList rightAnswer(const QDBusMessage& message, const QString& method) const {
        const QString book = message.path().section(QLatin1Char('/'), -1);
        if (method == QLatin1String("GetManagedObjects")) {
            return {QVariant::fromValue(objects())};
        }
        if (method == QLatin1String("OpenAddressBook")) {
            return {kBooks + message.arguments().value(0).toString(), connection_.baseService()};
        }
        if (method == QLatin1String("Open")) {
            return {QStringList()};
        }
        if (method == QLatin1String("GetView")) {
            return {QVariant::fromValue(QDBusObjectPath(kViews + book))};
        }
        if (method == QLatin1String("GetContactList")) {
            QStringList cards;
            const auto found = books_.find(book);
            for (const std::string& card : found == books_.end() ? std::vector<std::string>() : found->second.cards) {
                cards << QString::fromStdString(card);
            }
            return {cards};
        }
        return {};
    }

    const QString kBooks = QStringLiteral("/org/gnome/evolution/dataserver/Subprocess/");
    const QString kViews = QStringLiteral("/org/gnome/evolution/dataserver/AddressBookView/");
    const QString name_;
    QDBusConnection connection_;
    mutable std::mutex mutex_;
    std::map<QString, Book> books_;
    Manner manner_ = Manner::Answers;
    QString method_;
    std::vector<QDBusMessage> unanswered_;
    int readings_ = 0;
    FakeService service_;
    QThread thread_;
};

}  // namespace ktr::test
