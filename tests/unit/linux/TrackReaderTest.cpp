#include "linux/positions/TrackReader.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::TimedPosition;
using linux_::TrackReader;

class TrackReaderTest : public ::testing::Test {
  protected:
    static std::vector<TimedPosition> good(const std::variant<std::vector<TimedPosition>, TrackReader::Error>& read) {
        const auto* error = std::get_if<TrackReader::Error>(&read);
        EXPECT_EQ(error, nullptr) << (error != nullptr ? error->text : "");
        return error != nullptr ? std::vector<TimedPosition>() : std::get<std::vector<TimedPosition>>(read);
    }
    static std::string errorOf(const std::variant<std::vector<TimedPosition>, TrackReader::Error>& read) {
        const auto* error = std::get_if<TrackReader::Error>(&read);
        return error != nullptr ? error->text : "no error";
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
              "walk.gpx:3: expected a point with lat and lon in degrees");
    EXPECT_EQ(errorOf(gpx("")), "walk.gpx: expected a GPX file with at least one point");
    EXPECT_EQ(errorOf(gpx("<trk>")).rfind("walk.gpx:2: ", 0), 0U);
    EXPECT_EQ(errorOf(TrackReader::readScenario("{}", "s.json")), "s.json: expected \"positions\" in the scenario");
    EXPECT_EQ(errorOf(TrackReader::readScenario(R"({"positions": [{"latitude": 1}]})", "s.json")),
              "s.json: $.positions[0]: expected latitude and longitude in degrees");
    EXPECT_EQ(errorOf(TrackReader::readFile("/nonexistent/walk.gpx")),
              "/nonexistent/walk.gpx: the track cannot be read");
}

TEST_F(TrackReaderTest, Pipe_IsRefusedAndHoldsNobodyUp) {
    const TemporaryFolder folder;
    const std::string pipe = (folder.path() / "pipe").string();
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_EQ(errorOf(TrackReader::readFile(pipe)), pipe + ": the track cannot be read");
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
