#include "app/ServeArguments.h"

#include <CLI/CLI.hpp>
#include <cmath>

#include "documents/Words.h"
#include "serve/FaultScript.h"

namespace ktr::app {

namespace {

const char* const kExamples = R"(Examples:
  ktr serve --write-config /tmp/ktr.json
  ktr serve --port 8443 --interval 2 --fault status=503,at=5,count=1
  ktr serve --friends dinner.json --fault delay=3

The service says on its standard output when it is ready, and then one line a request. docs/service-protocol.md
describes requests, answers, the friends file and the faults.)";

}  // namespace

struct ServeArguments::Words {
    serve::ServeOptions options;
    std::vector<std::string> faults;
    std::string certificate = "good";
};

ServeArguments::ServeArguments(CLI::App& program)
    : command_(program.add_subcommand("serve", "Runs a development service on this machine, with friends who move")),
      words_(std::make_unique<Words>()) {
    serve::ServeOptions& options = words_->options;
    CLI::App& command = *command_;
    command.add_option("--port", options.port, "Port on 127.0.0.1 (a free one)")
        ->type_name("PORT")
        ->check(CLI::Range(0, 65535));
    command.add_option("--ca-dir", options.folder, "Folder of the certificates and the token")->type_name("FOLDER");
    command.add_option("--friends", options.friends, "Friends file, or a scenario (the demo people)")
        ->type_name("FILE");
    command.add_option("--interval", options.intervalSeconds, "Seconds between two answers; 0 ends the asking")
        ->type_name("SECONDS")
        ->check(CLI::Range(0.0, 86400.0));
    command.add_option("--fault", words_->faults, "A fault in words, such as status=503,at=2,count=1")
        ->type_name("WORDS")
        ->allow_extra_args(false);
    command.add_option("--fault-script", options.faultScript, "File with faults")->type_name("FILE");
    command.add_option("--person", options.personId, "Person identifier of the account (1000)")->type_name("TEXT");
    command
        .add_option("--positions", options.positions, "The user's own track, for the configuration: GPX or scenario")
        ->type_name("FILE");
    command
        .add_option("--contacts", options.contacts,
                    "The user's contacts, for the configuration: a vCard file or a folder of them (the friends)")
        ->type_name("PATH");
    command.add_flag("--print-config", options.printConfig, "Print a configuration that uses this service");
    command.add_option("--write-config", options.writeConfig, "Write that configuration to a file")->type_name("FILE");
    command.add_flag("--until-stdin-closes", options.untilStdinCloses, "End when the standard input ends");
    command.add_option("--certificate", words_->certificate, "good, expired, wrong-host or foreign (good)")
        ->type_name("KIND");
    command.footer(kExamples);
}

ServeArguments::~ServeArguments() = default;

bool ServeArguments::parsed() const {
    return command_->parsed();
}

std::string ServeArguments::read(serve::ServeOptions& options) const {
    options = words_->options;
    for (const std::string& words : words_->faults) {
        std::string complaint;
        const auto fault = serve::FaultScript::readWords(words, complaint);
        if (!fault) {
            return "--fault: " + complaint;
        }
        options.faults.push_back(*fault);
    }
    const std::string& kind = words_->certificate;
    if (kind == "good") {
        options.certificate = serve::CertificateKind::Good;
    } else if (kind == "expired") {
        options.certificate = serve::CertificateKind::Expired;
    } else if (kind == "wrong-host") {
        options.certificate = serve::CertificateKind::WrongHost;
    } else if (kind == "foreign") {
        options.certificate = serve::CertificateKind::Foreign;
    } else {
        return "--certificate: expected one of good, expired, wrong-host, foreign, found " + documents::inQuotes(kind);
    }
    // The parser's own check lets "nan" through.
    if (std::isnan(options.intervalSeconds)) {
        return "--interval: expected a number from 0 to 86400, found \"nan\"";
    }
    if (options.personId.empty() || options.personId.find(':') != std::string::npos) {
        return "--person: expected a text without \":\", found " + documents::inQuotes(options.personId);
    }
    return "";
}

}  // namespace ktr::app
