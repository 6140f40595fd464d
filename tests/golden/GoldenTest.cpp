// Draws every case and holds it beside what was looked at and kept: the picture within a small tolerance, the dumps of
// the layout and accessibility trees exactly. A failure leaves a page with actual, expected and difference in the build
// folder. KTR_REBASELINE=1 takes what is drawn as the new golden instead.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QGuiApplication>
#include <cstdio>
#include <memory>

#include "app/CommandLine.h"
#include "app/RenderCommand.h"
#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/paint/FontSetup.h"
#include "tests/golden/GoldenCase.h"
#include "tests/golden/PictureComparison.h"
#include "tests/support/TreeDump.h"

namespace ktr::test {

namespace {

/// No case looks at the clock: every scenario has its own, and this stands in for nothing else.
constexpr platform::Date kNow = {790171200.0};

QString goldenPath(const std::string& name) {
    return QStringLiteral(KTR_TEST_DATA "/golden/expected/") + QString::fromStdString(name);
}

QString resultPath(const std::string& name) {
    const QString folder = QStringLiteral(KTR_GOLDEN_RESULTS "/");
    QDir().mkpath(folder);
    return folder + QString::fromStdString(name);
}

bool rebaselines() {
    return qEnvironmentVariableIntValue("KTR_REBASELINE") != 0;
}

QByteArray contentOf(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

bool write(const QString& path, const QByteArray& content) {
    QFile file(path);
    return file.open(QIODevice::WriteOnly) && file.write(content) == content.size();
}

}  // namespace

class GoldenTest : public ::testing::TestWithParam<GoldenCase> {
  protected:
    void SetUp() override {
        std::vector<std::string> arguments = {"render"};
        const auto& own = GetParam().arguments;
        arguments.insert(arguments.end(), own.begin(), own.end());
        arguments.insert(arguments.end(),
                         {"-o", resultPath(GetParam().name + ".png").toStdString(), "--plugin", KTR_PLUGIN_FILE});
        const auto parsed = app::CommandLine::parse(arguments);
        ASSERT_TRUE(std::holds_alternative<app::Options>(parsed)) << std::get<app::CommandLine::Ending>(parsed).text;
        options = std::get<app::Options>(parsed);
        auto scenario = host::ScenarioReader(kNow).readFile(options.scenarios.front());
        ASSERT_TRUE(std::holds_alternative<host::Scenario>(scenario))
            << std::get<documents::DocumentError>(scenario).text();
        const std::vector<host::Scenario> scenarios = {std::get<host::Scenario>(scenario)};
        ASSERT_TRUE(scenarios.front().clock) << "a golden scenario needs a clock of its own";
        auto settings = host::HostSettings::decide(options, scenarios, {kNow, 0});
        ASSERT_TRUE(std::holds_alternative<host::HostSettings>(settings)) << std::get<host::Failure>(settings).line;
        auto made = host::Host::make(std::get<host::HostSettings>(settings), host::Host::Time::Virtual, options.plugin);
        ASSERT_TRUE(std::holds_alternative<std::unique_ptr<host::Host>>(made)) << std::get<host::Failure>(made).line;
        host = std::move(std::get<std::unique_ptr<host::Host>>(made));
        const auto failure = host->addTurn(scenarios.front());
        ASSERT_FALSE(failure) << failure->line;
    }

    /// Compares a text exactly, or takes it.
    static void checkText(const std::string& name, const std::string& actual) {
        const QByteArray content = QByteArray::fromStdString(actual);
        if (rebaselines()) {
            ASSERT_TRUE(write(goldenPath(name), content));
            return;
        }
        const QByteArray expected = contentOf(goldenPath(name));
        if (expected != content) {
            write(resultPath(name), content);
        }
        EXPECT_EQ(expected.toStdString(), actual) << name;
    }

    void checkPicture() {
        const std::string& name = GetParam().name;
        const QString drawn = resultPath(name + ".png");
        const QString kept = goldenPath(name + ".png");
        if (rebaselines()) {
            QFile::remove(kept);
            ASSERT_TRUE(QFile::copy(drawn, kept));
            return;
        }
        const QImage expected(kept);
        const QImage actual(drawn);
        ASSERT_FALSE(expected.isNull()) << kept.toStdString() << " is missing: scripts/rebaseline makes it";
        const PictureComparison result = compare(expected, actual);
        if (!result.matches()) {
            leavePage(expected, result);
        }
        EXPECT_TRUE(result.sameSize) << "expected " << expected.width() << " x " << expected.height() << ", drawn "
                                     << actual.width() << " x " << actual.height();
        EXPECT_TRUE(result.matches()) << result.differing << " pixels differ, by up to " << result.largestDifference
                                      << "; see " << resultPath(name + ".html").toStdString();
    }

