#include "app/WatchCommand.h"

#include <sys/signalfd.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QDBusConnection>
#include <QDateTime>
#include <QLocale>
#include <QProcess>
#include <QSocketNotifier>
#include <QTimer>
#include <csignal>
#include <cstdio>
#include <map>
#include <memory>
#include <optional>
#include <utility>

#include "app/CrossingHook.h"
#include "app/CrossingWatch.h"
#include "app/HookQueue.h"
#include "app/Messages.h"
#include "documents/AtomicFile.h"
#include "documents/FileLock.h"
#include "documents/FileReader.h"
#include "documents/FileTrust.h"
#include "host/Resources.h"
#include "linux/configuration/ConfiguredAccountStore.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/device/Buses.h"
#include "linux/device/DesktopNotifier.h"
#include "linux/device/LogindLock.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/locale/QtLocalization.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::app {

namespace {

/// So long after the start the lock's state is surely known: nothing is shown before.
constexpr int kUntilLockIsKnown = 1500;  // milliseconds
/// Between two attempts to show a notification that nobody has shown.
constexpr int kUntilShownAgain = 10000;  // milliseconds
constexpr std::size_t kMostOfKey = 1024;
constexpr std::size_t kMostQuestions = 100;
/// Where numbers of notifications begin: far beyond those that servers give out, which count from 1.
constexpr std::uint32_t kFirstNumber = 0x6B740000;

host::ExitCode complain(const std::string& line) {
    tell(line);
    return host::ExitCode::Failure;
}

std::optional<CrossingWatch::Account> readAccount(linux_::ConfiguredAccountStore& accounts, std::string& complaint) {
    accounts.read();
    accounts.take();
    const auto configuration = accounts.configuration();
    const auto account = accounts.deviceOwnerAccount();
    const auto token = account ? account->tokenOfType(platform::kFriendLocationService) : std::nullopt;
    const auto authorization =
        token ? platform::basicAuthorization(account->personIdentifier().value_or(""), *token) : std::nullopt;
    if (!configuration.account || !configuration.account->host || !authorization) {
        complaint =
            accounts.problem().empty() ? "there is no account with a token in the configuration" : accounts.problem();
        return std::nullopt;
    }
    return CrossingWatch::Account{*configuration.account->host, *authorization, configuration.certificates,
                                  configuration.account->domains};
}

/// In which notifications and the questions behind them are worded, as the window's texts are.
std::string languageOf(const WatchCommand::Options& options, const linux_::Configuration& configuration) {
    const std::string said = options.language.empty() ? configuration.language.value_or("") : options.language;
    return said.empty() ? linux_::LocaleRegion::sessionLanguage() : said;
}

std::optional<std::string> readKey(const std::string& file, std::string& complaint) {
    documents::FileReader::Terms terms;
    terms.most = kMostOfKey;
    terms.refusal = [&file](const struct stat& facts) {
        return (facts.st_mode & 077) != 0 ? std::string("others can read it; chmod 600 keeps it private")
                                          : documents::FileTrust::problemOf(file, facts);
    };
    const auto read = documents::FileReader::read(file, terms);
    if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
        complaint = file + ": " + error->reason;
        return std::nullopt;
    }
    std::string key = std::get<std::string>(read);
    while (!key.empty() && (key.back() == '\n' || key.back() == '\r')) {
        key.pop_back();
    }
    if (key.size() < 16) {
        complaint = file + ": expected a key of at least 16 characters";
        return std::nullopt;
    }
    return key;
}

/// A descriptor that can be read when the program is to end.
int endingSignals() {
    sigset_t set;
    sigemptyset(&set);
    sigaddset(&set, SIGINT);
    sigaddset(&set, SIGTERM);
    ::pthread_sigmask(SIG_BLOCK, &set, nullptr);
    return ::signalfd(-1, &set, SFD_CLOEXEC | SFD_NONBLOCK);
}

/// What becomes of a crossing.
class Teller {
  public:
    /// `hook`: none: nobody else is told.
    Teller(const WatchCommand::Options& options, std::string language, HookQueue* hook)
        : options_(options),
          hook_(hook),
          language_(std::move(language)),
          texts_(language_),
          notifier_(QDBusConnection::sessionBus(), [this](const std::string& tag) { open(tag); }) {
        texts_.addBundle(linux_::QtLocalization::kHostBundle, host::resourceFolder() / "localization", "host");
    }

    void tellOf(const Crossing& crossing, const CrossingWatch::Next& next) {
        if (hook_ != nullptr) {
            hook_->add(crossing);
        }
        if (options_.prints) {
            if (print(crossing)) {
                return next();
            }
            // Nobody has heard of it: it is not the one that was told last.
            tell("the crossings cannot be written");
            return QCoreApplication::exit(static_cast<int>(host::ExitCode::Failure));
        }
        const auto clock = [this](std::int64_t time) {
            return QLocale(QString::fromStdString(language_))
                .toString(QDateTime::fromSecsSinceEpoch(time).time(), QLocale::ShortFormat)
                .toStdString();
        };
        const auto words =
            CrossingWords::of(crossing, lock_.lockState() == platform::DeviceLock::kLocked, textOf(), clock);
        const std::string tag = "ktr-crossing-" + std::to_string(crossing.number);
        if (questions_.size() >= kMostQuestions) {
            questions_.erase(questions_.begin());
        }
        questions_[tag] = CrossingWords::question(crossing, textOf());
        const auto number = kFirstNumber + static_cast<std::uint32_t>(crossing.number % kFirstNumber);
        notifier_.show({tag, words.title, words.body, number},
                       [this, crossing, next](bool isShown) { shown(crossing, next, isShown); });
    }

