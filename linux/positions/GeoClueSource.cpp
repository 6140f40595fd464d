#include "linux/positions/GeoClueSource.h"

#include <QDBusArgument>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusServiceWatcher>
#include <QDBusVariant>
#include <QVariantMap>
#include <cmath>
#include <utility>

#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

const QString kService = QStringLiteral("org.freedesktop.GeoClue2");
const QString kManagerPath = QStringLiteral("/org/freedesktop/GeoClue2/Manager");
const QString kManager = QStringLiteral("org.freedesktop.GeoClue2.Manager");
const QString kClient = QStringLiteral("org.freedesktop.GeoClue2.Client");
const QString kLocation = QStringLiteral("org.freedesktop.GeoClue2.Location");
const QString kProperties = QStringLiteral("org.freedesktop.DBus.Properties");

// GClueAccuracyLevel.
constexpr unsigned kCity = 4;
constexpr unsigned kNeighborhood = 5;
constexpr unsigned kStreet = 6;
constexpr unsigned kExact = 8;

template <class Answered>
void call(const QDBusConnection& bus, QObject* owner, const QDBusMessage& message, Answered answered) {
    auto* watcher = new QDBusPendingCallWatcher(bus.asyncCall(message), owner);
    QObject::connect(watcher, &QDBusPendingCallWatcher::finished, owner,
                     [answered = std::move(answered)](QDBusPendingCallWatcher* finished) {
                         finished->deleteLater();
                         answered(*finished);
                     });
}

double number(const QVariantMap& properties, const char* name, double otherwise) {
    const auto found = properties.find(QLatin1String(name));
    const double value = found == properties.end() ? otherwise : found->toDouble();
    return std::isfinite(value) ? value : otherwise;
}

/// (tt): seconds and microseconds since 1970; none when GeoClue does not know.
std::optional<platform::Date> timestampOf(const QVariantMap& properties) {
    const QVariant value = properties.value(QStringLiteral("Timestamp"));
    const auto argument = qvariant_cast<QDBusArgument>(value);
    if (argument.currentType() != QDBusArgument::StructureType) {
        return std::nullopt;
    }
    qulonglong seconds = 0;
    qulonglong microseconds = 0;
    argument.beginStructure();
    argument >> seconds >> microseconds;
    argument.endStructure();
    if (seconds == 0) {
        return std::nullopt;
    }
    return platform::Date{static_cast<double>(seconds) + static_cast<double>(microseconds) / 1e6 -
                          platform::kSecondsFrom1970ToReferenceDate};
}

platform::PlatformLocation::Fix fixOf(const QVariantMap& properties) {
    platform::PlatformLocation::Fix fix;
    const double none = std::nan("");
    fix.coordinate = {number(properties, "Latitude", none), number(properties, "Longitude", none)};
    fix.horizontalAccuracy = number(properties, "Accuracy", -1.0);
    // Unknown altitudes are the least double; unknown speeds and headings are negative.
    const double altitude = number(properties, "Altitude", none);
    const bool known = altitude > -1.0e6 && altitude < 1.0e6;
    fix.altitude = known ? altitude : 0.0;
    // GeoClue does not estimate this error: as good as the horizontal one, at best.
    fix.verticalAccuracy = known ? fix.horizontalAccuracy : -1.0;
    fix.course = std::max(number(properties, "Heading", -1.0), -1.0);
    fix.speed = std::max(number(properties, "Speed", -1.0), -1.0);
    fix.timestamp = timestampOf(properties);
    return fix;
}

}  // namespace

GeoClueSource::GeoClueSource(std::shared_ptr<platform::MainLoop> mainLoop, QString desktopId, QDBusConnection bus)
    : retry_(std::move(mainLoop), [this] { askForClient(); }), desktopId_(std::move(desktopId)), bus_(std::move(bus)) {
    if (!bus_.isConnected()) {
        return;
    }
    auto* watcher = new QDBusServiceWatcher(kService, bus_, QDBusServiceWatcher::WatchForOwnerChange, this);
    connect(watcher, &QDBusServiceWatcher::serviceOwnerChanged, this,
            [this](const QString&, const QString&, const QString& now) {
                forgetClient();
                // GeoClue ends when no program uses it, and the bus starts it again: a call does.
                if (started_ && now.isEmpty()) {
                    retry_.later();
                } else if (started_) {
                    retry_.cancel();
                    askForClient();
                }
            });
}

