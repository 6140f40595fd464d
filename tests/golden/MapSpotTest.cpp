// A friend's pin and circle stand on their place to a pixel, at every scale: measured in pictures of the whole program
// against numbers of this file's own.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QImage>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTemporaryDir>
#include <cmath>
#include <numbers>

#include "app/CommandLine.h"
#include "app/RenderCommand.h"
#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"

namespace ktr::test {

namespace {

constexpr double kLatitude = 50.211708;
constexpr double kLongitude = -3.116166;
constexpr double kZoomLevel = 0.05F;
constexpr double kRadius = 2000.0;
// The map in a conversation 400 wide: 12 in, 219 high, its middle here. Points.
constexpr double kMiddleX = 200.0;
constexpr double kMapHeight = 219.0;

double radians(double degrees) {
    return degrees * std::numbers::pi / 180.0;
}
double mercator(double latitude) {
    return std::log(std::tan(std::numbers::pi / 4.0 + radians(latitude) / 2.0));
}
/// Points a radian of longitude: the northern half of the span fills the upper half of the map.
double pointsARadian() {
    return kMapHeight / 2.0 / (mercator(kLatitude + kZoomLevel / 2.0) - mercator(kLatitude));
}

struct Measured {
    double east = 0.0;   // points from the middle
    double south = 0.0;  // the same
};
/// How far the circle reaches on the WGS84 ellipsoid.
Measured reach() {
    constexpr double kA = 6378137.0;
    constexpr double kE2 = 0.00669437999014;
    const double sine = std::sin(radians(kLatitude));
    const double w = 1.0 - kE2 * sine * sine;
    const double east = kRadius / (kA / std::sqrt(w) * std::cos(radians(kLatitude)));
    const double south = kRadius / (kA * (1.0 - kE2) / std::pow(w, 1.5));
    return {east * pointsARadian(),
            (mercator(kLatitude) - mercator(kLatitude - south * 180.0 / std::numbers::pi)) * pointsARadian()};
}

bool isOrange(const QColor& c) {
    return c.red() > 220 && c.green() > 110 && c.green() < 170 && c.blue() < 60;
}

}  // namespace

class MapSpotTest : public ::testing::TestWithParam<double> {
  protected:
    /// The demo's Ann, with this accuracy, for a user who is nowhere.
    QImage drawn(double accuracy) {
        QFile source(QStringLiteral(KTR_SOURCE_DIR "/resources/scenarios/single.json"));
        EXPECT_TRUE(source.open(QIODevice::ReadOnly));
        QJsonObject scenario = QJsonDocument::fromJson(source.readAll()).object();
        scenario.remove(QStringLiteral("positions"));
        scenario[QStringLiteral("contacts")] = QStringLiteral(KTR_SOURCE_DIR "/resources/scenarios/contacts");
        QJsonObject snippet = scenario[QStringLiteral("snippet")].toObject();
        QJsonObject place = snippet[QStringLiteral("locations")].toArray().first().toObject();
        place[QStringLiteral("latitude")] = kLatitude;
        place[QStringLiteral("longitude")] = kLongitude;
        place[QStringLiteral("accuracy")] = accuracy;
        snippet[QStringLiteral("locations")] = QJsonArray{place};
        scenario[QStringLiteral("snippet")] = snippet;
        QFile file(folder_.filePath(QStringLiteral("ann.json")));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(QJsonDocument(scenario).toJson());
        file.close();
        return render(file.fileName().toStdString());
    }
    QImage render(const std::string& path) {
        const std::string picture = folder_.filePath(QStringLiteral("ann.png")).toStdString();
        const auto parsed = app::CommandLine::parse(
            {"render", path, "-o", picture, "--scale", std::to_string(GetParam()), "--plugin", KTR_PLUGIN_FILE});
        const auto* options = std::get_if<app::Options>(&parsed);
        auto read = host::ScenarioReader({0.0}).readFile(path);
        const auto* scenario = std::get_if<host::Scenario>(&read);
        if (options == nullptr || scenario == nullptr) {
            return {};
        }
        const auto settings = host::HostSettings::decide(*options, {*scenario}, {});
        auto made =
            host::Host::make(std::get<host::HostSettings>(settings), host::Host::Time::Virtual, options->plugin);
        const auto& host = std::get<std::unique_ptr<host::Host>>(made);
        if (host->addTurn(*scenario) || app::RenderCommand(*host).write(picture)) {
            return {};
        }
        return QImage(QString::fromStdString(picture));
    }

  private:
    QTemporaryDir folder_;
};

TEST_P(MapSpotTest, PinAndCircleStandOnTheirPlace) {
    const double scale = GetParam();
    const QImage sure = drawn(0.0);
    const QImage vague = drawn(kRadius);
    ASSERT_FALSE(sure.isNull());
    ASSERT_EQ(sure.size(), vague.size());
    // What the circle alone adds; its upper half stands behind the pin.
    QRect circle;
    for (int y = 0; y < sure.height(); ++y) {
        for (int x = 0; x < sure.width(); ++x) {
            const QColor a = sure.pixelColor(x, y);
            const QColor b = vague.pixelColor(x, y);
            if (std::abs(a.red() - b.red()) + std::abs(a.green() - b.green()) + std::abs(a.blue() - b.blue()) > 12) {
                circle |= QRect(x, y, 1, 1);
            }
        }
    }
    const Measured expected = reach();
    EXPECT_NEAR(circle.left() / scale, kMiddleX - expected.east, 1.5 / scale);
    EXPECT_NEAR((circle.right() + 1) / scale, kMiddleX + expected.east, 1.5 / scale);
    // The picture ends 24 points below the map.
    const double middleY = sure.height() / scale - 24.0 - kMapHeight / 2.0;
    EXPECT_NEAR((circle.bottom() + 1) / scale, middleY + expected.south, 1.5 / scale);

    const auto orangeAt = [&](double x, double y) {
        return isOrange(sure.pixelColor(static_cast<int>(x * scale), static_cast<int>(y * scale)));
    };
    EXPECT_TRUE(orangeAt(kMiddleX, middleY - 3.0));
    EXPECT_FALSE(orangeAt(kMiddleX, middleY + 1.0));
    // The same to both sides of the middle.
    int left = sure.width();
    int right = 0;
    const int row = static_cast<int>((middleY - 8.0) * scale);
    for (int x = 0; x < sure.width(); ++x) {
        if (isOrange(sure.pixelColor(x, row))) {
            left = std::min(left, x);
            right = std::max(right, x + 1);
        }
    }
    EXPECT_NEAR((left + right) / 2.0 / scale, kMiddleX, 0.5 / scale);
}

INSTANTIATE_TEST_SUITE_P(Scales, MapSpotTest, ::testing::Values(1.0, 2.0, 3.0),
                         [](const auto& tested) { return std::to_string(static_cast<int>(tested.param)); });

}  // namespace ktr::test
