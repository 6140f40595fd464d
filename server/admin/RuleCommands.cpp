#include "server/admin/RuleCommands.h"

namespace ktr::server {

RuleCommands::RuleCommands(CLI::App& program) {
    const auto named = [&](const char* word, const char* help) {
        CLI::App* command = program.add_subcommand(word, help);
        command->add_option("name", name_, "The person's name")->required();
        return command;
    };
    setPlace_ = named("place", "Names a place of a person, changes it, or removes it");
    setPlace_->add_option("--name", place_.name, "What its owner calls it")->required();
    setPlace_->add_option("--at", place_.at, "Where it is: LATITUDE,LONGITUDE in degrees")->type_name("LAT,LON");
    setPlace_->add_option("--label", place_.label,
                          "home, work, school, gym or other: clients have words for these; none");
    setPlace_->add_option("--radius", place_.radius, "Metres from there that belong to it (150)");
    CLI::Option* said = setPlace_->add_flag("--said", said_, "Those who see the person may hear its name");
    setPlace_->add_flag("--unsaid", unsaid_, "Nobody hears its name any more")->excludes(said);
    setPlace_->add_option("--rename", place_.rename, "Another name for one that is there");
    setPlace_->add_flag("--remove", place_.remove, "It has no name any more; grants that end there end now");
    places_ = named("places", "Lists a person's places");
    zone_ = named("zone", "Sets where a person's day ends");
    zone_->add_option("zone", other_, "A time zone such as Europe/Berlin")->required();
    looks_ = named("looks", "Lists who saw a person in the last 30 days");
    fences_ = named("fences", "Lists who is told when a person comes and goes");
    fences_->add_option("--end", number_, "Ends the one with this number")->check(CLI::PositiveNumber);
    keep_ = named("keep", "Says that a grant without an end is still meant");
    keep_->add_option("viewer", other_, "Who sees the person")->required();
    devices_ = named("devices", "Lists a person's phones and readers");
}

std::optional<std::string> RuleCommands::run(Administration& administration) const {
    if (*setPlace_) {
        Administration::PlaceWords place = place_;
        place.said = said_ || unsaid_ ? std::optional(said_) : std::nullopt;
        return administration.setPlace(name_, place);
    }
    if (*places_) {
        return administration.places(name_);
    }
    if (*fences_) {
        return number_ > 0 ? administration.endFence(name_, number_) : administration.fences(name_);
    }
    if (*zone_) {
        return administration.setZone(name_, other_);
    }
    if (*looks_) {
        return administration.looks(name_);
    }
    if (*keep_) {
        return administration.keepGrant(name_, other_);
    }
    if (*devices_) {
        return administration.devices(name_);
    }
    return std::nullopt;
}

}  // namespace ktr::server
