#include "linux/positions/TrackReader.h"

#include <gtest/gtest.h>

#include <chrono>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::TimedPosition;
using linux_::TrackReader;

class TrackReaderTest : public ::testing::Test {
  protected:
    using Read = std::variant<std::vector<TimedPosition>, documents::DocumentError>;

    static std::vector<TimedPosition> good(const Read& read) {
        const auto* error = std::get_if<documents::DocumentError>(&read);
        EXPECT_EQ(error, nullptr) << (error != nullptr ? error->text() : "");
        return error != nullptr ? std::vector<TimedPosition>() : std::get<std::vector<TimedPosition>>(read);
    }
    static std::string errorOf(const Read& read) {
        const auto* error = std::get_if<documents::DocumentError>(&read);
        return error != nullptr ? error->text() : "no error";
    }
    static auto gpx(const std::string& inner) {
        return TrackReader::readGpx(
            "<?xml version=\"1.0\"?>\n<gpx xmlns=\"http://www.topografix.com/GPX/1/1\">" + inner + "</gpx>",
            "walk.gpx");
    }
};

TEST_F(TrackReaderTest, Times_CountFromTheFirstPoint) {
    const auto walk = good(
        gpx("<wpt lat=\"9\" lon=\"9\"/><trk><trkseg><trkpt lat=\"51.5\" lon=\"-2.5\"><ele>12.5</ele>"
            "<time>2026-05-16T16:00:00Z</time><hdop>2</hdop></trkpt></trkseg><trkseg><trkpt lat=\"51.6\" lon=\"-2.5\">"
            "<time>2026-05-16T18:00:07+02:00</time></trkpt></trkseg></trk>"));
    ASSERT_EQ(walk.size(), 2U);
    EXPECT_EQ(walk[0].seconds, 0.0);
    EXPECT_EQ(walk[0].fix.coordinate, (platform::Coordinate{51.5, -2.5}));
    EXPECT_EQ(walk[0].fix.altitude, 12.5);
    EXPECT_EQ(walk[0].fix.horizontalAccuracy, 10.0);
    EXPECT_EQ(walk[1].seconds, 7.0);
    EXPECT_EQ(walk[1].fix.verticalAccuracy, -1.0);
    EXPECT_EQ(walk[1].fix.timestamp, std::nullopt);
}

TEST_F(TrackReaderTest, WithoutUsableTimes_TenSecondsApart) {
    const std::string point = "<trkpt lat=\"1\" lon=\"2\">";
    const auto some = good(
        gpx("<trk><trkseg>" + point + "<time>2026-05-16T16:00:00Z</time></trkpt>" + point + "</trkpt></trkseg></trk>"));
    ASSERT_EQ(some.size(), 2U);
    EXPECT_EQ(some[1].seconds, 10.0);
    const auto backwards = good(gpx("<trk><trkseg>" + point + "<time>2026-05-16T16:00:05Z</time></trkpt>" + point +
                                    "<time>2026-05-16T16:00:00Z</time></trkpt></trkseg></trk>"));
    EXPECT_EQ(backwards[1].seconds, 10.0);
}

TEST_F(TrackReaderTest, Errors_NameFileAndLine) {
    EXPECT_EQ(errorOf(gpx("\n<trk><trkseg><trkpt lat=\"91\" lon=\"0\"/></trkseg></trk>")),
              "walk.gpx:3:14: expected a point with lat and lon in degrees");
    EXPECT_EQ(errorOf(gpx("")), "walk.gpx: expected a GPX file with at least one point");
    EXPECT_EQ(errorOf(gpx("<trk>")).rfind("walk.gpx:2:", 0), 0U);
    EXPECT_EQ(errorOf(TrackReader::readScenario("{}", "s.json")),
              "s.json:1:1: $: expected a GPX file, or a scenario with \"positions\"");
    EXPECT_EQ(errorOf(TrackReader::readScenario(R"({"positions": [{"latitude": 1}]})", "s.json")),
              "s.json:1:16: $.positions[0]: expected a member \"longitude\"");
    EXPECT_EQ(errorOf(TrackReader::readFile("/nonexistent/walk.gpx")), "/nonexistent/walk.gpx: there is no such file");
}

TEST_F(TrackReaderTest, HostileGpx_IsReadOrRefusedQuickly) {
    const auto start = std::chrono::steady_clock::now();
    std::string attributes;
    for (int i = 0; i < 100'000; ++i) {
        attributes += " a" + std::to_string(i) + "=\"x\"";
    }
    EXPECT_EQ(good(gpx("<wpt lat=\"1\" lon=\"2\"" + attributes + "/>")).size(), 1U);
    EXPECT_EQ(good(gpx("<trk" + attributes + "><trkseg><trkpt lat=\"1\" lon=\"2\"/></trkseg></trk>")).size(), 1U);
    EXPECT_NE(errorOf(gpx("<wpt lat=\"1\" lat=\"1\" lon=\"2\"/>")).find("duplicate attribute"), std::string::npos);
    std::string deep;
    for (int i = 0; i < 1'000'000; ++i) {
        deep += "<a>";
    }
    EXPECT_EQ(errorOf(gpx(deep)), "walk.gpx:2:237: nested more than 64 levels deep");
    EXPECT_EQ(errorOf(TrackReader::readGpx(
                  "<!DOCTYPE a [<!ENTITY a \"aaaaaaaaaa\"><!ENTITY b \"&a;&a;&a;\">]><a>&b;</a>", "walk.gpx")),
              "walk.gpx:1:13: expected GPX, found a document type");
    const std::string digits(5'000'000, '1');
    EXPECT_EQ(good(gpx("<wpt lat=\"1\" lon=\"2\"><ele>" + digits + "</ele></wpt>")).front().fix.verticalAccuracy, -1.0);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
}

TEST_F(TrackReaderTest, Prefixes_AndNumbersOutOfRange_DoNoHarm) {
    const auto walk =
        good(TrackReader::readGpx("<g:gpx xmlns:g=\"x\"><g:wpt lat=\" +1 \" lon=\"2\"><g:hdop>-1</g:hdop>"
                                  "<g:speed>inf</g:speed><g:ele> 7 </g:ele></g:wpt></g:gpx>",
                                  "walk.gpx"));
    ASSERT_EQ(walk.size(), 1U);
    EXPECT_EQ(walk[0].fix.coordinate, (platform::Coordinate{1.0, 2.0}));
    EXPECT_EQ(walk[0].fix.horizontalAccuracy, 10.0);
    EXPECT_EQ(walk[0].fix.speed, -1.0);
    EXPECT_EQ(walk[0].fix.altitude, 7.0);
}

TEST_F(TrackReaderTest, File_IsGpxOrScenarioByItsText) {
    const TemporaryFolder folder;
    const auto walk = good(TrackReader::readFile(KTR_SOURCE_DIR "/resources/service/walk.gpx"));
    EXPECT_GT(walk.size(), 3U);
    const auto file =
        folder.write("s.gpx", R"({"positions": [{"at": 3, "latitude": 1, "longitude": 2, "accuracy": 4}]})");
    const auto scenario = good(TrackReader::readFile(file.string()));
    ASSERT_EQ(scenario.size(), 1U);
    EXPECT_EQ(scenario[0].seconds, 3.0);
    EXPECT_EQ(scenario[0].fix.horizontalAccuracy, 4.0);
}

}  // namespace ktr::test
