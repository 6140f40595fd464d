#include "app/Program.h"

#include <QApplication>
#include <QDateTime>
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <vector>

#include "app/AskCommand.h"
#include "app/CommandLine.h"
#include "app/ConfigCommand.h"
#include "app/Description.h"
#include "app/DoctorCommand.h"
#include "app/LiveRun.h"
#include "app/MapsCommand.h"
#include "app/Messages.h"
#include "app/RenderCommand.h"
#include "app/SearchCommand.h"
#include "app/ServeCommand.h"
#include "app/window/ShowCommand.h"
#include "documents/Words.h"
#include "host/Host.h"
#include "host/Resources.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/device/Buses.h"
#include "linux/device/Descriptors.h"
#include "linux/device/DesktopActivation.h"
#include "linux/device/SystemClock.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/locale/QtLocalization.h"
#include "linux/paint/FontSetup.h"

namespace ktr::app {

namespace {

host::ExitCode fail(const host::Failure& failure) {
    tell(failure.line);
    return failure.code;
}

/// The present moment in the session's time zone.
documents::IsoTime sessionNow() {
    return {linux_::SystemClock().now(), QDateTime::currentDateTime().offsetFromUtc()};
}

std::variant<std::vector<host::Scenario>, host::Failure> readScenarios(const Options& options, platform::Date now) {
    std::vector<host::Scenario> scenarios;
    documents::DocumentWarnings warnings;
    for (const std::string& file : options.scenarios) {
        const auto clock =
            options.live ? host::ScenarioReader::Clock::Present : host::ScenarioReader::Clock::OfTheScenario;
        auto read = host::ScenarioReader(now, clock).readFile(file, &warnings);
        if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
            return host::Failure{host::ExitCode::BadScenario, error->text()};
        }
        scenarios.push_back(std::move(std::get<host::Scenario>(read)));
    }
    tell(warnings);
    return scenarios;
}

/// What the file says, as far as it can be read: what is wrong with it is reported once the account is read.
linux_::Configuration configurationOf(const std::filesystem::path& file) {
    documents::DocumentWarnings warnings;
    auto read = linux_::ConfigurationReader::readFile(file, &warnings);
    if (std::holds_alternative<linux_::ConfigurationReader::Error>(read)) {
        // The account is read later: where a disk failed but once, it would be asked for friends whom nobody knows.
        warnings = {};
        read = linux_::ConfigurationReader::readFile(file, &warnings);
    }
    tell(warnings);
    auto* configuration = std::get_if<linux_::Configuration>(&read);
    return configuration == nullptr ? linux_::Configuration() : std::move(*configuration);
}

/// The configured maps for a conversation that stands for itself: those in files, since nothing is fetched for it. What
/// is not used is said.
linux_::Configuration::Maps mapsIn(const std::filesystem::path& file) {
    // A loop of links is one that cannot be looked at.
    if (std::error_code failed; !std::filesystem::exists(file, failed) && !failed) {
        return {};
    }
    auto read = linux_::ConfigurationReader::readFile(file, nullptr);
    if (const auto* error = std::get_if<linux_::ConfigurationReader::Error>(&read)) {
        tell("warning: the configured maps are not used: " + error->text);
        return {};
    }
    auto maps = std::get<linux_::Configuration>(std::move(read)).maps;
    std::erase_if(maps.sources, [](const linux_::Configuration::Maps::Source& source) {
        if (!source.url.empty()) {
            tell("warning: the map " + documents::inQuotes(source.url) + " is not used: nothing is fetched here");
        } else if (std::error_code failed; !std::filesystem::exists(source.file, failed)) {
            // What is there and no map is said by who reads it.
            tell("warning: the map " + documents::inQuotes(source.file) + " is not there");
        }
        return !source.url.empty();
    });
    return maps;
}

std::variant<std::unique_ptr<host::Host>, host::Failure> makeHost(const Options& options,
                                                                  const host::HostSettings& settings,
                                                                  const std::vector<host::Scenario>& scenarios,
                                                                  host::Host::Time time) {
    auto made = host::Host::make(settings, time, options.plugin);
    // What is live waits for the account first.
    if (auto* host = std::get_if<std::unique_ptr<host::Host>>(&made); host != nullptr && !options.live) {
        for (const host::Scenario& scenario : scenarios) {
            if (auto failure = (*host)->addTurn(scenario)) {
                return *failure;
            }
        }
    }
    return made;
}

host::ExitCode runHeadless(const Options& options, const host::HostSettings& settings,
                           const std::vector<host::Scenario>& scenarios) {
    auto made = makeHost(options, settings, scenarios, host::Host::Time::Virtual);
    if (const auto* failure = std::get_if<host::Failure>(&made)) {
        return fail(*failure);
    }
    host::Host& host = *std::get<std::unique_ptr<host::Host>>(made);
    if (options.command == Options::Command::Ask) {
        // Its own numbers, beside those of an attempt.
        return static_cast<host::ExitCode>(AskCommand(host, options).run());
    }
    if (options.command == Options::Command::Wyoming) {
        return WyomingCommand(host, options.wyoming).run();
    }
    if (options.command == Options::Command::Search) {
        return SearchCommand(host, options.searchIdle).run();
    }
    const RenderCommand render(host);
    render.choosePalette();
    const host::ExitCode code = options.live ? LiveRun(host, options).run(scenarios) : host::ExitCode::Ok;
    if (options.command == Options::Command::Render) {
        const auto failure = render.write(options.output);
        return failure ? fail(*failure) : code;
    }
    host.settle(settings.width);
    const std::string text = describe(platform::accessibilityTree(host.window(), host.rightToLeft()),
                                      {host.text("ACCESSIBILITY_LINK"), host.text("ACCESSIBILITY_IMAGE")});
    if (std::fputs(text.c_str(), stdout) == EOF || std::fflush(stdout) != 0) {
        return fail({host::ExitCode::Failure, "the description cannot be written"});
    }
    return code;
}

host::ExitCode runShow(const Options& options, host::HostSettings settings,
                       const std::vector<host::Scenario>& scenarios) {
    settings.scale = qApp->devicePixelRatio();
    auto made = makeHost(options, settings, scenarios, host::Host::Time::Running);
    if (const auto* failure = std::get_if<host::Failure>(&made)) {
        return fail(*failure);
    }
    return ShowCommand(*std::get<std::unique_ptr<host::Host>>(made), options).run(scenarios);
}

/// The display that a window needs; Qt ends the process when it looks for one in vain.
bool hasDisplay() {
    for (const char* name : {"DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM"}) {
        if (!qEnvironmentVariableIsEmpty(name)) {
            return true;
        }
    }
    return false;
}

/// Qt's own remarks are none of the user's concern; what it finds critical is. After a fatal one, such as a display
/// that does not answer, Qt would end the process with a core dump: the line and the exit status say it better.
void passOnQtMessage(QtMsgType type, const QMessageLogContext& /*context*/, const QString& text) {
    if (type == QtCriticalMsg || type == QtFatalMsg) {
        tell(text.section(u'\n', 0, 0).toStdString());
    }
    if (type == QtFatalMsg) {
        std::_Exit(static_cast<int>(host::ExitCode::Failure));
    }
}

/// KTR_FONTS=pinned sets texts from the same font files on every machine, for pictures that are compared.
linux_::FontSetup::Mode fontMode() {
    return qgetenv("KTR_FONTS") == "pinned" ? linux_::FontSetup::Mode::Pinned : linux_::FontSetup::Mode::System;
}

std::optional<host::Failure> prepareFonts() {
    std::string error;
    if (!linux_::FontSetup::prepare(fontMode(), &error)) {
        return host::Failure{host::ExitCode::Failure, "the fonts cannot be set up: " + error};
    }
    return std::nullopt;
}

std::optional<host::Failure> loadFonts() {
    const auto missing = linux_::FontSetup::load(fontMode());
    if (!missing.empty()) {
        return host::Failure{host::ExitCode::Failure, "a font file is missing: " + missing.front()};
    }
    return std::nullopt;
}

/// Libraries end the process with a signal when they get no descriptors: say it before they do.
std::optional<host::Failure> wantDescriptors(int wanted) {
    if (linux_::Descriptors::areEnough(wanted)) {
        return std::nullopt;
    }
    return host::Failure{host::ExitCode::Failure,
                         "too few files may be open at a time: " + std::to_string(wanted) +
                             " more than now are needed; raise the limit with: ulimit -n 1024"};
}

/// A language that somebody asked for is not passed over in silence.
void tellOfLanguage(const std::string& language) {
    const bool isAsked = language != linux_::LocaleRegion::sessionLanguage();
    if (isAsked && !linux_::QtLocalization::hasTexts(language, host::resourceFolder() / "localization", "host")) {
        tell("warning: there are no texts in the language " + documents::inQuotes(language) + "; they are English");
    }
}

/// Which letters there are only an application knows.
host::ExitCode runDoctor(const DoctorOptions& options, int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qInstallMessageHandler(passOnQtMessage);
    int count = argc > 0 ? 1 : 0;
    const QGuiApplication application(count, argv);
    return DoctorCommand::run(options);
}

host::ExitCode run(const Options& options, int argc, char** argv) {
    const documents::IsoTime now = sessionNow();
    const auto read = readScenarios(options, options.at ? options.at->date : now.date);
    if (const auto* failure = std::get_if<host::Failure>(&read)) {
        return fail(*failure);
    }
    const auto& scenarios = std::get<std::vector<host::Scenario>>(read);
    const auto configuration = linux_::XdgFolders::configurationFile();
    auto decided = host::HostSettings::decide(options, scenarios, now,
                                              options.live ? configurationOf(configuration) : linux_::Configuration());
    if (const auto* failure = std::get_if<host::Failure>(&decided)) {
        // Of what a host can be asked for wrongly, the command line has this one.
        const bool isUsage = failure->code == host::ExitCode::Usage;
        return isUsage ? fail({failure->code, "--at: " + failure->line}) : fail(*failure);
    }
    auto& settings = std::get<host::HostSettings>(decided);
    tellOfLanguage(settings.language);
    if (options.live) {
        settings.liveConfiguration = configuration;
    } else {
        settings.maps = mapsIn(configuration);
    }
    constexpr double kVectorDensity = 3.0;
    if (options.output.ends_with(".svg") || options.output.ends_with(".pdf")) {
        settings.mapDensity = kVectorDensity;
    }
    const bool window = options.command == Options::Command::Show || options.command == Options::Command::Open;
    if (window && !hasDisplay()) {
        return fail(
            {host::ExitCode::Failure, "there is no display to open a window on; `ktr render` draws without one"});
    }
    if (!window) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }
    // Qt itself uses the buses, from the application's making on.
    for (const std::string& line : linux_::Buses::switchOffSilent()) {
        std::fprintf(stderr, "ktr: %s\n", line.c_str());
    }
    qInstallMessageHandler(passOnQtMessage);
    if (const auto failure = prepareFonts()) {
        return fail(*failure);
    }
    // Qt's own options are none of this program's: it sees the name alone.
    int count = argc > 0 ? 1 : 0;
    const std::unique_ptr<QGuiApplication> application(window ? new QApplication(count, argv)
                                                              : new QGuiApplication(count, argv));
    if (const auto failure = loadFonts()) {
        return fail(*failure);
    }
    if (options.command == Options::Command::Open &&
        linux_::DesktopActivation::handOver(qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS"), options.link)) {
        return host::ExitCode::Ok;
    }
    return window ? runShow(options, settings, scenarios) : runHeadless(options, settings, scenarios);
}

}  // namespace

