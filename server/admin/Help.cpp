#include "server/admin/Help.h"

#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "documents/NearestName.h"

namespace ktr::server {

namespace {

constexpr std::pair<const char*, const char*> kExamples[] = {
    {"init", "init --host home.example --port 443"},
    {"add", "add Ann --handle ann@mail.example --friend Mara"},
    {"reader", "reader Mara --token-file ~/.config/ktr/token > ~/.config/ktr/config.json"},
    {"friend", "friend Ann Mara"},
    {"share", "share Ann Zoe --precision town --until midnight"},
    {"revoke", "revoke Ann Zoe"},
    {"keep", "keep Ann Mara"},
    {"devices", "devices Ann"},
    {"place", "place Ann --name Home --at 50.2104,-3.1200 --label home --said"},
    {"places", "places Ann"},
    {"zone", "zone Ann Europe/Berlin"},
    {"looks", "looks Ann"},
    {"fences", "fences Ann --end 2"},
    {"maps", "maps /srv/maps/region.mbtiles"},
    {"backup", "backup /var/backups/ktr-service.backup"},
    {"restore", "restore /var/backups/ktr-service.backup"},
    {"confirm", "confirm Mara"},
    {"export", "export Ann ann.json"},
    {"forget", "forget Ann"},
    {"retention", "retention Ann --fixes 24h --looks 7d"},
    {"hide", "hide Ann"},
    {"show", "show Ann"},
    {"link", "link Ann"},
    {"face", "face Ann ann.jpg"},
    {"people", "people"},
    {"check", "check"},
    {"serve", "serve --socket /run/ktr-service/http.sock --socket-group www-data"},
};

void addExamples(CLI::App& program) {
    for (CLI::App* command : program.get_subcommands([](const CLI::App*) { return true; })) {
        const auto* example = std::find_if(std::begin(kExamples), std::end(kExamples),
                                           [&](const auto& one) { return command->get_name() == one.first; });
        if (example != std::end(kExamples)) {
            command->footer(std::string("Example: ktr-service ") + example->second);
        }
    }
    program.footer("ktr-service COMMAND --help says more of one, with an example.");
}

std::string sentenceOf(const CLI::App& program, const CLI::ParseError& error, int count, const char* const* words) {
    std::vector<std::string> names;
    for (const CLI::App* command : program.get_subcommands([](const CLI::App*) { return true; })) {
        names.push_back(command->get_name());
    }
    for (int i = 1; i < count; ++i) {
        const std::string_view word = words[i];
        if (word == "--data") {
            ++i;
        } else if (word.rfind('-', 0) != 0) {
            if (std::find(names.begin(), names.end(), word) == names.end()) {
                return "there is no command \"" + std::string(word) + "\"; ktr-service --help lists all" +
                       documents::didYouMean(word, names);
            }
            return std::string(error.what()) + "; ktr-service " + std::string(word) + " --help says what it takes";
        }
    }
    return std::string(error.what()) + "; ktr-service --help lists all commands";
}

}  // namespace

std::optional<int> parsed(CLI::App& program, int count, const char* const* words) {
    addExamples(program);
    try {
        program.parse(count, words);
    } catch (const CLI::CallForHelp& help) {
        return program.exit(help);
    } catch (const CLI::ParseError& error) {
        std::cerr << "ktr-service: " << sentenceOf(program, error, count, words) << std::endl;
        return EXIT_FAILURE;
    }
    return std::nullopt;
}

}  // namespace ktr::server
