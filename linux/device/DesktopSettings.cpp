#include "linux/device/DesktopSettings.h"

#include <QDBusArgument>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QProcess>
#include <QStandardPaths>
#include <QStringList>
#include <algorithm>
#include <array>
#include <cmath>

#include "linux/device/KdeFonts.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

const QString kPortal = QStringLiteral("org.freedesktop.portal.Desktop");
const QString kPath = QStringLiteral("/org/freedesktop/portal/desktop");
const QString kInterface = QStringLiteral("org.freedesktop.portal.Settings");
const QString kAppearance = QStringLiteral("org.freedesktop.appearance");
const QString kScheme = QStringLiteral("color-scheme");
const QString kContrast = QStringLiteral("contrast");
const QString kMotion = QStringLiteral("reduced-motion");
const QString kAccent = QStringLiteral("accent-color");
const QString kGnome = QStringLiteral("org.gnome.desktop.interface");
const QString kTextScale = QStringLiteral("text-scaling-factor");

/// A portal answers with a variant in a variant.
QVariant unwrapped(QVariant value) {
    while (value.userType() == qMetaTypeId<QDBusVariant>()) {
        value = value.value<QDBusVariant>().variant();
    }
    return value;
}

/// None for what is no sensible size.
std::optional<double> scaleOf(const QVariant& value) {
    bool isNumber = false;
    const double scale = value.toDouble(&isNumber);
    return isNumber && std::isfinite(scale) && scale >= 0.25 && scale <= 8.0 ? std::optional(scale) : std::nullopt;
}

/// 1: the user wishes it; 0 and whatever a later day brings: not.
std::optional<bool> wishOf(const QVariant& value) {
    bool isNumber = false;
    const uint wish = value.toUInt(&isNumber);
    return isNumber ? std::optional(wish == 1) : std::nullopt;
}

/// Red, green and blue from 0 to 1 in sRGB; whatever lies outside is how the portal says that there is none.
std::optional<QColor> colorOf(const QVariant& value) {
    if (value.userType() != qMetaTypeId<QDBusArgument>()) {
        return std::nullopt;
    }
    const auto argument = value.value<QDBusArgument>();
    if (argument.currentSignature() != QLatin1String("(ddd)")) {
        return std::nullopt;
    }
    std::array<double, 3> parts{};
    argument.beginStructure();
    for (double& part : parts) {
        argument >> part;
    }
    argument.endStructure();
    const bool isColor =
        std::all_of(parts.begin(), parts.end(), [](double part) { return part >= 0.0 && part <= 1.0; });
    const auto channel = [&parts](std::size_t i) { return static_cast<int>(std::lround(parts[i] * 255.0)); };
    return isColor ? std::optional(QColor(channel(0), channel(1), channel(2))) : std::nullopt;
}

}  // namespace

DesktopSettings::Places DesktopSettings::Places::ofSession() {
    return {qEnvironmentVariable("XDG_CURRENT_DESKTOP"),
            QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation).toStdString(),
            qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS"), QStringLiteral("gsettings")};
}

DesktopSettings::DesktopSettings(Places places)
    : places_(std::move(places)),
      desktop_([this] {
          const QStringList names = places_.desktop.split(QLatin1Char(':'));
          if (names.contains(QLatin1String("KDE"), Qt::CaseInsensitive)) {
              return Desktop::Kde;
          }
          const bool gnome = names.contains(QLatin1String("GNOME"), Qt::CaseInsensitive) ||
                             names.contains(QLatin1String("Phosh"), Qt::CaseInsensitive);
          return gnome ? Desktop::Gnome : Desktop::Other;
      }()),
      files_([this] { followKdeFonts(); }),
      aside_(*this) {
    if (desktop_ == Desktop::Kde) {
        followKdeFonts();
    }
    joinBus();
}

DesktopSettings::~DesktopSettings() {
    if (bus_) {
        QDBusConnection::disconnectFromBus(bus_->name());
    }
}

void DesktopSettings::joinBus() {
    if (places_.busAddress.isEmpty()) {
        return;
    }
    const QString name =
        QStringLiteral("ktr-desktop-settings-") + QString::number(reinterpret_cast<quintptr>(this), 16);
    aside_.run([this, name, address = places_.busAddress] {
        const QDBusConnection bus = QDBusConnection::connectToBus(address, name);
        return [this, bus] {
            if (bus.isConnected()) {
                useBus(bus);
            }
        };
    });
}

