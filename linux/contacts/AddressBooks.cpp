#include "linux/contacts/AddressBooks.h"

#include <QDBusArgument>
#include <QDBusObjectPath>
#include <QDBusPendingCall>
#include <QDBusPendingCallWatcher>
#include <QDBusServiceWatcher>
#include <QStringList>
#include <QVariantMap>
#include <algorithm>
#include <utility>

#include "linux/contacts/VCardReader.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

const QString kBus = QStringLiteral("org.freedesktop.DBus");
const QString kBusPath = QStringLiteral("/org/freedesktop/DBus");
/// What the connection says of itself (D-Bus specification, "org.freedesktop.DBus.Local").
const QString kLocal = QStringLiteral("org.freedesktop.DBus.Local");
const QString kLocalPath = QStringLiteral("/org/freedesktop/DBus/Local");
const QString kObjects = QStringLiteral("org.freedesktop.DBus.ObjectManager");
const QString kProperties = QStringLiteral("org.freedesktop.DBus.Properties");
/// The services' names end in the number of their interface's version.
const QString kRegistryPrefix = QStringLiteral("org.gnome.evolution.dataserver.Sources");
const QString kRegistryPath = QStringLiteral("/org/gnome/evolution/dataserver/SourceManager");
const QString kFactoryPrefix = QStringLiteral("org.gnome.evolution.dataserver.AddressBook");
const QString kFactoryPath = QStringLiteral("/org/gnome/evolution/dataserver/AddressBookFactory");
const QString kFactory = QStringLiteral("org.gnome.evolution.dataserver.AddressBookFactory");
const QString kBook = QStringLiteral("org.gnome.evolution.dataserver.AddressBook");
const QString kView = QStringLiteral("org.gnome.evolution.dataserver.AddressBookView");
/// The query that every card meets (libebook's queries are S-expressions).
const QString kEverything = QStringLiteral("(contains \"x-evolution-any-field\" \"\")");

/// The newest version of a service among names; empty for none.
QString newest(const QStringList& names, const QString& prefix) {
    int best = -1;
    for (const QString& name : names) {
        bool isNumber = false;
        const int version = name.startsWith(prefix) ? name.mid(prefix.size()).toInt(&isNumber) : 0;
        best = isNumber ? std::max(best, version) : best;
    }
    return best < 0 ? QString() : prefix + QString::number(best);
}

QString pathIn(const QVariant& value) {
    return value.canConvert<QDBusObjectPath>() ? value.value<QDBusObjectPath>().path() : value.toString();
}

const platform::Log& log() {
    return platform::areaLog(platform::LogArea::Contacts);
}

}  // namespace

struct AddressBooks::Opened {
    BookSource source;
    QString service, path, view;
    std::string cards;
    bool isFailed = false;
    bool isReading = false;
    bool isStale = false;
};

AddressBooks::AddressBooks(QDBusConnection bus, Read read, const Pauses& pauses)
    : bus_(std::move(bus)), read_(std::move(read)), pauses_(pauses), pause_(pauses.retry) {
    for (QTimer* timer : {&partial_, &quiet_, &retry_}) {
        timer->setSingleShot(true);
    }
    partial_.setInterval(pauses_.partial);
    quiet_.setInterval(pauses_.quiet);
    connect(&partial_, &QTimer::timeout, this, [this] { tell(false); });
    connect(&quiet_, &QTimer::timeout, this, [this] { refresh(); });
    connect(&retry_, &QTimer::timeout, this, [this] {
        const bool isLost = books_.empty() || isStale_;
        isLost ? start() : refresh();
    });
    // What was asked of a bus that goes is not answered, nor does it end.
    bus_.connect(QString(), kLocalPath, kLocal, QStringLiteral("Disconnected"), this, SLOT(start()));
}

AddressBooks::~AddressBooks() = default;

void AddressBooks::call(const QDBusMessage& message, Answered answered) {
    auto* watcher = new QDBusPendingCallWatcher(bus_.asyncCall(message, pauses_.answer), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [this, generation = generation_, answered = std::move(answered)](QDBusPendingCallWatcher* finished) {
                finished->deleteLater();
                if (generation == generation_) {
                    answered(finished->reply());
                }
            });
}

void AddressBooks::callBook(const OpenedBook& book, const QString& method, const QVariantList& arguments,
                            Answered answered) {
    QDBusMessage message = QDBusMessage::createMethodCall(book->service, book->path, kBook, method);
    message.setArguments(arguments);
    call(message, [this, book, method, answered = std::move(answered)](const QDBusMessage& answer) {
        if (answer.type() == QDBusMessage::ReplyMessage) {
            answered(answer);
        } else {
            failed(method, answer);
            ended(book, false);
        }
    });
}

