#include "app/KeepingArguments.h"

#include <CLI/CLI.hpp>

namespace ktr::app {

namespace {

const char* const kConfigExamples = R"(Examples:
  ktr config list
  ktr config get account.host
  ktr config set textSize XL
  ktr config set contacts '["~/friends.vcf"]'
  ktr config unset language

ktr.json(5) describes each setting. The app token is none of them.)";

const char* const kDoctorExamples =
    R"(Looks at account, secret, service, clock, contacts, position, maps, letters, locale, screen reader and portals. Exit
status 0: all is fine; 1: something is wrong, and a line says what mends it. Nothing is changed.

Examples:
  ktr doctor
  ktr doctor --json)";

}  // namespace

KeepingArguments::KeepingArguments(CLI::App& program, ConfigOptions& config, DoctorOptions& doctor)
    : config_(config),
      configCommand_(program.add_subcommand("config", "Tells and changes the settings of the configuration file")),
      get_(configCommand_->add_subcommand("get", "Prints a setting; nothing where it has its default")),
      set_(configCommand_->add_subcommand("set", "Changes a setting")),
      unset_(configCommand_->add_subcommand("unset", "Gives a setting its default again")),
      doctorCommand_(program.add_subcommand("doctor", "Looks for what is wrong, and says what mends it")) {
    configCommand_->require_subcommand(1);
    configCommand_->footer(kConfigExamples);
    configCommand_->add_subcommand("list", "Prints all settings that are set")
        ->add_flag("--json", config.json, "As one JSON object");
    for (CLI::App* command : {get_, set_, unset_}) {
        command->add_option("name", config.name, "The setting, such as account.host")->required()->type_name("NAME");
    }
    set_->add_option("value", config.value, "A text, or JSON for a number, a truth value or a list")
        ->required()
        ->type_name("VALUE");
    doctorCommand_->add_flag("--json", doctor.json, "As one JSON object");
    doctorCommand_->footer(kDoctorExamples);
}

bool KeepingArguments::isConfig() const {
    using Action = ConfigOptions::Action;
    config_.action = get_->parsed()     ? Action::Get
                     : set_->parsed()   ? Action::Set
                     : unset_->parsed() ? Action::Unset
                                        : Action::List;
    return configCommand_->parsed();
}

bool KeepingArguments::isDoctor() const {
    return doctorCommand_->parsed();
}

}  // namespace ktr::app
