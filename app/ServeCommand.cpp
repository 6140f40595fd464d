#include "app/ServeCommand.h"

#include <poll.h>
#include <sys/signalfd.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <filesystem>
#include <iostream>
#include <variant>

#include "app/Messages.h"
#include "documents/AtomicFile.h"
#include "documents/FileSteps.h"
#include "documents/Words.h"
#include "linux/configuration/XdgFolders.h"
#include "platform/base/Json.h"
#include "serve/DevelopmentServer.h"
#include "serve/FriendsReader.h"
#include "serve/ServedContacts.h"

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

namespace fs = std::filesystem;

host::ExitCode complain(const std::string& line, host::ExitCode code = host::ExitCode::Failure) {
    tell(line);
    return code;
}

/// What lies beside the program: in the build tree and in an installation alike.
fs::path resource(const char* name) {
    std::error_code failure;
    const fs::path program = fs::read_symlink("/proc/self/exe", failure);
    return (program.parent_path() / "../share/ktr/service" / name).lexically_normal();
}

std::string configuration(const serve::ServeOptions& options, const serve::DevelopmentCertificates& certificates,
                          const std::string& userName, const std::string& contacts, int port) {
    const Dictionary account{{"personId", options.personId},
                             {"userName", userName},
                             {"host", "localhost:" + std::to_string(port)},
                             {"tokenFile", certificates.tokenFile().string()}};
    const std::string track = !options.positions.empty()
                                  ? documents::FileSteps::absolute(options.positions).lexically_normal().string()
                              : options.friends.empty() ? resource("walk.gpx").string()
                                                        : std::string();
    const Dictionary positions =
        track.empty() ? Dictionary{{"source", "none"}} : Dictionary{{"source", "track"}, {"file", track}};
    return platform::writeJson(Dictionary{{"account", account},
                                          {"certificates", Value::Array{certificates.authorityFile().string()}},
                                          {"contacts", Value::Array{contacts}},
                                          {"positions", positions}});
}

/// Why the configuration cannot name what an option gave; empty when it can, or when nothing was given.
std::string complaintAbout(const char* option, const std::string& given, bool folderToo) {
    std::error_code failed;
    const fs::file_status found = fs::status(given, failed);
    if (given.empty() || fs::is_regular_file(found) || (folderToo && fs::is_directory(found))) {
        return "";
    }
    const char* what = !fs::exists(found) ? " is not there"
                       : folderToo        ? " is neither a file nor a folder"
                                          : " is not a file";
    return std::string(option) + ": " + documents::inQuotes(given) + what;
}

/// The contacts that the configuration names; writes them where none are given. Empty, and the reason in `failure`,
/// when that fails.
std::string contactsFor(const serve::ServeOptions& options, const fs::path& folder, const serve::FriendsFile& friends,
                        std::string& failure) {
    if (!options.contacts.empty()) {
        failure = complaintAbout("--contacts", options.contacts, true);
        return documents::FileSteps::absolute(options.contacts).lexically_normal().string();
    }
    const fs::path file = documents::FileSteps::absolute(folder / "contacts.vcf").lexically_normal();
    std::vector<serve::ServedFriend> people = friends.friends;
    people.push_back(friends.user);
    failure = documents::AtomicFile::write(file, serve::ServedContacts::vCards(people));
    return file.string();
}

/// Reads away what comes; false at the end of the standard input.
bool drainStandardInput() {
    std::array<char, 4096> block{};
    const ssize_t count = ::read(STDIN_FILENO, block.data(), block.size());
    return count > 0 || (count < 0 && (errno == EINTR || errno == EAGAIN));
}

void waitForTheEnd(int signals, bool standardInput) {
    std::array<pollfd, 2> watched{pollfd{signals, POLLIN, 0}, pollfd{standardInput ? STDIN_FILENO : -1, POLLIN, 0}};
    for (;;) {
        const int count = ::poll(watched.data(), watched.size(), -1);
        if (count < 0 && errno != EINTR) {
            return;
        }
        if (count > 0 && watched[0].revents != 0) {
            return;
        }
        if (count > 0 && watched[1].revents != 0 && !drainStandardInput()) {
            return;
        }
    }
}

