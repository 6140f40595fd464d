#include "linux/doctor/SessionChecks.h"

#include <langinfo.h>
#include <netdb.h>
#include <sys/socket.h>
#include <unistd.h>

#include <QDBusConnection>
#include <QDBusConnectionInterface>
#include <QDBusMessage>
#include <QDBusVariant>
#include <QFontDatabase>
#include <QRegularExpression>
#include <QUuid>
#include <array>
#include <clocale>
#include <memory>

#include "linux/contacts/ContactFiles.h"
#include "linux/device/Buses.h"
#include "linux/locale/QtLocalization.h"
#include "linux/maps/FolderGround.h"
#include "linux/maps/MbtilesLoader.h"
#include "linux/positions/TrackReader.h"
#include "platform/contacts/ContactStore.h"

namespace ktr::linux_::session_checks {

namespace {

using Finding = CheckUp::Finding;
using State = CheckUp::State;
using Cause = CheckUp::Cause;

constexpr int kCallTimeout = 3000;  // milliseconds

Finding fine(std::string thing, std::string words) {
    return {std::move(thing), State::Fine, std::move(words), {}};
}

Finding wrong(std::string thing, Cause cause, std::string words, std::string remedy) {
    return {std::move(thing), State::Wrong, std::move(words), std::move(remedy), 0.0, cause};
}

/// A connection of one check's own, ended with it.
class OwnBus {
  public:
    explicit OwnBus(const std::string& address)
        : name_(QStringLiteral("ktr-doctor-") + QUuid::createUuid().toString(QUuid::WithoutBraces)),
          isThere_(!address.empty() && Buses::greet(address) == Buses::Greeting::Answered),
          bus_(isThere_ ? QDBusConnection::connectToBus(QString::fromStdString(address), name_)
                        : QDBusConnection(name_)) {}
    ~OwnBus() {
        if (isThere_) {
            QDBusConnection::disconnectFromBus(name_);
        }
    }
    OwnBus(const OwnBus&) = delete;
    OwnBus& operator=(const OwnBus&) = delete;

    bool isThere() const { return isThere_ && bus_.isConnected(); }
    /// The answer's first value; none for an error or silence.
    std::optional<QVariant> ask(const char* service, const char* path, const char* interface, const char* method,
                                const QVariantList& arguments = {}) const {
        QDBusMessage message = QDBusMessage::createMethodCall(QLatin1String(service), QLatin1String(path),
                                                              QLatin1String(interface), QLatin1String(method));
        message.setArguments(arguments);
        const QDBusMessage answer = bus_.call(message, QDBus::Block, kCallTimeout);
        return answer.type() == QDBusMessage::ReplyMessage && !answer.arguments().isEmpty()
                   ? std::optional(answer.arguments().first())
                   : std::nullopt;
    }
    std::optional<QVariant> property(const char* service, const char* path, const char* interface,
                                     const char* name) const {
        const auto value = ask(service, path, "org.freedesktop.DBus.Properties", "Get",
                               {QLatin1String(interface), QLatin1String(name)});
        return value ? std::optional(value->value<QDBusVariant>().variant()) : std::nullopt;
    }
    /// Whether somebody has the name, or can be started for it.
    bool offers(const char* service) const { return names().contains(QLatin1String(service)); }
    /// The last in order that begins so and ends in a version; empty for none.
    QString nameLike(const char* beginning) const {
        const QStringList like = names().filter(QRegularExpression(
            QLatin1Char('^') + QRegularExpression::escape(QLatin1String(beginning)) + QStringLiteral("[0-9]+$")));
        return like.isEmpty() ? QString() : like.last();
    }

  private:
    QStringList names() const {
        QStringList all;
        for (const char* method : {"ListNames", "ListActivatableNames"}) {
            const auto names = ask("org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", method);
            all += names ? names->toStringList() : QStringList();
        }
        all.sort();
        return all;
    }

