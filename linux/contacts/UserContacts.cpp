#include "linux/contacts/UserContacts.h"

#include <QDBusConnection>
#include <QFileSystemWatcher>
#include <QThread>
#include <QTimer>
#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <utility>

#include "linux/contacts/AddressBooks.h"
#include "linux/contacts/BookPhotos.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// A tool that writes a folder of cards is given so long to write the next one, milliseconds.
constexpr int kQuiet = 300;
constexpr unsigned long kEnd = 2000;  // milliseconds

const platform::Log& log() {
    return platform::areaLog(platform::LogArea::Contacts);
}

}  // namespace

/// What both threads see.
struct UserContacts::Shared {
    std::mutex mutex;
    std::condition_variable changedHere;
    platform::MainLoop* mainLoop = nullptr;  ///< none once its owner wants nothing more
    Contacts contacts;
    std::string error;
    bool isComplete = false;
    int version = 0;
    // Of the main thread.
    std::function<void(const Contacts&)> changed;
    int given = 0;

    static void deliver(const std::shared_ptr<Shared>& shared) {
        Contacts contacts;
        {
            const std::lock_guard<std::mutex> lock(shared->mutex);
            if (shared->given == shared->version || !shared->changed) {
                return;
            }
            shared->given = shared->version;
            contacts = shared->contacts;
        }
        shared->changed(contacts);
    }
};

/// Reads, on the thread of its own.
class UserContacts::Reader : public QObject {
  public:
    Reader(std::shared_ptr<Shared> shared, Paths paths, std::string bus, bool usesBooks)
        : shared_(std::move(shared)), paths_(std::move(paths)), address_(std::move(bus)), usesBooks_(usesBooks) {}
    ~Reader() override { closeBooks(); }

    void begin() {
        watcher_ = std::make_unique<QFileSystemWatcher>();
        quiet_ = std::make_unique<QTimer>();
        quiet_->setSingleShot(true);
        quiet_->setInterval(kQuiet);
        const auto touched = [this](const QString&) { quiet_->start(); };
        connect(watcher_.get(), &QFileSystemWatcher::fileChanged, this, touched);
        connect(watcher_.get(), &QFileSystemWatcher::directoryChanged, this, touched);
        connect(quiet_.get(), &QTimer::timeout, this, [this] { readFiles(false); });
        booksAreComplete_ = !usesBooks_;
        readFiles(true);
        if (usesBooks_) {
            openBooks();
        }
    }
    void setUsesBooks(bool usesBooks) {
        if (std::exchange(usesBooks_, usesBooks) == usesBooks) {
            return;
        }
        if (usesBooks) {
            openBooks();
            return;
        }
        closeBooks();
        read_.clear();
        booksAreComplete_ = true;
        tell();
    }
    void setPaths(Paths paths) {
        paths_ = std::move(paths);
        const QStringList known = watcher_->files() + watcher_->directories();
        if (!known.isEmpty()) {
            watcher_->removePaths(known);
        }
        readFiles(false);
    }

  private:
    void watch() {
        const QStringList known = watcher_->files() + watcher_->directories();
        for (const std::string& path : ContactFiles::watched(paths_)) {
            if (const QString name = QString::fromStdString(path); !known.contains(name)) {
                watcher_->addPath(name);
            }
        }
    }

    void readFiles(bool isFirst) {
        watch();
        std::string error;
        auto read = ContactFiles::read(paths_, error);
        if (read) {
            files_ = std::move(*read);
            tell();
        } else if (isFirst) {
            fail(error);
        } else {
            log().write(platform::LogLevel::Error, "the contacts stay as they were: %@",
                        platform::FormatArgument(error).shown());
        }
    }

    void openBooks() {
        connection_ = QStringLiteral("ktr-address-books-%1").arg(reinterpret_cast<quintptr>(this));
        const auto bus = address_.empty()
                             ? QDBusConnection::connectToBus(QDBusConnection::SessionBus, connection_)
                             : QDBusConnection::connectToBus(QString::fromStdString(address_), connection_);
        books_ =
            std::make_unique<AddressBooks>(bus, [this](const std::vector<AddressBooks::Book>& books, bool isComplete) {
                takeBooks(books);
                booksAreComplete_ = booksAreComplete_ || isComplete;
                tell();
            });
        books_->start();
    }

    void closeBooks() {
        books_.reset();
        if (!connection_.isEmpty()) {
            QDBusConnection::disconnectFromBus(connection_);
            connection_.clear();
        }
    }

