#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QObject>
#include <QString>
#include <QTimer>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "linux/contacts/BookSources.h"

class QDBusServiceWatcher;

namespace ktr::linux_ {

/// The desktop's address books: all that Evolution Data Server keeps and that are enabled, read over the message bus
/// and followed. It waits for nobody: a service that is slow, lies or dies costs its books' cards, which stay as they
/// were when they were read before, one line in the log, and another attempt after a pause that grows. Of a thread with
/// an event loop; all of it there.
class AddressBooks : public QObject {
    Q_OBJECT

  public:
    struct Book {
        std::string name;   ///< for people
        std::string cards;  ///< vCards, as the service has them; empty: nothing could be read
        bool operator==(const Book&) const = default;
    };
    /// `isComplete`: every book was read, or could not be.
    using Read = std::function<void(const std::vector<Book>& books, bool isComplete)>;

    /// Milliseconds.
    struct Pauses {
        int answer = 10000;    ///< what a call may take
        int partial = 700;     ///< after this, what was read until then is told
        int quiet = 300;       ///< a burst of changes is over
        int retry = 5000;      ///< the first pause before another attempt; each is twice the one before
        int longest = 960000;  ///< the longest
    };

    /// `read` is called with all books, in the order of their identifiers, whenever they have become others.
    AddressBooks(QDBusConnection bus, Read read) : AddressBooks(std::move(bus), std::move(read), Pauses()) {}
    AddressBooks(QDBusConnection bus, Read read, const Pauses& pauses);
    ~AddressBooks() override;

  public Q_SLOTS:
    void start();

  private Q_SLOTS:
    void sourcesChanged(const QDBusMessage& signal);
    void contentsChanged(const QDBusMessage& signal);

  private:
    struct Opened;
    using OpenedBook = std::shared_ptr<Opened>;
    using Answered = std::function<void(const QDBusMessage& answer)>;

    void findServices();
    void listBooks();
    void open(const OpenedBook& book);
    void watch(const OpenedBook& book);
    void read(const OpenedBook& book);
    void take(const OpenedBook& book, const QDBusMessage& answer);
    void ended(const OpenedBook& book, bool isRead);
    void failed(const QString& what, const QDBusMessage& answer);
    void retryLater();
    void refresh();
    void tell(bool isComplete);

    /// `answered` gets the answer or the error, unless everything began anew meanwhile.
    void call(const QDBusMessage& message, Answered answered);
    void callBook(const OpenedBook& book, const QString& method, const QVariantList& arguments, Answered answered);

    QDBusConnection bus_;
    Read read_;
    const Pauses pauses_;
    QString registry_, factory_;  ///< names on the bus
    std::unique_ptr<QDBusServiceWatcher> owners_;
    /// By identifier.
    std::map<QString, OpenedBook> books_;
    int generation_ = 0;
    bool isStale_ = false;
    bool wasTold_ = false;
    std::vector<Book> told_;
    int pause_ = 0;
    QTimer partial_, quiet_, retry_;
};

}  // namespace ktr::linux_