host::ExitCode runProgram(int argc, char** argv) {
    const auto parsed = CommandLine::parse(std::vector<std::string>(argv + (argc > 0 ? 1 : 0), argv + argc));
    if (const auto* ending = std::get_if<CommandLine::Ending>(&parsed)) {
        const bool isAnswer = ending->code == host::ExitCode::Ok;
        std::FILE* const stream = isAnswer ? stdout : stderr;
        if ((std::fputs(ending->text.c_str(), stream) == EOF || std::fflush(stream) != 0) && isAnswer) {
            return fail({host::ExitCode::Failure, "the answer cannot be written"});
        }
        return ending->code;
    }
    const auto& options = std::get<Options>(parsed);
    const bool isLive = options.live || options.command == Options::Command::Show;
    using linux_::Descriptors;
    if (const auto failure = wantDescriptors(isLive ? Descriptors::kForLive : Descriptors::kForOthers)) {
        return fail(*failure);
    }
    switch (options.command) {
        case Options::Command::Serve:
            return ServeCommand::run(options.serve);
        case Options::Command::AddMap:
            return MapsCommand::add(options.map);
        case Options::Command::Watch:
            return WatchCommand::run(options.watch, argc, argv);
        case Options::Command::Config:
            return ConfigCommand::run(options.config, linux_::XdgFolders::configurationFile());
        case Options::Command::Doctor:
            return runDoctor(options.doctor, argc, argv);
        default:
            return run(options, argc, argv);
    }
}

}  // namespace ktr::app
