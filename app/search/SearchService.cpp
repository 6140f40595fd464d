#include "app/search/SearchService.h"

#include <QDBusArgument>
#include <QDBusError>
#include <QDBusMetaType>
#include <QDBusVariant>
#include <QStringList>
#include <QVariantMap>
#include <algorithm>
#include <utility>

#include "ask/Question.h"
#include "documents/Words.h"

namespace ktr::app {

/// As the shell reads a picture by its name: (sv), "themed" and its names.
struct ThemedIcon {
    QString kind = QStringLiteral("themed");
    QDBusVariant names;
};

/// As the runner reads a result: (sssida{sv}).
struct RunnerMatch {
    QString id;
    QString text;
    QString icon;
    int type = 0;
    double relevance = 0.0;
    QVariantMap properties;
};

/// (sss): there are none beside opening.
struct RunnerAction {
    QString id;
    QString text;
    QString icon;
};

}  // namespace ktr::app

Q_DECLARE_METATYPE(ktr::app::ThemedIcon)
Q_DECLARE_METATYPE(ktr::app::RunnerAction)
Q_DECLARE_METATYPE(ktr::app::RunnerMatch)

namespace ktr::app {

QDBusArgument& operator<<(QDBusArgument& to, const ThemedIcon& icon) {
    to.beginStructure();
    to << icon.kind << icon.names;
    to.endStructure();
    return to;
}

const QDBusArgument& operator>>(const QDBusArgument& from, ThemedIcon& icon) {
    from.beginStructure();
    from >> icon.kind >> icon.names;
    from.endStructure();
    return from;
}

QDBusArgument& operator<<(QDBusArgument& to, const RunnerMatch& match) {
    to.beginStructure();
    to << match.id << match.text << match.icon << match.type << match.relevance << match.properties;
    to.endStructure();
    return to;
}

const QDBusArgument& operator>>(const QDBusArgument& from, RunnerMatch& match) {
    from.beginStructure();
    from >> match.id >> match.text >> match.icon >> match.type >> match.relevance >> match.properties;
    from.endStructure();
    return from;
}

QDBusArgument& operator<<(QDBusArgument& to, const RunnerAction& action) {
    to.beginStructure();
    to << action.id << action.text << action.icon;
    to.endStructure();
    return to;
}

const QDBusArgument& operator>>(const QDBusArgument& from, RunnerAction& action) {
    from.beginStructure();
    from >> action.id >> action.text >> action.icon;
    from.endStructure();
    return from;
}

namespace {

const QString kShell = QStringLiteral("org.gnome.Shell.SearchProvider2");
const QString kRunner = QStringLiteral("org.kde.krunner1");
const QString kIcon = QStringLiteral("org.ktr.ktr");
/// The runner's sorts of matches.
constexpr int kPossible = 30;
constexpr int kExact = 100;
constexpr double kSure = 1.0;
constexpr double kLikely = 0.7;
/// Of one call so many results are described; the others have a name and no more.
constexpr qsizetype kMostDescribed = 64;
constexpr std::size_t kMostWaiting = 64;

const char* const kInterfaces =
    R"xml(<interface name="org.gnome.Shell.SearchProvider2">
<method name="GetInitialResultSet"><arg type="as" name="terms" direction="in"/><arg type="as" name="results" direction="out"/></method>
<method name="GetSubsearchResultSet"><arg type="as" name="previous_results" direction="in"/><arg type="as" name="terms" direction="in"/><arg type="as" name="results" direction="out"/></method>
<method name="GetResultMetas"><arg type="as" name="identifiers" direction="in"/><arg type="aa{sv}" name="metas" direction="out"/></method>
<method name="ActivateResult"><arg type="s" name="identifier" direction="in"/><arg type="as" name="terms" direction="in"/><arg type="u" name="timestamp" direction="in"/></method>
<method name="LaunchSearch"><arg type="as" name="terms" direction="in"/><arg type="u" name="timestamp" direction="in"/></method>
</interface><interface name="org.kde.krunner1">
<method name="Match"><arg type="s" name="query" direction="in"/><arg type="a(sssida{sv})" name="matches" direction="out"/></method>
<method name="Actions"><arg type="a(sss)" name="matches" direction="out"/></method>
<method name="Run"><arg type="s" name="matchId" direction="in"/><arg type="s" name="actionId" direction="in"/></method>
<method name="Config"><arg type="a{sv}" name="config" direction="out"/></method>
<method name="Teardown"/>
</interface>)xml";

/// Names and places come from others: nothing in them ends a line or turns what stands around them.
QString line(const std::string& text) {
    return QString::fromStdString(documents::withoutControls(text));
}

/// The words as they were typed; none for more than anybody types.
std::string textOf(const QStringList& terms) {
    qsizetype length = 0;
    for (const QString& term : terms) {
        length += term.size() + 1;
    }
    const auto most = static_cast<qsizetype>(ask::Question::kLongest);
    return length > most ? std::string() : terms.join(u' ').toStdString();
}

QStringList idsOf(const std::vector<SearchDesk::Result>& results) {
    QStringList ids;
    for (const SearchDesk::Result& result : results) {
        ids << QString::fromStdString(result.id);
    }
    return ids;
}

QVariantMap metaOf(const QString& id, const SearchDesk::Result& result) {
    const ThemedIcon icon{QStringLiteral("themed"), QDBusVariant(QStringList{kIcon})};
    QVariantMap meta{{QStringLiteral("id"), id},
                     {QStringLiteral("name"), line(result.title)},
                     {QStringLiteral("icon"), QVariant::fromValue(icon)}};
    if (!result.description.empty()) {
        meta.insert(QStringLiteral("description"), line(result.description));
    }
    return meta;
}

/// Of a result that is not selected the runner shows the text alone, as styled text when it may take more than a line.
RunnerMatch matchOf(const SearchDesk::Result& result) {
    const QString text = line(result.isAnswer ? result.description : result.title).toHtmlEscaped();
    const QString other = line(result.isAnswer ? result.title : result.description);
    return {QString::fromStdString(result.id),
            text,
            kIcon,
            result.isWhole ? kExact : kPossible,
            result.isWhole ? kSure : kLikely,
            {{QStringLiteral("subtext"), other},
             {QStringLiteral("category"), QStringLiteral("ktr")},
             {QStringLiteral("multiline"), true},
             {QStringLiteral("actions"), QStringList()}}};
}

}  // namespace