void AddressBooks::start() {
    ++generation_;
    isStale_ = false;
    retry_.stop();
    if (!bus_.isConnected()) {
        tell(true);
        return;
    }
    partial_.start();
    findServices();
}

void AddressBooks::findServices() {
    const auto ask = [this](const char* method, Answered answered) {
        call(QDBusMessage::createMethodCall(kBus, kBusPath, kBus, QLatin1String(method)), std::move(answered));
    };
    ask("ListActivatableNames", [this, ask](const QDBusMessage& activatable) {
        ask("ListNames", [this, activatable](const QDBusMessage& running) {
            const QStringList names =
                activatable.arguments().value(0).toStringList() + running.arguments().value(0).toStringList();
            registry_ = newest(names, kRegistryPrefix);
            factory_ = newest(names, kFactoryPrefix);
            if (registry_.isEmpty() || factory_.isEmpty()) {
                // A desktop without address books; or with some that were there a moment ago.
                isStale_ = !books_.empty();
                tell(true);
                if (isStale_) {
                    retryLater();
                }
                return;
            }
            listBooks();
        });
    });
}

void AddressBooks::listBooks() {
    const char* changed = SLOT(sourcesChanged(QDBusMessage));
    for (const char* signal : {"InterfacesAdded", "InterfacesRemoved"}) {
        bus_.connect(registry_, kRegistryPath, kObjects, QLatin1String(signal), this, changed);
    }
    // What a source says of itself, such as whether it is enabled.
    bus_.connect(registry_, QString(), kProperties, QStringLiteral("PropertiesChanged"), this, changed);
    owners_ = std::make_unique<QDBusServiceWatcher>();
    owners_->setConnection(bus_);
    owners_->setWatchMode(QDBusServiceWatcher::WatchForUnregistration);
    owners_->addWatchedService(registry_);
    owners_->addWatchedService(factory_);
    connect(owners_.get(), &QDBusServiceWatcher::serviceUnregistered, this, [this](const QString& name) {
        log().write(platform::LogLevel::Info, "the address books' service %@ has gone",
                    platform::FormatArgument(name.toStdString()).shown());
        isStale_ = true;
        retryLater();
    });
    call(QDBusMessage::createMethodCall(registry_, kRegistryPath, kObjects, QStringLiteral("GetManagedObjects")),
         [this](const QDBusMessage& answer) {
             const auto sources = BookSources::of(answer);
             if (!sources) {
                 failed(QStringLiteral("GetManagedObjects"), answer);
                 isStale_ = true;
                 tell(true);
                 retryLater();
                 return;
             }
             std::map<QString, OpenedBook> found;
             for (const BookSource& source : *sources) {
                 const auto book = std::make_shared<Opened>();
                 book->source = source;
                 if (const auto before = books_.find(source.uid); before != books_.end()) {
                     book->cards = before->second->cards;
                 }
                 found.emplace(source.uid, book);
             }
             books_ = std::move(found);
             for (const auto& [uid, book] : books_) {
                 open(book);
             }
             if (books_.empty()) {
                 tell(true);
             }
         });
}

void AddressBooks::open(const OpenedBook& book) {
    book->isReading = true;
    QDBusMessage message =
        QDBusMessage::createMethodCall(factory_, kFactoryPath, kFactory, QStringLiteral("OpenAddressBook"));
    message << book->source.uid;
    call(message, [this, book](const QDBusMessage& answer) {
        book->path = pathIn(answer.arguments().value(0));
        book->service = answer.arguments().value(1).toString();
        if (answer.type() != QDBusMessage::ReplyMessage || !book->path.startsWith(QLatin1Char('/')) ||
            book->service.isEmpty()) {
            failed(QStringLiteral("OpenAddressBook"), answer);
            ended(book, false);
            return;
        }
        callBook(book, QStringLiteral("Open"), {}, [this, book](const QDBusMessage&) { watch(book); });
    });
}

