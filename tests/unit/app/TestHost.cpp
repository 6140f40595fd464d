#include "tests/unit/app/TestHost.h"

#include <QApplication>
#include <QDir>
#include <QImage>
#include <utility>
#include <variant>

#include "host/scenario/ScenarioReader.h"

#include <gtest/gtest.h>

namespace ktr::app {

std::vector<host::Scenario> demoScenarios(const std::vector<std::string>& names) {
    std::vector<host::Scenario> scenarios;
    for (const std::string& name : names) {
        auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/" + name + ".json");
        if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
            ADD_FAILURE() << error->text();
        } else {
            scenarios.push_back(std::get<host::Scenario>(std::move(read)));
        }
    }
    return scenarios;
}

std::unique_ptr<host::Host> testHost(const host::HostOptions& options, const std::vector<host::Scenario>& scenarios,
                                     host::Host::Time time) {
    const auto settings = host::HostSettings::decide(options, scenarios, {});
    if (const auto* failure = std::get_if<host::Failure>(&settings)) {
        ADD_FAILURE() << failure->line;
        return nullptr;
    }
    auto made = host::Host::make(std::get<host::HostSettings>(settings), time, KTR_PLUGIN_FILE);
    if (const auto* failure = std::get_if<host::Failure>(&made)) {
        ADD_FAILURE() << failure->line;
        return nullptr;
    }
    auto host = std::get<std::unique_ptr<host::Host>>(std::move(made));
    for (const host::Scenario& scenario : scenarios) {
        const auto failure = host->addTurn(scenario);
        EXPECT_FALSE(failure) << failure->line;
    }
    return host;
}

void keepPicture(QWidget& widget, const std::string& name) {
    const QString folder = qEnvironmentVariable("KTR_GALLERY");
    if (folder.isEmpty()) {
        return;
    }
    QApplication::processEvents();
    QImage picture(widget.size() * 2, QImage::Format_RGB32);
    picture.setDevicePixelRatio(2.0);
    widget.render(&picture);
    EXPECT_TRUE(picture.save(QDir(folder).filePath(QString::fromStdString(name + ".png"))));
}

}  // namespace ktr::app
