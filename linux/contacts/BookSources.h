#pragma once

#include <QDBusMessage>
#include <QString>
#include <optional>
#include <vector>

namespace ktr::linux_ {

/// An address book of the desktop's, as the registry of Evolution Data Server names it.
struct BookSource {
    QString uid;
    QString name;  ///< for people
};

/// Reads what the registry answers. Whatever that holds: who answers is some other process. Any thread.
class BookSources {
  public:
    /// So many books are opened, the first.
    static constexpr std::size_t kMost = 64;

    /// The enabled address books of an answer to GetManagedObjects (org.freedesktop.DBus.ObjectManager), by identifier.
    /// A book is enabled when it and all that it belongs to are. None for an answer of another form.
    static std::optional<std::vector<BookSource>> of(const QDBusMessage& answer);
};

}  // namespace ktr::linux_
