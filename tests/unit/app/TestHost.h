#pragma once

#include <QWidget>
#include <memory>
#include <string>
#include <vector>

#include "host/Host.h"
#include "host/HostOptions.h"
#include "host/scenario/Scenario.h"

namespace ktr::app {

/// Demo scenarios by their names; one that cannot be read fails the test and is none of them.
std::vector<host::Scenario> demoScenarios(const std::vector<std::string>& names);

/// A host with the real plugin, with a turn for each scenario; null, and the test fails, where there can be none.
std::unique_ptr<host::Host> testHost(const host::HostOptions& options,
                                     const std::vector<host::Scenario>& scenarios = {},
                                     host::Host::Time time = host::Host::Time::Virtual);

/// Where KTR_GALLERY names a folder: what the widget shows, at twice its size, as NAME.png there.
void keepPicture(QWidget& widget, const std::string& name);

}  // namespace ktr::app
