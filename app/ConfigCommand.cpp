#include "app/ConfigCommand.h"

#include <cstdio>

#include "app/Messages.h"
#include "documents/Words.h"
#include "linux/configuration/ConfigurationFile.h"
#include "linux/configuration/ConfigurationReader.h"
#include "platform/base/Json.h"

namespace ktr::app {

namespace {

using platform::Value;

/// A text as it stands; everything else as JSON.
std::string printed(const Value& value) {
    return value.string() != nullptr ? documents::forLine(*value.string(), std::string::npos)
                                     : documents::jsonForTerminal(platform::writeJson(value));
}

host::ExitCode print(const std::string& text) {
    if (std::fputs(text.c_str(), stdout) == EOF || std::fflush(stdout) != 0) {
        tell("the answer cannot be written");
        return host::ExitCode::Failure;
    }
    return host::ExitCode::Ok;
}

host::ExitCode failed(const std::string& line) {
    tell(line);
    return host::ExitCode::Failure;
}

/// What is misspelt in the file is said wherever the file is told.
void tellOfUnknown(const std::filesystem::path& file) {
    documents::DocumentWarnings warnings;
    linux_::ConfigurationReader::readFile(file, &warnings);
    tell(warnings);
}

host::ExitCode list(const linux_::ConfigurationFile& file, bool asJson) {
    const auto listed = file.list();
    if (const auto* problem = std::get_if<std::string>(&listed)) {
        return failed(*problem);
    }
    std::string text;
    platform::Dictionary object;
    for (const auto& [name, value] : std::get<0>(listed)) {
        text += name + " = " + printed(value) + "\n";
        object.set(name, value);
    }
    return print(asJson ? documents::jsonForTerminal(platform::writeJson(object)) + "\n" : text);
}

}  // namespace

host::ExitCode ConfigCommand::run(const ConfigOptions& options, const std::filesystem::path& path) {
    const linux_::ConfigurationFile file(path);
    using Action = ConfigOptions::Action;
    std::string problem;
    switch (options.action) {
        case Action::List:
            tellOfUnknown(path);
            return list(file, options.json);
        case Action::Get: {
            const auto got = file.get(options.name);
            if (got.index() == 1) {
                return failed(std::get<1>(got));
            }
            const Value& value = std::get<0>(got);
            return value.isNull() ? host::ExitCode::Ok : print(printed(value) + "\n");
        }
        case Action::Set:
            problem = file.set(options.name, options.value);
            break;
        case Action::Unset:
            problem = file.change({{options.name, std::nullopt}});
            break;
    }
    return problem.empty() ? host::ExitCode::Ok : failed(problem);
}

}  // namespace ktr::app
