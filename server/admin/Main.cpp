// `main` is long: every command of the program once, with its words, in the order in which the help lists them.
#include <unistd.h>

#include <CLI/CLI.hpp>
#include <chrono>
#include <cstdlib>
#include <iostream>
#include <string>
#include <vector>

#include "server/admin/Administration.h"
#include "server/admin/FolderOwner.h"
#include "server/admin/Help.h"
#include "server/admin/KeepingCommands.h"
#include "server/admin/RuleCommands.h"

namespace {

std::string defaultFolder() {
    const char* data = std::getenv("XDG_DATA_HOME");
    if (data != nullptr && data[0] == '/') {
        return std::string(data) + "/ktr-service";
    }
    const char* home = std::getenv("HOME");
    return (home == nullptr ? std::string() : std::string(home)) + "/.local/share/ktr-service";
}

}  // namespace

int main(int count, char** words) {
    CLI::App program("A location service for a family or a club: phones in, friends back.");
    program.require_subcommand(1);
    std::string folder = defaultFolder();
    program.add_option("--data", folder, "Folder of the service (" + folder + ")")->type_name("FOLDER");
    std::string name, other, host, store, picture, token = "ktr-token";
    ktr::server::Newcomer newcomer;
    ktr::server::Administration::GrantWords grant;
    int port = 8443, device = 0;
    const auto named = [&](CLI::App* command) {
        command->add_option("name", name, "The person's name")->required();
        return command;
    };
    CLI::App* init = program.add_subcommand("init", "Makes a service");
    init->add_option("--host", host, "Name or address under which phones reach it")->required();
    init->add_option("--port", port, "Its port (8443)")->check(CLI::Range(0, 65535));
    init->add_option("--store", store, "Keep all on a PostgreSQL server (postgresql:///ktr) instead of in a file");
    CLI::App* add = named(program.add_subcommand("add", "Adds a person with a phone"));
    add->add_option("--handle", newcomer.handles, "E-mail address or phone number by which friends ask")
        ->allow_extra_args(false);
    add->add_option("--key", newcomer.key, "With which the phone seals its messages");
    add->add_flag("--code", newcomer.code, "Print a code for the phone's camera (in a terminal it is always printed)");
    add->add_flag("--shared", newcomer.shared, "The phone is a child's or shared: it shows by whom the person is seen");
    add->add_option("--friend", newcomer.friends, "Somebody there: the two see each other exactly")
        ->allow_extra_args(false);
    add->add_option("--ktr", newcomer.ktr, "Folder of a configuration to write, with which ktr asks for this person")
        ->type_name("FOLDER");
    CLI::App* reader = named(program.add_subcommand("reader", "Prints a configuration for ktr"));
    reader->add_option("--token-file", token, "Where its secret is written (ktr-token)");
    CLI::App* friend_ = named(program.add_subcommand("friend", "Two people see each other exactly"));
    friend_->add_option("other", other, "The other one")->required();
    CLI::App* share = named(program.add_subcommand("share", "Lets somebody see a person"));
    share->add_option("viewer", other, "Who may see")->required();
    share->add_option("--precision", grant.precision, "exact, 1km, town or places (exact)");
    share->add_option("--until", grant.until, "midnight, a time such as 18:30, or a date");
    share->add_option("--arrival", grant.arrival, "A place of the person: it ends when they are there")
        ->type_name("PLACE");
    share->add_flag("--aloud", grant.aloud, "What is seen may be said aloud");
    share->add_flag("--fences", grant.fences, "They may be told when the person comes and goes");
    CLI::App* revoke = named(program.add_subcommand("revoke", "Ends a grant, or all secrets of a person"));
    CLI::Option* noViewer = revoke->add_option("viewer", other, "Who no longer sees the person");
    revoke->add_option("--device", device, "One secret alone, by its number in the list of devices")
        ->excludes(noViewer);
    CLI::App* hide = named(program.add_subcommand("hide", "Hides a person from everybody"));
    CLI::App* show = named(program.add_subcommand("show", "Shows a person again"));
    CLI::App* face = named(program.add_subcommand("face", "Sets or takes away the picture that phones show"));
    face->add_option("picture", picture, "A JPEG or PNG of at most 512 pixels a side; without one: none any more")
        ->type_name("FILE");
    CLI::App* people = program.add_subcommand("people", "Lists people and who sees them");
    CLI::App* link = named(program.add_subcommand("link", "Prints a link that opens a person's own page once"));
    CLI::App* check = program.add_subcommand("check", "Looks whether all is whole");
    CLI::App* serve = program.add_subcommand("serve", "Serves until it is told to end");
    ktr::server::Administration::Serving where;
    serve->add_option("--address", where.address, "Address to serve with the own certificate (127.0.0.1)");
    CLI::Option* socket =
        serve->add_option("--socket", where.place.path, "Socket for a proxy such as caddy or nginx")->type_name("PATH");
    serve->add_option("--socket-group", where.place.group, "Group of the proxy's user, which may connect")
        ->needs(socket);
    const ktr::server::RuleCommands rules(program);
    const ktr::server::KeepingCommands keeping(program);
    if (const auto ended = ktr::server::parsed(program, count, words)) {
        return *ended;
    }
    newcomer.name = name;
    newcomer.coloured = ::isatty(STDOUT_FILENO) != 0;
    newcomer.code = newcomer.code || newcomer.coloured;

    const auto now =
        std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch()).count();
    if (std::string complaint = ktr::server::becomeOwnerOf(folder); !complaint.empty()) {
        std::cerr << "ktr-service: " << complaint << std::endl;
        return EXIT_FAILURE;
    }
    ktr::server::Administration administration(folder, now, std::cout);
    const auto revokes = [&] {
        return device != 0 ? administration.revokeDevice(name, device) : administration.revoke(name, other);
    };
    const std::string complaint = *init      ? administration.init(host, port, store)
                                  : *add     ? administration.add(newcomer)
                                  : *reader  ? administration.reader(name, token)
                                  : *friend_ ? administration.befriend(name, other)
                                  : *share   ? administration.share(name, other, grant)
                                  : *revoke  ? revokes()
                                  : *hide    ? administration.setHidden(name, true)
                                  : *show    ? administration.setHidden(name, false)
                                  : *face    ? administration.face(name, picture)
                                  : *people  ? administration.people()
                                  : *link    ? administration.link(name, newcomer.coloured)
                                  : *check   ? administration.check()
                                  : *serve
                                      ? administration.serve(where)
                                      : rules.run(administration).value_or(keeping.run(administration).value_or(""));
    if (!complaint.empty()) {
        std::cerr << "ktr-service: " << complaint << std::endl;
        return EXIT_FAILURE;
    }
    return EXIT_SUCCESS;
}