GeoClueSource::~GeoClueSource() {
    GeoClueSource::stop();
}

unsigned GeoClueSource::accuracyLevel() const {
    return accuracy_ <= 100.0 ? kExact : accuracy_ <= 1000.0 ? kStreet : accuracy_ <= 5000.0 ? kNeighborhood : kCity;
}

void GeoClueSource::start(double desiredAccuracy) {
    accuracy_ = desiredAccuracy;
    if (!bus_.isConnected()) {
        return;
    }
    if (!started_) {
        started_ = true;
        askForClient();
    } else if (!client_.isEmpty()) {
        // A running client does not notice: it is asked to start again with the new level.
        useClient(client_);
    }
}

void GeoClueSource::stop() {
    retry_.cancel();
    if (started_ && !client_.isEmpty()) {
        bus_.asyncCall(QDBusMessage::createMethodCall(kService, client_, kClient, QStringLiteral("Stop")));
        QDBusMessage gone =
            QDBusMessage::createMethodCall(kService, kManagerPath, kManager, QStringLiteral("DeleteClient"));
        gone << QVariant::fromValue(QDBusObjectPath(client_));
        bus_.asyncCall(gone);
    }
    started_ = false;
    forgetClient();
}

void GeoClueSource::forgetClient() {
    ++round_;
    if (!client_.isEmpty()) {
        bus_.disconnect(kService, client_, kClient, QStringLiteral("LocationUpdated"), this,
                        SLOT(locationUpdated(QDBusObjectPath, QDBusObjectPath)));
        client_.clear();
    }
}

void GeoClueSource::askForClient() {
    if (!started_) {
        return;
    }
    forgetClient();
    const QDBusMessage message =
        QDBusMessage::createMethodCall(kService, kManagerPath, kManager, QStringLiteral("CreateClient"));
    call(bus_, this, message, [this, round = round_](const QDBusPendingCall& answered) {
        if (round != round_) {
            return;
        }
        const QDBusPendingReply<QDBusObjectPath> reply = answered;
        if (reply.isValid()) {
            useClient(reply.value().path());
        } else {
            retry_.later();
        }
    });
}

void GeoClueSource::useClient(const QString& path) {
    if (client_ != path) {
        client_ = path;
        bus_.connect(kService, client_, kClient, QStringLiteral("LocationUpdated"), this,
                     SLOT(locationUpdated(QDBusObjectPath, QDBusObjectPath)));
    }
    const auto set = [this](const QString& name, const QVariant& value) {
        QDBusMessage message = QDBusMessage::createMethodCall(kService, client_, kProperties, QStringLiteral("Set"));
        message << kClient << name << QVariant::fromValue(QDBusVariant(value));
        bus_.asyncCall(message);
    };
    set(QStringLiteral("DesktopId"), desktopId_);
    set(QStringLiteral("RequestedAccuracyLevel"), accuracyLevel());
    startClient();
}

void GeoClueSource::startClient() {
    const QDBusMessage message = QDBusMessage::createMethodCall(kService, client_, kClient, QStringLiteral("Start"));
    call(bus_, this, message, [this, round = round_](const QDBusPendingCall& answered) {
        if (round != round_) {
            return;
        }
        if (answered.isError()) {
            platform::areaLog(platform::LogArea::Positions)
                .write(platform::LogLevel::Info, "GeoClue gives no positions: %@",
                       platform::FormatArgument(answered.error().name().toStdString()).shown());
            retry_.later();
        } else {
            retry_.succeeded();
        }
    });
}

void GeoClueSource::locationUpdated(const QDBusObjectPath&, const QDBusObjectPath& now) {
    // "/" stands for no location.
    if (started_ && now.path() != QLatin1String("/")) {
        readLocation(now.path());
    }
}

void GeoClueSource::readLocation(const QString& path) {
    QDBusMessage message = QDBusMessage::createMethodCall(kService, path, kProperties, QStringLiteral("GetAll"));
    message << kLocation;
    call(bus_, this, message, [this, round = round_](const QDBusPendingCall& answered) {
        const QDBusPendingReply<QVariantMap> reply = answered;
        if (round == round_ && started_ && reply.isValid()) {
            tell(fixOf(reply.value()));
        }
    });
}

}  // namespace ktr::linux_