    void takeBooks(const std::vector<AddressBooks::Book>& books) {
        std::vector<Read> now;
        const auto folders = BookPhotos::folders();
        for (const AddressBooks::Book& book : books) {
            const auto same =
                std::find_if(read_.begin(), read_.end(), [&](const Read& one) { return one.book == book; });
            if (same != read_.end()) {
                now.push_back(*same);
            } else {
                now.push_back(
                    {book, ContactFiles::readText(BookPhotos::withPhotos(book.cards, folders), "address book")});
            }
        }
        read_ = std::move(now);
    }

    Contacts all() const {
        Contacts all = files_;
        for (const Read& one : read_) {
            all.insert(all.end(), one.contacts.begin(), one.contacts.end());
        }
        return all;
    }

    void fail(const std::string& error) {
        const std::lock_guard<std::mutex> lock(shared_->mutex);
        shared_->error = error;
        shared_->changedHere.notify_all();
    }

    void tell() {
        Contacts contacts = all();
        const std::lock_guard<std::mutex> lock(shared_->mutex);
        const bool isNew = contacts != shared_->contacts;
        shared_->contacts = std::move(contacts);
        shared_->isComplete = booksAreComplete_;
        if (!isNew) {
            shared_->changedHere.notify_all();
            return;
        }
        ++shared_->version;
        shared_->changedHere.notify_all();
        if (shared_->mainLoop != nullptr) {
            shared_->mainLoop->post([weak = std::weak_ptr<Shared>(shared_)] {
                if (const auto shared = weak.lock()) {
                    Shared::deliver(shared);
                }
            });
        }
    }

    /// Cards as they came, and what they say.
    struct Read {
        AddressBooks::Book book;
        Contacts contacts;
    };

    std::shared_ptr<Shared> shared_;
    Paths paths_;
    const std::string address_;
    bool usesBooks_;
    QString connection_;
    std::unique_ptr<QFileSystemWatcher> watcher_;
    /// Runs out when a burst of changes is over.
    std::unique_ptr<QTimer> quiet_;
    std::unique_ptr<AddressBooks> books_;
    Contacts files_;
    std::vector<Read> read_;
    bool booksAreComplete_ = false;
};

UserContacts::UserContacts(const std::shared_ptr<platform::MainLoop>& mainLoop, Paths paths, std::string bus,
                           bool usesBooks)
    : shared_(std::make_shared<Shared>()), thread_(std::make_unique<QThread>()) {
    shared_->mainLoop = mainLoop.get();
    reader_ = new Reader(shared_, std::move(paths), std::move(bus), usesBooks);
    reader_->moveToThread(thread_.get());
    QObject::connect(thread_.get(), &QThread::finished, reader_, &QObject::deleteLater);
    thread_->start();
    QMetaObject::invokeMethod(
        reader_, [reader = reader_] { reader->begin(); }, Qt::QueuedConnection);
}

UserContacts::~UserContacts() {
    {
        const std::lock_guard<std::mutex> lock(shared_->mutex);
        shared_->mainLoop = nullptr;
    }
    shared_->changed = nullptr;
    thread_->quit();
    if (!thread_->wait(kEnd)) {
        // It hangs in the system, which takes it when the program ends.
        static_cast<void>(thread_.release());
    }
}

UserContacts::Contacts UserContacts::first(double seconds, std::string& error) {
    std::unique_lock<std::mutex> lock(shared_->mutex);
    const bool isThere = shared_->changedHere.wait_for(lock, std::chrono::duration<double>(seconds), [this] {
        return shared_->isComplete || !shared_->error.empty();
    });
    if (!isThere) {
        log().write(platform::LogLevel::Default,
                    "not all contacts have been read yet; the rest is shown when it is there");
    }
    error = shared_->error;
    shared_->given = shared_->version;
    return shared_->contacts;
}

void UserContacts::follow(std::function<void(const Contacts&)> changed) {
    shared_->changed = std::move(changed);
    Shared::deliver(shared_);
}

void UserContacts::setPaths(Paths paths) {
    QMetaObject::invokeMethod(
        reader_, [reader = reader_, paths = std::move(paths)] { reader->setPaths(paths); }, Qt::QueuedConnection);
}

void UserContacts::setUsesBooks(bool usesBooks) {
    QMetaObject::invokeMethod(
        reader_, [reader = reader_, usesBooks] { reader->setUsesBooks(usesBooks); }, Qt::QueuedConnection);
}

}  // namespace ktr::linux_
