#include "linux/positions/GpsdSource.h"

#include <QHostAddress>
#include <QTcpServer>
#include <QTcpSocket>
#include <memory>
#include <vector>

#include "tests/support/PlatformTest.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::GpsdSource;

class GpsdSourceTest : public PlatformTest {
  protected:
    static constexpr const char* kReport =
        "{\"class\":\"TPV\",\"mode\":3,\"time\":\"2026-01-15T12:00:00.500Z\",\"lat\":51.5,\"lon\":-2.5,\"eph\":6.5,"
        "\"altMSL\":20.5,\"epv\":9,\"track\":181.5,\"speed\":1.25}\n";

    void SetUp() override { ASSERT_TRUE(gpsd.listen(QHostAddress::LocalHost)); }
    std::unique_ptr<GpsdSource> startedSource() {
        auto source = std::make_unique<GpsdSource>(QStringLiteral("127.0.0.1"), gpsd.serverPort(), time);
        source->setListener([this](const auto& fix) { fixes.push_back(fix); });
        source->start(10.0);
        return source;
    }
    /// The next connection, which has asked to watch.
    std::unique_ptr<QTcpSocket> watcher() {
        EXPECT_TRUE(eventually([&] { return gpsd.hasPendingConnections(); }));
        std::unique_ptr<QTcpSocket> socket(gpsd.nextPendingConnection());
        EXPECT_TRUE(socket && eventually([&] { return socket->canReadLine(); }));
        EXPECT_EQ(socket->readLine(), QByteArray("?WATCH={\"enable\":true,\"json\":true};\n"));
        return socket;
    }

    QTcpServer gpsd;
    std::vector<platform::PlatformLocation::Fix> fixes;
};

TEST_F(GpsdSourceTest, Report_BecomesAFix) {
    const auto fix = GpsdSource::fixOf(kReport);
    ASSERT_TRUE(fix.has_value());
    EXPECT_EQ(fix->coordinate, (platform::Coordinate{51.5, -2.5}));
    EXPECT_EQ(fix->horizontalAccuracy, 6.5);
    EXPECT_EQ(fix->altitude, 20.5);
    EXPECT_EQ(fix->verticalAccuracy, 9.0);
    EXPECT_EQ(fix->course, 181.5);
    EXPECT_EQ(fix->speed, 1.25);
    ASSERT_TRUE(fix->timestamp.has_value());
    EXPECT_EQ(fix->timestamp->secondsSinceReferenceDate, kNoon + 0.5);
}

TEST_F(GpsdSourceTest, ReportWithoutFixOrPlace_IsNone) {
    for (const char* line : {"{\"class\":\"TPV\",\"mode\":1}", "{\"class\":\"TPV\",\"mode\":2,\"lat\":51.5}",
                             "{\"class\":\"SKY\",\"mode\":3}", "{\"class\":\"TPV\",\"mode\":2,\"lat\":91,\"lon\":0}",
                             "not json", "", "[]", "{\"class\":\"TPV\",\"mode\":\"3\",\"lat\":51.5,\"lon\":-2.5}",
                             "{\"class\":\"TPV\",\"mode\":3,\"lat\":51.5,\"lat\":5.5,\"lon\":-2.5}",
                             "{\"class\":\"TPV\",\"mode\":3,\"lat\":51.5,\"lon\":-2.5,\"device\":\"\xff\"}"}) {
        EXPECT_EQ(GpsdSource::fixOf(line), std::nullopt) << line;
    }
    const auto flat =
        GpsdSource::fixOf("{\"class\":\"TPV\",\"mode\":2,\"lat\":1,\"lon\":2,\"epx\":3,\"epy\":4,\"alt\":5}");
    ASSERT_TRUE(flat.has_value());
    EXPECT_EQ(flat->horizontalAccuracy, 4.0);
    EXPECT_EQ(flat->verticalAccuracy, -1.0);
    EXPECT_EQ(flat->course, -1.0);
}

TEST_F(GpsdSourceTest, LinesInPieces_AreReadWhole) {
    const auto source = startedSource();
    const auto socket = watcher();
    const QByteArray report(kReport);
    socket->write("{\"class\":\"VERSION\"}\n" + report.left(20));
    socket->flush();
    socket->write(report.mid(20) + report);
    EXPECT_TRUE(eventually([&] { return fixes.size() == 2; }));
}

TEST_F(GpsdSourceTest, GpsdThatGoesAway_IsCalledAgainUntilStopped) {
    const auto source = startedSource();
    watcher().reset();
    ASSERT_TRUE(eventually([&] { return time->pendingTimers() == 1; }));
    const quint16 port = gpsd.serverPort();
    gpsd.close();
    time->advance(1.0);
    ASSERT_TRUE(eventually([&] { return time->pendingTimers() == 1; })) << "nobody listens";
    ASSERT_TRUE(gpsd.listen(QHostAddress::LocalHost, port));
    time->advance(2.0);
    const auto socket = watcher();
    socket->write(kReport);
    EXPECT_TRUE(eventually([&] { return fixes.size() == 1; }));
    source->stop();
    EXPECT_EQ(time->pendingTimers(), 0U);
    EXPECT_TRUE(eventually([&] { return socket->state() == QAbstractSocket::UnconnectedState; }));
}

TEST_F(GpsdSourceTest, LineThatNeverEnds_EndsTheConnection) {
    const auto source = startedSource();
    const auto socket = watcher();
    socket->write(QByteArray(1 << 20, 'x'));
    EXPECT_TRUE(eventually([&] { return time->pendingTimers() == 1; }));
    EXPECT_TRUE(fixes.empty());
}

}  // namespace ktr::test