  private:
    std::function<std::string(const std::string&)> textOf() const {
        return [this](const std::string& key) { return texts_.text(key, linux_::QtLocalization::kHostBundle); };
    }
    void shown(const Crossing& crossing, const CrossingWatch::Next& next, bool isShown) {
        if (!isShown && !std::exchange(isNobodyThere_, true)) {
            tell("there is nobody on the desktop who shows notifications");
        }
        if (isShown || hook_ != nullptr) {
            isNobodyThere_ = !isShown;
            return next();
        }
        // At a session's start whoever shows them may come later than this program; the service keeps what follows.
        QTimer::singleShot(kUntilShownAgain, &notifier_, [this, crossing, next] { tellOf(crossing, next); });
    }
    /// Whether somebody has it.
    static bool print(const Crossing& crossing) {
        const std::string time = QDateTime::fromSecsSinceEpoch(crossing.time).toString(Qt::ISODate).toStdString();
        const std::string line = std::to_string(crossing.number) + "  " + time + "  " + crossing.name +
                                 (crossing.arrives ? " arrived" : " left") +
                                 (crossing.place.empty() ? "" : ": " + crossing.place) + "\n";
        return std::fputs(line.c_str(), stdout) != EOF && std::fflush(stdout) == 0;
    }
    void open(const std::string& tag) {
        QStringList words{QStringLiteral("show")};
        if (const auto question = questions_.find(tag); question != questions_.end()) {
            words << QStringLiteral("--ask") << QString::fromStdString(question->second);
        }
        if (!options_.language.empty()) {
            words << QStringLiteral("--language") << QString::fromStdString(options_.language);
        }
        QProcess::startDetached(QCoreApplication::applicationFilePath(), words);
    }

    const WatchCommand::Options& options_;
    HookQueue* const hook_;
    const std::string language_;
    linux_::QtLocalization texts_;
    linux_::LogindLock lock_;
    linux_::DesktopNotifier notifier_;
    bool isNobodyThere_ = false;                    ///< it was said
    std::map<std::string, std::string> questions_;  ///< what a click on a notification asks, by its tag
};

}  // namespace

host::ExitCode WatchCommand::run(const Options& options, int argc, char** argv) {
    const int signals = endingSignals();
    for (const std::string& line : linux_::Buses::switchOffSilent()) {
        tell(line);
    }
    int count = argc > 0 ? 1 : 0;
    const QCoreApplication application(count, argv);
    std::string complaint;
    linux_::ConfiguredAccountStore accounts(linux_::XdgFolders::configurationFile());
    const auto account = readAccount(accounts, complaint);
    if (!account) {
        return complain(complaint);
    }
    std::unique_ptr<CrossingHook> hook;
    if (!options.hook.empty()) {
        const auto key = readKey(options.hookKey, complaint);
        if (!key) {
            return complain(complaint);
        }
        hook = std::make_unique<CrossingHook>(CrossingHook::Setup{options.hook, *key, account->certificateFiles,
                                                                  [](const std::string& line) { tell(line); }});
    }
    const auto folder = linux_::XdgFolders::state();
    if (complaint = documents::AtomicFile::makeFolder(folder); !complaint.empty()) {
        return complain(complaint);
    }
    // Two with one secret would end each other's streams.
    const documents::FileLock lock(folder / "watch.lock", std::chrono::milliseconds(200));
    if (!lock.isHeld()) {
        return complain("another ktr watch is running: " + lock.problem());
    }
    std::unique_ptr<HookQueue> queue;
    if (hook) {
        queue = std::make_unique<HookQueue>(HookQueue::Setup{
            folder / "watch-hook",
            [&hook](const Crossing& crossing, std::function<void()> done) { hook->post(crossing, std::move(done)); },
            [](const std::string& line) { tell(line); }, [] { return QDateTime::currentSecsSinceEpoch(); }});
    }
    Teller teller(options, languageOf(options, accounts.configuration()), queue.get());
    CrossingWatch watch(
        {*account, folder / "watch",
         [&](const Crossing& crossing, const CrossingWatch::Next& next) { teller.tellOf(crossing, next); },
         [](const std::string& line) { tell(line); }});
    QTimer::singleShot(options.prints ? 0 : kUntilLockIsKnown, &application, [&] { watch.start(); });
    if (queue) {
        queue->start();
    }
    QSocketNotifier ending(signals, QSocketNotifier::Read);
    QObject::connect(&ending, &QSocketNotifier::activated, &application, &QCoreApplication::quit);
    const int code = QCoreApplication::exec();
    ::close(signals);
    return static_cast<host::ExitCode>(code);
}

}  // namespace ktr::app