/// The signals that end the service, as a descriptor; blocked in this thread and in those that it makes.
int endingSignals() {
    sigset_t set;
    sigemptyset(&set);
    sigaddset(&set, SIGINT);
    sigaddset(&set, SIGTERM);
    sigaddset(&set, SIGHUP);
    ::pthread_sigmask(SIG_BLOCK, &set, nullptr);
    // A client that goes away, or a reader of our lines, is no reason to end.
    std::signal(SIGPIPE, SIG_IGN);
    return ::signalfd(-1, &set, SFD_CLOEXEC);
}

std::variant<serve::DevelopmentServer::Setup, documents::DocumentError> readSetup(const serve::ServeOptions& options) {
    serve::DevelopmentServer::Setup setup;
    const std::string file = options.friends.empty() ? resource("friends.json").string() : options.friends;
    documents::DocumentWarnings warnings;
    auto friends = serve::FriendsReader::readFile(file, &warnings);
    if (const auto* error = std::get_if<documents::DocumentError>(&friends)) {
        return *error;
    }
    setup.friends = std::get<serve::FriendsFile>(std::move(friends));
    if (options.intervalSeconds >= 0.0) {
        setup.friends.intervalSeconds = options.intervalSeconds;
    }
    if (!options.faultScript.empty()) {
        auto script = serve::FaultScript::readFile(options.faultScript, &warnings);
        if (const auto* error = std::get_if<documents::DocumentError>(&script)) {
            return *error;
        }
        setup.faults = std::get<serve::FaultScript>(std::move(script));
    }
    for (const serve::Fault& fault : options.faults) {
        setup.faults.add(fault);
    }
    tell(warnings);
    setup.maps = {resource("../maps/brinmouth.mbtiles").string()};
    setup.port = options.port;
    setup.personId = options.personId;
    return setup;
}

}  // namespace

host::ExitCode ServeCommand::run(const serve::ServeOptions& options) {
    auto read = readSetup(options);
    if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
        return complain(error->text(), host::ExitCode::BadScenario);
    }
    const fs::path folder = options.folder.empty() ? linux_::XdgFolders::state() / "serve" : fs::path(options.folder);
    const auto prepared = serve::DevelopmentCertificates::prepare(folder);
    if (const auto* failure = std::get_if<std::string>(&prepared)) {
        return complain(*failure);
    }
    const auto& certificates = std::get<serve::DevelopmentCertificates>(prepared);
    const auto certificate = certificates.makeServerCertificate(options.certificate);
    if (!certificate) {
        return complain("the service's certificate cannot be made");
    }
    auto& setup = std::get<serve::DevelopmentServer::Setup>(read);
    const std::string userName = setup.friends.user.handle();
    std::string failure = complaintAbout("--positions", options.positions, false);
    if (!failure.empty()) {
        return complain(failure);
    }
    const std::string contacts = contactsFor(options, folder, setup.friends, failure);
    if (!failure.empty()) {
        return complain(failure);
    }
    const int signals = endingSignals();
    setup.token = certificates.token();
    setup.certificate = *certificate;
    setup.report = [](const std::string& line) { std::cout << documents::forLine(line) << std::endl; };
    serve::DevelopmentServer server(std::move(setup));
    const std::string refused = signals < 0 ? "signals cannot be waited for" : server.start();
    if (!refused.empty()) {
        ::close(signals);
        return complain(refused);
    }
    const std::string config = configuration(options, certificates, userName, contacts, server.port());
    if (failure.empty() && !options.writeConfig.empty()) {
        failure = documents::AtomicFile::write(options.writeConfig, config + "\n");
    }
    if (failure.empty()) {
        std::cout << "ready https://localhost:" << server.port() << " "
                  << documents::forLine(certificates.authorityFile().string(), std::string::npos) << std::endl;
        if (options.printConfig) {
            std::cout << config << std::endl;
        }
        waitForTheEnd(signals, options.untilStdinCloses);
    }
    server.stop();
    ::close(signals);
    return failure.empty() ? host::ExitCode::Ok : complain(failure);
}

}  // namespace ktr::app
