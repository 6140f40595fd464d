#include "app/MapsCommand.h"

#include <cstdio>
#include <filesystem>

#include "app/AddedMaps.h"
#include "app/Messages.h"
#include "documents/Words.h"

namespace ktr::app {

host::ExitCode MapsCommand::add(const std::string& file) {
    const auto added = AddedMaps::add(file);
    if (const auto* problem = std::get_if<AddedMaps::Problem>(&added)) {
        tell(documents::forLine(file) + ": " + documents::forLine(problem->why));
        return host::ExitCode::Failure;
    }
    const std::string name = std::filesystem::weakly_canonical(file).filename().string();
    const bool isSaid = std::printf("%s: %s\n", documents::forLine(name).c_str(),
                                    documents::forLine(std::get<std::string>(added), std::string::npos).c_str()) >= 0;
    return isSaid && std::fflush(stdout) == 0 ? host::ExitCode::Ok : host::ExitCode::Failure;
}

}  // namespace ktr::app
