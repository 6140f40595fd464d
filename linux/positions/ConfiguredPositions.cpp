#include "linux/positions/ConfiguredPositions.h"

#include <variant>

#include "linux/positions/GeoClueSource.h"
#include "linux/positions/GpsdSource.h"
#include "linux/positions/ScenarioLocationManagerFactory.h"
#include "linux/positions/SourceLocationManagerFactory.h"
#include "linux/positions/TrackReader.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

std::shared_ptr<platform::LocationManagerFactory> ConfiguredPositions::make(
    const Configuration::Positions& configuration, const std::shared_ptr<platform::MainLoop>& mainLoop,
    const std::shared_ptr<platform::Clock>& clock, const std::shared_ptr<platform::Geodesy>& geodesy) {
    using Source = Configuration::Positions::Source;
    const auto shared = [&](std::unique_ptr<PositionSource> source) {
        return std::make_shared<SourceLocationManagerFactory>(
            std::make_shared<PositionHub>(std::move(source), mainLoop, geodesy));
    };
    std::vector<TimedPosition> walk;
    switch (configuration.source) {
        case Source::GeoClue:
            return shared(std::make_unique<GeoClueSource>(mainLoop, QStringLiteral("org.ktr.ktr")));
        case Source::Gpsd:
            return shared(std::make_unique<GpsdSource>(QString::fromStdString(configuration.gpsdHost),
                                                       static_cast<quint16>(configuration.gpsdPort), mainLoop));
        case Source::Track: {
            auto read = TrackReader::readFile(configuration.file);
            if (auto* positions = std::get_if<std::vector<TimedPosition>>(&read)) {
                walk = std::move(*positions);
            } else {
                platform::areaLog(platform::LogArea::Positions)
                    .write(platform::LogLevel::Error, "%@",
                           platform::FormatArgument(std::get<documents::DocumentError>(read).text()).shown());
            }
            break;
        }
        case Source::None:
            break;
    }
    return std::make_shared<ScenarioLocationManagerFactory>(std::move(walk), mainLoop, clock, geodesy);
}

}  // namespace ktr::linux_