    static void leavePage(const QImage& expected, const PictureComparison& result) {
        const std::string& name = GetParam().name;
        expected.save(resultPath(name + ".expected.png"));
        result.difference.save(resultPath(name + ".difference.png"));
        std::string page = "<!doctype html><meta charset=utf-8><title>" + name + "</title><h1>" + name + "</h1>";
        for (const char* kind : {".expected.png", ".png", ".difference.png"}) {
            page += "<img src='" + name + kind + "' style='max-width:32%;vertical-align:top'> ";
        }
        write(resultPath(name + ".html"), QByteArray::fromStdString(page));
    }

    app::Options options;
    std::unique_ptr<host::Host> host;
};

TEST_P(GoldenTest, LooksAndReadsAsItDid) {
    const auto failure = app::RenderCommand(*host).write(options.output);
    ASSERT_FALSE(failure) << failure->line;
    checkPicture();
    checkText(GetParam().name + ".layout.txt", layoutDump(*host->window()));
    checkText(GetParam().name + ".accessibility.txt",
              accessibilityDump(platform::accessibilityTree(host->window(), host->rightToLeft())));
}

INSTANTIATE_TEST_SUITE_P(Scenarios, GoldenTest, ::testing::ValuesIn(goldenCases()), [](const auto& tested) {
    std::string name = tested.param.name;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
});

TEST(GoldenCasesTest, EveryDemoScenarioIsDrawn) {
    const auto cases = goldenCases();
    for (const QString& file :
         QDir(QStringLiteral(KTR_SOURCE_DIR "/resources/scenarios")).entryList({QStringLiteral("*.json")})) {
        const std::string path = KTR_SOURCE_DIR "/resources/scenarios/" + file.toStdString();
        // Forty friends are a picture of their own size; the integration tests draw them.
        const bool drawn =
            file == QStringLiteral("forty-friends.json") ||
            std::any_of(cases.begin(), cases.end(), [&](const auto& one) { return one.arguments[0] == path; });
        EXPECT_TRUE(drawn) << file.toStdString() << " has no line in cases.txt";
    }
}

TEST(PictureComparisonTest, OneChangedLetterIsADifference) {
    QImage expected(400, 400, QImage::Format_ARGB32);
    expected.fill(Qt::white);
    QImage actual = expected;
    EXPECT_TRUE(compare(expected, actual).matches());
    for (int x = 0; x < 10; ++x) {
        actual.setPixelColor(x, 0, QColor(245, 245, 245));
    }
    EXPECT_TRUE(compare(expected, actual).matches());
    for (int x = 0; x < 40; ++x) {
        actual.setPixelColor(x, 5, Qt::black);
    }
    const PictureComparison result = compare(expected, actual);
    EXPECT_FALSE(result.matches());
    EXPECT_EQ(result.differing, 40);
    EXPECT_EQ(result.largestDifference, 255);
    EXPECT_FALSE(compare(expected, QImage(400, 401, QImage::Format_ARGB32)).matches());
}

}  // namespace ktr::test

int main(int argc, char** argv) {
    ::testing::InitGoogleTest(&argc, argv);
    qputenv("QT_QPA_PLATFORM", "offscreen");
    std::string error;
    if (!ktr::linux_::FontSetup::prepare(ktr::linux_::FontSetup::Mode::Pinned, &error)) {
        std::fprintf(stderr, "the fonts cannot be set up: %s\n", error.c_str());
        return 1;
    }
    const QGuiApplication application(argc, argv);
    const auto missing = ktr::linux_::FontSetup::load(ktr::linux_::FontSetup::Mode::Pinned);
    for (const std::string& file : missing) {
        std::fprintf(stderr, "a pinned font is missing: %s\n", file.c_str());
    }
    return missing.empty() ? RUN_ALL_TESTS() : 1;
}
