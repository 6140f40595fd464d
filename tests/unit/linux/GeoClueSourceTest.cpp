#include "linux/positions/GeoClueSource.h"

#include <QDBusObjectPath>
#include <QDBusVariant>
#include <QVariantMap>
#include <limits>
#include <memory>
#include <vector>

#include "tests/support/PlatformTest.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::GeoClueSource;

class GeoClueSourceTest : public PlatformTest {
  protected:
    GeoClueSourceTest()
        : service(bus.connect(QStringLiteral("geoclue"))), client(bus.connect(QStringLiteral("program"))) {}
    ~GeoClueSourceTest() override {
        PrivateBus::disconnect(QStringLiteral("geoclue"));
        PrivateBus::disconnect(QStringLiteral("program"));
    }

    bool answer(const QDBusMessage& message, const QDBusConnection& connection) {
        const QString member = message.member();
        calls << member;
        if (member == QLatin1String("CreateClient")) {
            return connection.send(message.createReply(QVariant::fromValue(QDBusObjectPath(kClient))));
        }
        if (member == QLatin1String("Set")) {
            const auto value = qvariant_cast<QDBusVariant>(message.arguments().at(2)).variant();
            settings[message.arguments().at(1).toString()] = value;
            return connection.send(message.createReply());
        }
        if (member == QLatin1String("Start") && denied) {
            return connection.send(message.createErrorReply(QDBusError::AccessDenied, QStringLiteral("no")));
        }
        if (member == QLatin1String("GetAll")) {
            return connection.send(message.createReply(QVariant(position)));
        }
        return connection.send(message.createReply());
    }
    void startGeoClue() {
        fake = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            return answer(message, connection);
        });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/GeoClue2"), fake.get(),
                                                  QDBusConnection::SubPath));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.GeoClue2")));
    }
    void announce() {
        QDBusMessage signal = QDBusMessage::createSignal(kClient, QStringLiteral("org.freedesktop.GeoClue2.Client"),
                                                         QStringLiteral("LocationUpdated"));
        signal << QVariant::fromValue(QDBusObjectPath(QStringLiteral("/")))
               << QVariant::fromValue(QDBusObjectPath(QStringLiteral("/org/freedesktop/GeoClue2/Location/1")));
        ASSERT_TRUE(service.send(signal));
    }
    std::unique_ptr<GeoClueSource> startedSource() {
        auto source = std::make_unique<GeoClueSource>(time, QStringLiteral("org.ktr.ktr"), client);
        source->setListener([this](const auto& fix) { fixes.push_back(fix); });
        source->start(10.0);
        return source;
    }

    const QString kClient = QStringLiteral("/org/freedesktop/GeoClue2/Client/1");
    PrivateBus bus;
    QDBusConnection service, client;
    std::unique_ptr<FakeService> fake;
    QStringList calls;
    QVariantMap settings;
    QVariantMap position{{QStringLiteral("Latitude"), 51.5}, {QStringLiteral("Longitude"), -2.5},
                         {QStringLiteral("Accuracy"), 7.0},  {QStringLiteral("Altitude"), 33.0},
                         {QStringLiteral("Heading"), 90.0},  {QStringLiteral("Speed"), 1.5}};
    bool denied = false;
    std::vector<platform::PlatformLocation::Fix> fixes;
};

TEST_F(GeoClueSourceTest, Location_ArrivesWithEverythingKnown) {
    startGeoClue();
    const auto source = startedSource();
    ASSERT_TRUE(eventually([&] { return calls.contains(QStringLiteral("Start")); }));
    EXPECT_EQ(settings[QStringLiteral("DesktopId")].toString(), QStringLiteral("org.ktr.ktr"));
    EXPECT_EQ(settings[QStringLiteral("RequestedAccuracyLevel")].toUInt(), 8U);
    announce();
    ASSERT_TRUE(eventually([&] { return fixes.size() == 1; }));
    EXPECT_EQ(fixes[0].coordinate, (platform::Coordinate{51.5, -2.5}));
    EXPECT_EQ(fixes[0].horizontalAccuracy, 7.0);
    EXPECT_EQ(fixes[0].altitude, 33.0);
    EXPECT_EQ(fixes[0].verticalAccuracy, 7.0);
    EXPECT_EQ(fixes[0].course, 90.0);
    EXPECT_EQ(fixes[0].speed, 1.5);
    source->start(3000.0);
    EXPECT_TRUE(eventually([&] { return settings[QStringLiteral("RequestedAccuracyLevel")].toUInt() == 5U; }));
    source->stop();
    EXPECT_TRUE(eventually([&] { return calls.contains(QStringLiteral("DeleteClient")); }));
}

TEST_F(GeoClueSourceTest, UnknownAltitudeSpeedAndHeading_AreMarkedInvalid) {
    position[QStringLiteral("Altitude")] = -std::numeric_limits<double>::max();
    position[QStringLiteral("Heading")] = -1.0;
    position[QStringLiteral("Speed")] = -1.0;
    startGeoClue();
    const auto source = startedSource();
    ASSERT_TRUE(eventually([&] { return calls.contains(QStringLiteral("Start")); }));
    announce();
    ASSERT_TRUE(eventually([&] { return fixes.size() == 1; }));
    EXPECT_EQ(fixes[0].altitude, 0.0);
    EXPECT_EQ(fixes[0].verticalAccuracy, -1.0);
    EXPECT_EQ(fixes[0].course, -1.0);
    EXPECT_EQ(fixes[0].speed, -1.0);
}

TEST_F(GeoClueSourceTest, AbsentThenThereThenGoneThenThere_IsFollowed) {
    const auto source = startedSource();
    ASSERT_TRUE(eventually([&] { return time->pendingTimers() == 1; })) << "no GeoClue: it is asked again later";
    startGeoClue();
    ASSERT_TRUE(eventually([&] { return calls.count(QStringLiteral("Start")) == 1; }));
    ASSERT_TRUE(service.unregisterService(QStringLiteral("org.freedesktop.GeoClue2")));
    ASSERT_TRUE(eventually([&] { return time->pendingTimers() == 1; }));
    ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.GeoClue2")));
    ASSERT_TRUE(eventually([&] { return calls.count(QStringLiteral("Start")) == 2; }));
    announce();
    EXPECT_TRUE(eventually([&] { return fixes.size() == 1; }));
}

TEST_F(GeoClueSourceTest, NoConsent_IsAskedForAgainLater) {
    denied = true;
    startGeoClue();
    const auto source = startedSource();
    ASSERT_TRUE(eventually([&] { return time->pendingTimers() == 1; }));
    denied = false;
    time->advance(60.0);
    ASSERT_TRUE(eventually([&] { return calls.count(QStringLiteral("Start")) == 2; }));
    announce();
    EXPECT_TRUE(eventually([&] { return fixes.size() == 1; }));
}

TEST_F(GeoClueSourceTest, NoBus_TellsNothing) {
    GeoClueSource source(time, QStringLiteral("org.ktr.ktr"), QDBusConnection(QStringLiteral("none")));
    source.start(10.0);
    source.stop();
    EXPECT_EQ(time->pendingTimers(), 0U);
}

}  // namespace ktr::test
