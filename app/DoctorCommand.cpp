#include "app/DoctorCommand.h"

#include <cstdio>
#include <cstdlib>

#include "app/Messages.h"
#include "host/Resources.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/doctor/CheckUp.h"
#include "linux/locale/LocaleRegion.h"
#include "platform/base/Bundle.h"

namespace ktr::app {

namespace {

std::string environment(const char* name, const char* otherwise) {
    const char* value = std::getenv(name);
    return value == nullptr || *value == '\0' ? otherwise : value;
}

/// Where a session that names no bus has one (systemd, file-hierarchy(7)).
std::string usualSessionBus() {
    const std::string runtime = environment("XDG_RUNTIME_DIR", "");
    return runtime.empty() ? "" : "unix:path=" + runtime + "/bus";
}

}  // namespace

linux_::CheckUp::Places DoctorCommand::places() {
    linux_::CheckUp::Places places;
    places.configuration = linux_::XdgFolders::configurationFile();
    places.preferences =
        linux_::XdgFolders::state() / "preferences" / (std::string(platform::kSnippetsBundle) + ".json");
    places.maps = linux_::XdgFolders::data() / "maps";
    places.texts = host::resourceFolder() / "localization";
    places.language = linux_::LocaleRegion::sessionLanguage();
    places.sessionBus = environment("DBUS_SESSION_BUS_ADDRESS", usualSessionBus().c_str());
    places.systemBus = environment("DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/run/dbus/system_bus_socket");
    return places;
}

host::ExitCode DoctorCommand::run(const DoctorOptions& options) {
    using linux_::CheckUp;
    const auto findings = CheckUp::run(places());
    const std::string text = options.json ? CheckUp::json(findings) : CheckUp::text(findings);
    auto code = CheckUp::isWell(findings) ? host::ExitCode::Ok : host::ExitCode::Failure;
    if (std::fputs(text.c_str(), stdout) == EOF || std::fflush(stdout) != 0) {
        tell("the findings cannot be written");
        code = host::ExitCode::Failure;
    }
    // What still waits for somebody silent is not waited for, nor is what it uses taken away beneath it.
    std::_Exit(static_cast<int>(code));
}

}  // namespace ktr::app