SearchService::SearchService(SearchDesk& desk, const QDBusConnection& bus, Open open, std::function<void()> heard)
    : desk_(desk), bus_(bus), open_(std::move(open)), heard_(std::move(heard)) {
    qDBusRegisterMetaType<ThemedIcon>();
    qDBusRegisterMetaType<RunnerMatch>();
    qDBusRegisterMetaType<QList<RunnerMatch>>();
    qDBusRegisterMetaType<RunnerAction>();
    qDBusRegisterMetaType<QList<RunnerAction>>();
    qDBusRegisterMetaType<QList<QVariantMap>>();
    connect(&patience_, &QTimer::timeout, this, [this] { setReady(); });
    patience_.setSingleShot(true);
    patience_.start(kPatience);
}

void SearchService::setReady() {
    isReady_ = true;
    patience_.stop();
    for (const QDBusMessage& message : std::exchange(waiting_, {})) {
        answer(message);
    }
}

QString SearchService::introspect(const QString& /*path*/) const {
    return QString::fromLatin1(kInterfaces);
}

bool SearchService::handleMessage(const QDBusMessage& message, const QDBusConnection& /*connection*/) {
    if (message.interface() != kShell && message.interface() != kRunner) {
        return false;
    }
    heard_();
    message.setDelayedReply(true);
    if (isReady_ || waiting_.size() >= kMostWaiting) {
        answer(message);
    } else {
        waiting_.push_back(message);
    }
    return true;
}

void SearchService::answer(const QDBusMessage& message) {
    const bool isAnswered = message.interface() == kShell ? answerShell(message) : answerRunner(message);
    if (!isAnswered) {
        bus_.send(message.createErrorReply(QDBusError::UnknownMethod, QStringLiteral("There is no such method")));
    }
}

void SearchService::reply(const QDBusMessage& message, const QVariant& value) {
    bus_.send(message.createReply(value));
}

bool SearchService::answerShell(const QDBusMessage& message) {
    const QString call = message.member() + u' ' + message.signature();
    const QVariantList given = message.arguments();
    if (call == QLatin1String("GetInitialResultSet as")) {
        reply(message, idsOf(desk_.results(textOf(given[0].toStringList()))));
    } else if (call == QLatin1String("GetSubsearchResultSet asas")) {
        const QStringList before = given[0].toStringList();
        const QStringList ids = idsOf(desk_.results(textOf(given[1].toStringList())));
        // Never more than before. But where there were none nothing was searched yet: a letter alone, half a question.
        reply(message, before.isEmpty() ? ids : ids.mid(0, before.size()));
    } else if (call == QLatin1String("GetResultMetas as")) {
        const QStringList ids = given[0].toStringList();
        QList<QVariantMap> metas;
        for (const QString& id : ids) {
            const bool isDescribed = metas.size() < kMostDescribed;
            metas << metaOf(id, isDescribed ? desk_.result(id.toStdString()) : SearchDesk::Result());
        }
        reply(message, QVariant::fromValue(metas));
    } else if (call == QLatin1String("ActivateResult sasu")) {
        open_(desk_.opening(given[0].toString().toStdString()));
        bus_.send(message.createReply());
    } else if (call == QLatin1String("LaunchSearch asu")) {
        open_(desk_.openingOf(textOf(given[0].toStringList())));
        bus_.send(message.createReply());
    } else {
        return false;
    }
    return true;
}

bool SearchService::answerRunner(const QDBusMessage& message) {
    const QString call = message.member() + u' ' + message.signature();
    const QVariantList given = message.arguments();
    if (call == QLatin1String("Match s")) {
        QList<RunnerMatch> matches;
        for (const SearchDesk::Result& result : desk_.results(textOf({given[0].toString()}))) {
            matches << matchOf(result);
        }
        reply(message, QVariant::fromValue(matches));
    } else if (call == QLatin1String("Actions ")) {
        reply(message, QVariant::fromValue(QList<RunnerAction>()));
    } else if (call == QLatin1String("Run ss")) {
        open_(desk_.opening(given[0].toString().toStdString()));
        bus_.send(message.createReply());
    } else if (call == QLatin1String("Config ")) {
        reply(message, QVariantMap());
    } else if (call == QLatin1String("Teardown ")) {
        desk_.forget();
        bus_.send(message.createReply());
    } else {
        return false;
    }
    return true;
}

}  // namespace ktr::app