void AddressBooks::watch(const OpenedBook& book) {
    // Before it is read: nothing that changes meanwhile is missed.
    callBook(book, QStringLiteral("GetView"), {kEverything}, [this, book](const QDBusMessage& answer) {
        book->view = pathIn(answer.arguments().value(0));
        if (book->view.startsWith(QLatin1Char('/'))) {
            const char* changed = SLOT(contentsChanged(QDBusMessage));
            for (const char* signal : {"ObjectsAdded", "ObjectsModified", "ObjectsRemoved"}) {
                bus_.connect(book->service, book->view, kView, QLatin1String(signal), this, changed);
            }
            // It need not tell what is there already.
            QDBusMessage flags =
                QDBusMessage::createMethodCall(book->service, book->view, kView, QStringLiteral("SetFlags"));
            flags << 0U;
            bus_.asyncCall(flags, pauses_.answer);
            bus_.asyncCall(QDBusMessage::createMethodCall(book->service, book->view, kView, QStringLiteral("Start")),
                           pauses_.answer);
        }
        read(book);
    });
}

void AddressBooks::read(const OpenedBook& book) {
    book->isStale = false;
    callBook(book, QStringLiteral("GetContactList"), {kEverything},
             [this, book](const QDBusMessage& answer) { take(book, answer); });
}

void AddressBooks::take(const OpenedBook& book, const QDBusMessage& answer) {
    if (answer.signature() != QLatin1String("as")) {
        failed(QStringLiteral("GetContactList"), answer);
        ended(book, false);
        return;
    }
    std::string cards;
    bool isWhole = true;
    for (const QString& card : answer.arguments().value(0).toStringList()) {
        const QByteArray bytes = card.toUtf8();
        isWhole = cards.size() + static_cast<std::size_t>(bytes.size()) <= VCardReader::kLargestFile;
        if (!isWhole) {
            break;
        }
        cards.append(bytes.constData(), static_cast<std::size_t>(bytes.size())).append("\r\n");
    }
    if (isWhole) {
        book->cards = std::move(cards);
    } else {
        failed(QStringLiteral("GetContactList"), answer);
    }
    ended(book, isWhole);
}

void AddressBooks::ended(const OpenedBook& book, bool isRead) {
    book->isFailed = !isRead;
    book->isReading = false;
    if (!isRead) {
        retryLater();
    } else if (book->isStale) {
        quiet_.start();
    }
    // Of the books that there are now: this one may have been replaced while it was read.
    const auto none = [this](bool Opened::*is) {
        return std::none_of(books_.begin(), books_.end(), [is](const auto& entry) { return (*entry.second).*is; });
    };
    const bool isOver = none(&Opened::isReading);
    const bool isWell = none(&Opened::isFailed);
    if (isOver && isWell && !isStale_) {
        pause_ = pauses_.retry;
    }
    if (isOver) {
        tell(true);
    }
}

void AddressBooks::failed(const QString& what, const QDBusMessage& answer) {
    const bool isError = answer.type() == QDBusMessage::ErrorMessage;
    log().write(platform::LogLevel::Default, "an address book cannot be read (%@): %@; its contacts stay as they were",
                platform::FormatArgument(what.toStdString()).shown(),
                platform::FormatArgument(isError ? answer.errorName().toStdString()
                                                 : std::string("the answer is not what was asked for"))
                    .shown());
}

void AddressBooks::retryLater() {
    if (!retry_.isActive()) {
        retry_.start(pause_);
        pause_ = std::min(pause_ * 2, pauses_.longest);
    }
}

void AddressBooks::sourcesChanged(const QDBusMessage& signal) {
    // Opening a book changes what its source says of the connection.
    const QString facts = QStringLiteral("Data");
    const QVariantList said = signal.arguments();
    if (signal.member() == QLatin1String("PropertiesChanged") &&
        !qdbus_cast<QVariantMap>(said.value(1)).contains(facts) && !said.value(2).toStringList().contains(facts)) {
        return;
    }
    isStale_ = true;
    quiet_.start();
}

void AddressBooks::contentsChanged(const QDBusMessage& signal) {
    for (const auto& [uid, book] : books_) {
        if (book->view == signal.path()) {
            book->isStale = true;
            quiet_.start();
        }
    }
}

void AddressBooks::refresh() {
    if (isStale_) {
        start();
        return;
    }
    for (const auto& [uid, book] : books_) {
        if (!book->isReading && book->isFailed) {
            open(book);
        } else if (!book->isReading && book->isStale) {
            book->isReading = true;
            read(book);
        }
    }
}

void AddressBooks::tell(bool isComplete) {
    if (isComplete) {
        partial_.stop();
    }
    std::vector<Book> books;
    for (const auto& [uid, book] : books_) {
        books.push_back({book->source.name.toStdString(), book->cards});
    }
    if (!wasTold_ || isComplete || books != told_) {
        wasTold_ = true;
        told_ = books;
        read_(told_, isComplete);
    }
}

}  // namespace ktr::linux_
