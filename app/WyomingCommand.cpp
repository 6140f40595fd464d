#include "app/WyomingCommand.h"

#include <QCoreApplication>
#include <QTimer>
#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <utility>

#include "app/Messages.h"
#include "host/Resources.h"
#include "host/scenario/Scenario.h"

#ifndef KTR_VERSION
#error "KTR_VERSION is given by the build"
#endif

namespace ktr::app {

namespace {

/// How long a keyring may take before questions are taken without a secret, milliseconds.
constexpr int kAccountWait = 10000;

PeerList peersOf(const WyomingCommand::Options& options) {
    PeerList peers;
    for (const std::string& text : options.allowed) {
        peers.add(text);
    }
    return peers;
}

/// Those that questions are understood in.
std::vector<std::string> languages() {
    std::vector<std::string> tags;
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(host::resourceFolder() / "questions", error)) {
        if (entry.path().extension() == ".json") {
            tags.push_back(entry.path().stem().string());
        }
    }
    std::sort(tags.begin(), tags.end());
    return tags;
}

}  // namespace

std::string WyomingCommand::objection(const Options& options) {
    const QHostAddress address(QString::fromStdString(options.address));
    if (address.isNull()) {
        return "--listen: expected an address of this machine, such as 127.0.0.1";
    }
    PeerList peers;
    for (const std::string& text : options.allowed) {
        if (const std::string complaint = peers.add(text); !complaint.empty()) {
            return "--allow: " + complaint;
        }
    }
    // Nobody is asked for a password.
    return address.isLoopback() || !peers.isEmpty()
               ? ""
               : "--listen: other machines need --allow ADDRESS, as there is no password";
}

WyomingCommand::WyomingCommand(host::Host& host, const Options& options)
    : host_(host),
      options_(options),
      desk_(host, host::QuestionDesk::Audience::WhoeverHears),
      server_({peersOf(options), languages(), KTR_VERSION,
               [this](const std::string& text, const std::string& language, const WyomingServer::Answer& answer) {
                   ask(text, language, answer);
               }}) {}

void WyomingCommand::ask(const std::string& text, const std::string& language, const WyomingServer::Answer& answer) {
    ask::Question question = desk_.question(text, false);
    if (host::isLanguageTag(language)) {
        question.language = language;
    }
    desk_.ask(question, [answer](const ask::Answer& given) {
        answer({given.sentence, given.outcome != ask::Outcome::NotUnderstood});
    });
}

bool WyomingCommand::listen() {
    const std::string complaint =
        server_.listen(QHostAddress(QString::fromStdString(options_.address)), static_cast<quint16>(options_.port));
    if (!complaint.empty()) {
        tell("cannot listen on " + options_.address + ", port " + std::to_string(options_.port) + ": " + complaint);
        return false;
    }
    const bool isIpv6 = options_.address.find(':') != std::string::npos;
    const std::string address = isIpv6 ? "[" + options_.address + "]" : options_.address;
    std::fputs(("ready " + address + ":" + std::to_string(server_.port()) + "\n").c_str(), stdout);
    std::fflush(stdout);
    return true;
}

host::ExitCode WyomingCommand::run() {
    std::optional<bool> isListening;
    const auto listenOnce = [&] {
        if (!isListening) {
            isListening = listen();
            if (!*isListening) {
                QCoreApplication::exit(static_cast<int>(host::ExitCode::Failure));
            }
        }
    };
    // An exit before the loop runs would be forgotten.
    QTimer::singleShot(0, &server_, [&] { host_.live()->start(listenOnce); });
    QTimer::singleShot(kAccountWait, &server_, listenOnce);
    return static_cast<host::ExitCode>(QCoreApplication::exec());
}

}  // namespace ktr::app