void DesktopSettings::useBus(const QDBusConnection& bus) {
    bus_ = bus;
    // A slot can be found only when the types that it takes are known by their names, and this one is not before the
    // first variant has come in: too late.
    qRegisterMetaType<QDBusVariant>();
    // Before anything is asked, so that no change falls between an answer and this. From whomever: who owns the
    // portal's name is learnt in the background, and what it says until then would be lost.
    if (!bus_->connect(QString(), kPath, kInterface, QStringLiteral("SettingChanged"), this,
                       SLOT(settingChanged(QString, QString, QDBusVariant)))) {
        platform::platformLog().write(platform::LogLevel::Error,
                                      "the desktop's settings are not followed: no connection to SettingChanged");
    }
    askAll();
}

void DesktopSettings::askAll() {
    ask(kAppearance, kScheme);
    ask(kAppearance, kContrast);
    ask(kAppearance, kMotion);
    ask(kAppearance, kAccent);
    if (desktop_ == Desktop::Gnome) {
        ask(kGnome, kTextScale);
    }
}

void DesktopSettings::ask(const QString& group, const QString& key) {
    QDBusMessage message = QDBusMessage::createMethodCall(kPortal, kPath, kInterface, QStringLiteral("Read"));
    message << group << key;
    const unsigned heard = heard_[{group, key}];
    auto* watcher = new QDBusPendingCallWatcher(bus_->asyncCall(message), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [this, group, key, heard](QDBusPendingCallWatcher* finished) {
                finished->deleteLater();
                const QDBusPendingReply<QDBusVariant> reply = *finished;
                if (!reply.isValid()) {
                    if (group == kGnome) {
                        askGsettings();
                    }
                } else if (heard == heard_[{group, key}]) {
                    take(group, key, reply.value().variant());
                }
            });
}

void DesktopSettings::settingChanged(const QString& group, const QString& key, const QDBusVariant& value) {
    if (const auto asked = heard_.find({group, key}); asked != heard_.end()) {
        ++asked->second;
    }
    take(group, key, value.variant());
}

void DesktopSettings::take(const QString& group, const QString& key, const QVariant& wrapped) {
    const QVariant value = unwrapped(wrapped);
    Values values = values_;
    if (group == kAppearance && key == kScheme) {
        // 1: dark, 2: light; 0 and whatever a later day brings: no preference.
        bool isNumber = false;
        const uint scheme = value.toUInt(&isNumber);
        values.dark = isNumber && (scheme == 1 || scheme == 2) ? std::optional(scheme == 1) : std::nullopt;
    } else if (group == kAppearance && key == kContrast) {
        values.highContrast = wishOf(value);
    } else if (group == kAppearance && key == kMotion) {
        values.reducedMotion = wishOf(value);
    } else if (group == kAppearance && key == kAccent) {
        values.accent = colorOf(value);
    } else if (group == kGnome && key == kTextScale && desktop_ == Desktop::Gnome) {
        portalKnowsTextScale_ = true;
        values.textScale = scaleOf(value);
    }
    set(values);
}

void DesktopSettings::followKdeFonts() {
    FileWatch::Files files;
    for (const char* name : KdeFonts::kFiles) {
        files.push_back(places_.configuration / name);
    }
    // Watched before they are read, so that no change falls between the two.
    files_.watch(std::move(files), [this](bool) { readKdeFonts(); });
}

void DesktopSettings::readKdeFonts() {
    aside_.run([this, folder = places_.configuration] {
        return [this, scale = KdeFonts::textScale(folder)] {
            Values values = values_;
            values.textScale = scale;
            set(values);
        };
    });
}

void DesktopSettings::askGsettings() {
    auto* process = new QProcess(this);
    connect(process, &QProcess::errorOccurred, process, &QObject::deleteLater);
    connect(process, &QProcess::finished, this, [this, process](int status) {
        process->deleteLater();
        if (status == 0 && !portalKnowsTextScale_) {
            Values values = values_;
            values.textScale = scaleOf(QString::fromUtf8(process->readAllStandardOutput()).trimmed());
            set(values);
        }
    });
    process->start(places_.gsettings, {QStringLiteral("get"), kGnome, kTextScale}, QIODevice::ReadOnly);
}

void DesktopSettings::refresh() {
    if (bus_) {
        askAll();
    }
}

void DesktopSettings::set(const Values& values) {
    if (values != values_) {
        values_ = values;
        if (changed_) {
            changed_();
        }
    }
}

}  // namespace ktr::linux_
