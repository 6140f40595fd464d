#include "linux/device/UserUnit.h"

#include <QDBusPendingCallWatcher>
#include <QStringList>
#include <utility>

#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

const QString kManager = QStringLiteral("org.freedesktop.systemd1");
const QString kManagerPath = QStringLiteral("/org/freedesktop/systemd1");
const QString kManagerInterface = QStringLiteral("org.freedesktop.systemd1.Manager");
/// Whatever was begun for it before gives way.
const QString kReplace = QStringLiteral("replace");

}  // namespace

UserUnit::UserUnit(const QString& busAddress, QString unit) : unit_(std::move(unit)), aside_(*this) {
    if (busAddress.isEmpty()) {
        state_ = State::None;
        return;
    }
    const QString name = QStringLiteral("ktr-user-unit-%1").arg(reinterpret_cast<quintptr>(this), 0, 16);
    aside_.run([this, name, busAddress] {
        const QDBusConnection bus = QDBusConnection::connectToBus(busAddress, name);
        return [this, bus] { bus.isConnected() ? useBus(bus) : set(State::None); };
    });
}

UserUnit::~UserUnit() {
    if (bus_) {
        QDBusConnection::disconnectFromBus(bus_->name());
    }
}

void UserUnit::useBus(const QDBusConnection& bus) {
    bus_ = bus;
    ask();
}

void UserUnit::call(const QString& method, const QVariantList& arguments, Then then) {
    QDBusMessage message = QDBusMessage::createMethodCall(kManager, kManagerPath, kManagerInterface, method);
    message.setArguments(arguments);
    auto* watcher = new QDBusPendingCallWatcher(bus_->asyncCall(message, kLongestSilence), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [then = std::move(then)](QDBusPendingCallWatcher* finished) {
                finished->deleteLater();
                then(finished->reply());
            });
}

void UserUnit::ask() {
    call(QStringLiteral("GetUnitFileState"), {unit_}, [this](const QDBusMessage& answer) {
        isBusy_ = false;
        const QString said =
            answer.type() == QDBusMessage::ReplyMessage ? answer.arguments().value(0).toString() : QString();
        // Those of an administrator ("masked", "static") are not the user's to change.
        const bool isOn = said.startsWith(QLatin1String("enabled"));
        set(isOn ? State::On : said == QLatin1String("disabled") ? State::Off : State::None);
    });
}

void UserUnit::setOn(bool isOn) {
    if (isBusy_ || !bus_ || (state_ != State::On && state_ != State::Off)) {
        return;
    }
    isBusy_ = true;
    // For good and not for this session alone; what is in the way of enabling gives way.
    const QVariantList enabling =
        isOn ? QVariantList{QStringList{unit_}, false, true} : QVariantList{QStringList{unit_}, false};
    callAll({{isOn ? QStringLiteral("EnableUnitFiles") : QStringLiteral("DisableUnitFiles"), enabling},
             {QStringLiteral("Reload"), {}},
             {isOn ? QStringLiteral("StartUnit") : QStringLiteral("StopUnit"), {unit_, kReplace}}});
}

void UserUnit::callAll(const std::vector<std::pair<QString, QVariantList>>& calls) {
    if (calls.empty()) {
        ask();
        return;
    }
    const auto& [method, arguments] = calls.front();
    call(method, arguments,
         [this, name = method, rest = std::vector(calls.begin() + 1, calls.end())](const QDBusMessage& answer) {
             if (answer.type() == QDBusMessage::ReplyMessage) {
                 callAll(rest);
                 return;
             }
             // A service that does not run is not there to be stopped.
             const bool isGone = name == QLatin1String("StopUnit") &&
                                 answer.errorName() == QLatin1String("org.freedesktop.systemd1.NoSuchUnit");
             if (!isGone) {
                 platform::areaLog(platform::LogArea::Host)
                     .write(platform::LogLevel::Default, "the user's services do not take %@: %@",
                            platform::FormatArgument(name.toStdString()).shown(),
                            platform::FormatArgument(answer.errorName().toStdString()).shown());
             }
             ask();
         });
}

void UserUnit::set(State state) {
    // Also when it stays: whoever wished for another one shows what it is.
    state_ = state;
    if (changed_) {
        changed_();
    }
}

}  // namespace ktr::linux_
