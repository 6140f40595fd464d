#include "app/SearchCommand.h"

#include <QCoreApplication>
#include <QDBusConnectionInterface>
#include <QDBusReply>
#include <QProcess>
#include <QProcessEnvironment>

#include "app/Messages.h"

namespace ktr::app {

namespace {

/// How long a keyring may take before the service is asked without a secret, milliseconds.
constexpr int kAccountWait = 10000;
/// What was on its way to the name when it was given up is still answered, milliseconds.
constexpr int kFarewell = 500;
constexpr int kMillisecondsASecond = 1000;

}  // namespace

SearchCommand::SearchCommand(host::Host& host, int idle)
    : host_(host),
      bus_(QDBusConnection::sessionBus()),
      lock_(bus_, QDBusConnection::systemBus()),
      desk_(host, [this] { return lock_.isOpen(); }),
      service_(desk_, bus_, open, [this] { idle_.start(); }) {
    idle_.setSingleShot(true);
    idle_.setInterval(idle * kMillisecondsASecond);
    QObject::connect(&idle_, &QTimer::timeout, &idle_, [this] { endWhenIdle(); });
    lock_.setChanged([this] { lockChanged(); });
}

void SearchCommand::lockChanged() {
    if (!lock_.isOpen()) {
        desk_.forget();
    }
    if (lock_.isKnown()) {
        service_.setReady();
    }
}

void SearchCommand::open(const std::vector<std::string>& words) {
    if (words.empty()) {
        return;
    }
    QStringList arguments;
    for (const std::string& word : words) {
        arguments << QString::fromStdString(word);
    }
    // This process draws on no screen; the window does.
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.remove(QStringLiteral("QT_QPA_PLATFORM"));
    QProcess window;
    window.setProgram(QCoreApplication::applicationFilePath());
    window.setArguments(arguments);
    window.setProcessEnvironment(environment);
    if (!window.startDetached()) {
        tell("the window cannot be opened");
    }
}

bool SearchCommand::takeName() {
    const QString path = QString::fromLatin1(SearchService::kPath);
    // The object first, so that whoever finds the name finds it too.
    if (!bus_.isConnected() || !bus_.registerVirtualObject(path, &service_)) {
        tell("there is no session bus that the desktop's search could come by");
        return false;
    }
    const QDBusReply<QDBusConnectionInterface::RegisterServiceReply> taken = bus_.interface()->registerService(
        QString::fromLatin1(SearchService::kName), QDBusConnectionInterface::DontQueueService);
    if (!taken.isValid() || taken.value() != QDBusConnectionInterface::ServiceRegistered) {
        tell("another ktr answers the desktop's search already");
        return false;
    }
    return true;
}

void SearchCommand::endWhenIdle() {
    if (desk_.isBusy()) {
        idle_.start();
        return;
    }
    // Whoever calls from now on starts another.
    bus_.interface()->unregisterService(QString::fromLatin1(SearchService::kName));
    QTimer::singleShot(kFarewell, &idle_, [] { QCoreApplication::quit(); });
}

host::ExitCode SearchCommand::run() {
    if (!takeName()) {
        return host::ExitCode::Failure;
    }
    idle_.start();
    lockChanged();
    // The session ended.
    bus_.connect(QString(), QStringLiteral("/org/freedesktop/DBus/Local"), QStringLiteral("org.freedesktop.DBus.Local"),
                 QStringLiteral("Disconnected"), QCoreApplication::instance(), SLOT(quit()));
    // An exit before the loop runs would be forgotten.
    QTimer::singleShot(0, &idle_, [this] { host_.live()->start([this] { desk_.setReady(); }); });
    QTimer::singleShot(kAccountWait, &idle_, [this] { desk_.setReady(); });
    return static_cast<host::ExitCode>(QCoreApplication::exec());
}

}  // namespace ktr::app
