#include "bench/ScenarioHost.h"

#include <QApplication>
#include <cstdio>
#include <utility>
#include <variant>

#include "app/Options.h"
#include "host/HostSettings.h"
#include "linux/paint/FontSetup.h"

namespace ktr::bench {

std::unique_ptr<host::Host> hostFor(const char* file, const host::Scenario& scenario, host::Host::Time time) {
    app::Options options;
    options.scenarios = {file};
    const auto decided = host::HostSettings::decide(options, {scenario}, {});
    if (const auto* failure = std::get_if<host::Failure>(&decided)) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return nullptr;
    }
    auto made = host::Host::make(std::get<host::HostSettings>(decided), time, {});
    if (const auto* failure = std::get_if<host::Failure>(&made)) {
        std::fprintf(stderr, "%s\n", failure->line.c_str());
        return nullptr;
    }
    return std::move(std::get<std::unique_ptr<host::Host>>(made));
}

int runScenario(int argc, char** argv, int (*run)(const char* file)) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: %s SCENARIO      bench/make-scenario writes long ones\n", argv[0]);
        return 2;
    }
    qputenv("QT_QPA_PLATFORM", "offscreen");
    linux_::FontSetup::prepare(linux_::FontSetup::Mode::System);
    const QApplication application(argc, argv);
    return run(argv[1]);
}

}  // namespace ktr::bench
