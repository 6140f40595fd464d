#include "server/admin/KeepingCommands.h"

namespace ktr::server {

KeepingCommands::KeepingCommands(CLI::App& program) {
    const auto named = [&](const char* word, const char* help) {
        CLI::App* command = program.add_subcommand(word, help);
        command->add_option("name", name_, "The person's name")->required();
        return command;
    };
    maps_ = program.add_subcommand("maps", "Says, or sets, by which maps places get their streets and towns");
    CLI::Option* maps =
        maps_->add_option("file", files_, "MBTiles files with vector tiles, the finer ones first")->type_name("FILE");
    maps_->add_flag("--none", none_, "By none any more")->excludes(maps);
    backup_ = program.add_subcommand("backup", "Writes all but places, looks and sessions to a file");
    backup_->add_option("file", file_, "Written as a whole or not at all")->required();
    restore_ = program.add_subcommand("restore", "Brings a backup back, with everybody hidden");
    restore_->add_option("file", file_, "The backup")->required();
    restore_->add_flag("--replace", replace_, "Also when there are people: they are replaced by those of the backup");
    confirm_ = named("confirm", "After a restore: the person's readers work again, on the person's word");
    export_ = named("export", "Writes all that is kept of a person to a file");
    export_->add_option("file", file_, "JSON, readable for you alone")->required();
    forget_ = named("forget", "Deletes a person and all that is kept of them; no backup brings them back");
    retention_ = named("retention", "Says, or sets, how long something is kept of a person");
    retention_->add_option("--fixes", fixes_, "Where they were: 1h to 48h");
    retention_->add_option("--looks", looks_, "Who looked: 1d to 30d");
}

std::optional<std::string> KeepingCommands::run(Administration& administration) const {
    if (*maps_) {
        return administration.maps(files_, none_);
    }
    if (*backup_) {
        return administration.backup(file_);
    }
    if (*restore_) {
        return administration.restore(file_, replace_);
    }
    if (*confirm_) {
        return administration.confirm(name_);
    }
    if (*export_) {
        return administration.exportPerson(name_, file_);
    }
    if (*forget_) {
        return administration.forget(name_);
    }
    if (*retention_) {
        return administration.retention(name_, fixes_, looks_);
    }
    return std::nullopt;
}

}  // namespace ktr::server
