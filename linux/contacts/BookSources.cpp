#include "linux/contacts/BookSources.h"

#include <QDBusArgument>
#include <QDBusObjectPath>
#include <QMap>
#include <QStringList>
#include <QVariantMap>

namespace ktr::linux_ {

namespace {

const QString kSource = QStringLiteral("org.gnome.evolution.dataserver.Source");
/// A source belongs to another, and that to another: no deeper than this.
constexpr int kDeepest = 16;

/// A source's key file (Desktop Entry Specification, "Basic format of the file"), as far as it matters here.
struct Facts {
    QString name;
    QString parent;
    bool isEnabled = true;
    bool isBook = false;
};

Facts factsOf(const QString& data) {
    Facts facts;
    QString group;
    for (const QString& whole : data.split(QLatin1Char('\n'))) {
        const QString line = whole.trimmed();
        if (line.startsWith(QLatin1Char('[')) && line.endsWith(QLatin1Char(']'))) {
            group = line.mid(1, line.size() - 2);
            facts.isBook = facts.isBook || group == QLatin1String("Address Book");
        } else if (group == QLatin1String("Data Source")) {
            const QString key = line.section(QLatin1Char('='), 0, 0).trimmed();
            const QString value = line.section(QLatin1Char('='), 1).trimmed();
            if (key == QLatin1String("DisplayName")) {
                facts.name = value;
            } else if (key == QLatin1String("Parent")) {
                facts.parent = value;
            } else if (key == QLatin1String("Enabled")) {
                facts.isEnabled = value != QLatin1String("false");
            }
        }
    }
    return facts;
}

using Known = QMap<QString, Facts>;

Known knownOf(const QDBusMessage& answer) {
    Known known;
    const auto argument = answer.arguments().value(0).value<QDBusArgument>();
    argument.beginMap();
    while (!argument.atEnd()) {
        QDBusObjectPath path;
        QMap<QString, QVariantMap> interfaces;
        argument.beginMapEntry();
        argument >> path >> interfaces;
        argument.endMapEntry();
        const QVariantMap source = interfaces.value(kSource);
        const QString uid = source.value(QStringLiteral("UID")).toString();
        if (!uid.isEmpty()) {
            known.insert(uid, factsOf(source.value(QStringLiteral("Data")).toString()));
        }
    }
    argument.endMap();
    return known;
}

bool isEnabled(const Known& known, QString uid) {
    for (int depth = 0; depth < kDeepest && known.contains(uid); ++depth) {
        const Facts facts = known.value(uid);
        if (!facts.isEnabled) {
            return false;
        }
        uid = facts.parent;
    }
    return true;
}

}  // namespace

std::optional<std::vector<BookSource>> BookSources::of(const QDBusMessage& answer) {
    if (answer.type() != QDBusMessage::ReplyMessage || answer.signature() != QLatin1String("a{oa{sa{sv}}}")) {
        return std::nullopt;
    }
    const Known known = knownOf(answer);
    std::vector<BookSource> books;
    for (auto source = known.begin(); source != known.end() && books.size() < kMost; ++source) {
        if (source->isBook && isEnabled(known, source.key())) {
            books.push_back({source.key(), source->name});
        }
    }
    return books;
}

}  // namespace ktr::linux_