    const QString name_;
    const bool isThere_;
    QDBusConnection bus_;
};

bool connects(const std::string& host, int port) {
    addrinfo hints{};
    hints.ai_socktype = SOCK_STREAM;
    addrinfo* found = nullptr;
    if (::getaddrinfo(host.c_str(), std::to_string(port).c_str(), &hints, &found) != 0) {
        return false;
    }
    const std::unique_ptr<addrinfo, void (*)(addrinfo*)> list(found, ::freeaddrinfo);
    for (const addrinfo* one = found; one != nullptr; one = one->ai_next) {
        const int socket = ::socket(one->ai_family, one->ai_socktype | SOCK_CLOEXEC, one->ai_protocol);
        if (socket < 0) {
            continue;
        }
        const bool isThere = ::connect(socket, one->ai_addr, one->ai_addrlen) == 0;
        ::close(socket);
        if (isThere) {
            return true;
        }
    }
    return false;
}

}  // namespace

Finding contacts(const Configuration& configuration) {
    if (configuration.contacts.empty()) {
        return {"contacts", State::NotUsed, "no address book is named: names come from the answers",
                "ktr config set contacts FILE.vcf"};
    }
    std::string error;
    const auto read = ContactFiles::read(configuration.contacts, error);
    if (!read) {
        return wrong("contacts", Cause::Contacts, error, "ktr config set contacts FILE.vcf");
    }
    if (read->empty()) {
        return wrong("contacts", Cause::Contacts, "nobody is in them", "ktr config get contacts");
    }
    return fine("contacts", std::to_string(read->size()) + " people");
}

Finding addressBooks(const CheckUp::Places& places, const Configuration& configuration) {
    constexpr const char* kThing = "address books";
    constexpr const char* kRegistry = "org.gnome.evolution.dataserver.Sources";
    if (!configuration.addressBooks) {
        return {kThing, State::NotUsed, "they are switched off", "ktr config unset addressBooks"};
    }
    const OwnBus session(places.sessionBus);
    const QString registry = session.isThere() ? session.nameLike(kRegistry) : QString();
    if (registry.isEmpty()) {
        return {kThing, State::NotUsed, "this desktop keeps none", {}};
    }
    const auto sources = session.ask(registry.toUtf8().constData(), "/org/gnome/evolution/dataserver/SourceManager",
                                     "org.freedesktop.DBus.ObjectManager", "GetManagedObjects");
    return sources ? fine(kThing, "whoever keeps them answers")
                   : wrong(kThing, Cause::AddressBooks, "whoever keeps them does not answer",
                           "systemctl --user restart evolution-addressbook-factory evolution-source-registry");
}

Finding positions(const CheckUp::Places& places, const Configuration& configuration) {
    using Source = Configuration::Positions::Source;
    const auto& positions = configuration.positions;
    switch (positions.source) {
        case Source::None:
            return {"position", State::NotUsed, "none is asked for, so that there are no distances",
                    "ktr config set positions.source geoclue"};
        case Source::GeoClue: {
            const OwnBus bus(places.systemBus);
            return bus.isThere() && bus.offers("org.freedesktop.GeoClue2")
                       ? fine("position", "GeoClue tells it")
                       : wrong("position", Cause::Position, "GeoClue is not there, so that there are no distances",
                               "sudo apt install geoclue-2.0");
        }
        case Source::Gpsd:
            return connects(positions.gpsdHost, positions.gpsdPort)
                       ? fine("position", "gpsd listens")
                       : wrong("position", Cause::Position, "gpsd does not listen, so that there are no distances",
                               "sudo systemctl start gpsd");
        case Source::Track:
            break;
    }
    const auto track = TrackReader::readFile(positions.file);
    if (const auto* error = std::get_if<documents::DocumentError>(&track)) {
        return wrong("position", Cause::Position, error->text(), "ktr config set positions.file FILE.gpx");
    }
    return fine("position", "a track tells it");
}

Finding maps(const CheckUp::Places& places, const Configuration& configuration) {
    int opened = 0;
    for (const auto& source : configuration.maps.sources) {
        std::string error;
        if (!source.file.empty() && MbtilesLoader::open(source.file, error) == nullptr) {
            return wrong("maps", Cause::Map, source.file + ": " + error, "ktr config get maps.sources");
        }
        ++opened;
    }
    for (const auto& file : FolderGround::filesIn(places.maps)) {
        std::string error;
        if (MbtilesLoader::open(file.string(), error) == nullptr) {
            return wrong("maps", Cause::Map, file.string() + ": " + error, "ktr maps add FILE.mbtiles");
        }
        ++opened;
    }
    if (opened == 0) {
        return {"maps", State::NotUsed, "towns, borders and large roads alone: no streets are named",
                "ktr maps add FILE.mbtiles"};
    }
    return fine("maps", std::to_string(opened) + (opened == 1 ? " map with streets" : " maps with streets"));
}

Finding letters() {
    struct Script {
        QFontDatabase::WritingSystem system;
        const char* name;
        const char* package;
    };
    constexpr std::array kScripts = {Script{QFontDatabase::Latin, "Latin", "fonts-noto-core"},
                                     Script{QFontDatabase::Greek, "Greek", "fonts-noto-core"},
                                     Script{QFontDatabase::Cyrillic, "Cyrillic", "fonts-noto-core"},
                                     Script{QFontDatabase::Hebrew, "Hebrew", "fonts-noto-core"},
                                     Script{QFontDatabase::Arabic, "Arabic", "fonts-noto-core"},
                                     Script{QFontDatabase::Devanagari, "Devanagari", "fonts-noto-core"},
                                     Script{QFontDatabase::SimplifiedChinese, "Chinese", "fonts-noto-cjk"},
                                     Script{QFontDatabase::Japanese, "Japanese", "fonts-noto-cjk"},
                                     Script{QFontDatabase::Korean, "Korean", "fonts-noto-cjk"}};
    std::string missing;
    std::string packages;
    for (const Script& script : kScripts) {
        if (QFontDatabase::families(script.system).isEmpty()) {
            missing += (missing.empty() ? "" : ", ") + std::string(script.name);
            if (packages.find(script.package) == std::string::npos) {
                packages += std::string(" ") + script.package;
            }
        }
    }
    return missing.empty()
               ? fine("letters", "of every language here")
               : wrong("letters", Cause::Letters, "these show as boxes: " + missing, "sudo apt install" + packages);
}

Finding locale(const CheckUp::Places& places) {
    // Of this thread alone: the program's own stays as it is.
    const locale_t session = ::newlocale(LC_ALL_MASK, "", nullptr);
    if (session == nullptr) {
        return wrong("locale", Cause::Letters, "the session's locale is not there", "sudo dpkg-reconfigure locales");
    }
    const std::string codeset = ::nl_langinfo_l(CODESET, session);
    ::freelocale(session);
    if (codeset != "UTF-8") {
        return wrong("locale", Cause::Letters, "its letters are " + codeset + ", not UTF-8", "export LANG=C.UTF-8");
    }
    return QtLocalization::hasTexts(places.language, places.texts, "host")
               ? fine("locale", "there are texts in " + places.language)
               : fine("locale", "there are no texts in " + places.language + ": they are English");
}

Finding screenReader(const CheckUp::Places& places) {
    const OwnBus session(places.sessionBus);
    if (!session.isThere()) {
        return wrong("screen reader", Cause::ScreenReader, "there is no session bus that answers",
                     "log in anew, or: dbus-run-session ktr show");
    }
    const auto address = session.ask("org.a11y.Bus", "/org/a11y/bus", "org.a11y.Bus", "GetAddress");
    if (!address) {
        return wrong("screen reader", Cause::ScreenReader, "there is no bus for screen readers",
                     "sudo apt install at-spi2-core");
    }
    const OwnBus bus(address->toString().toStdString());
    if (!bus.isThere() || !bus.offers("org.a11y.atspi.Registry")) {
        return wrong("screen reader", Cause::ScreenReader, "the bus for screen readers does not answer",
                     "log out and in again");
    }
    const auto listens = session.property("org.a11y.Bus", "/org/a11y/bus", "org.a11y.Status", "ScreenReaderEnabled");
    return fine("screen reader", listens && listens->toBool() ? "one listens" : "none listens now; the bus is ready");
}

Finding portals(const CheckUp::Places& places) {
    constexpr const char* kPortal = "org.freedesktop.portal.Desktop";
    constexpr const char* kPath = "/org/freedesktop/portal/desktop";
    const OwnBus session(places.sessionBus);
    if (!session.isThere()) {
        return wrong("portals", Cause::Desktop, "there is no session bus that answers",
                     "log in anew, or: dbus-run-session ktr show");
    }
    if (!session.offers(kPortal)) {
        return wrong("portals", Cause::Desktop,
                     "there are none: dark, contrast and motion are not followed, links open another way",
                     "sudo apt install xdg-desktop-portal xdg-desktop-portal-gtk");
    }
    std::string missing;
    for (const auto& [interface, name] : {std::pair{"org.freedesktop.portal.Settings", "settings"},
                                          std::pair{"org.freedesktop.portal.OpenURI", "links"}}) {
        if (!session.property(kPortal, kPath, interface, "version")) {
            missing += (missing.empty() ? "" : ", ") + std::string(name);
        }
    }
    return missing.empty() ? fine("portals", "settings and links")
                           : wrong("portals", Cause::Desktop, "these are missing: " + missing,
                                   "sudo apt install xdg-desktop-portal-gtk");
}

}  // namespace ktr::linux_::session_checks
