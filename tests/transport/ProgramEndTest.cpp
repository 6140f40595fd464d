// How a program ends that has looked up names.
#include <QProcess>
#include <cstdlib>

#include "tests/transport/TransportTest.h"

/// Asked by the leak sanitizer, whose name for it this is: whom a look-up would have told is never freed by the toolkit
/// when the application ends while the resolver still looks.
extern "C" const char* __lsan_default_suppressions();   // NOLINT(bugprone-reserved-identifier)
extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
    return "leak:lookupHost<\n";
}

namespace ktr::test {
namespace {

/// Says to a program of this suite that it is the one whose end is tested.
constexpr const char* kIsTested = "KTR_TEST_PROGRAM_END";
constexpr int kOutlived = 3;

/// Another run of this program, for one test.
class ProgramEndTest : public TransportTest {
  protected:
    /// Runs the calling test once more.
    static void runAgain() {
        auto environment = QProcessEnvironment::systemEnvironment();
        environment.insert(QString::fromLatin1(kIsTested), QStringLiteral("1"));
        QProcess program;
        program.setProcessEnvironment(environment);
        program.setProcessChannelMode(QProcess::MergedChannels);
        const auto* const info = ::testing::UnitTest::GetInstance()->current_test_info();
        program.start(QCoreApplication::applicationFilePath(),
                      {QStringLiteral("--gtest_filter=%1.%2")
                           .arg(QString::fromLatin1(info->test_suite_name()), QString::fromLatin1(info->name()))});
        ASSERT_TRUE(program.waitForFinished(60'000));
        const std::string said = program.readAll().toStdString();
        EXPECT_EQ(program.exitStatus(), QProcess::NormalExit) << said;
        EXPECT_EQ(program.exitCode(), 0) << said;
        EXPECT_NE(said.find("[  PASSED  ] 1 test."), std::string::npos) << said;
    }
};

TEST_F(ProgramEndTest, LookUpUnderWay_ApplicationEndsBeforeStaticsGo) {
    if (!qEnvironmentVariableIsSet(kIsTested)) {
        runAgain();
        return;
    }
    serve(gladly());
    const auto answer = start(request());
    http.reset();
    EXPECT_EQ(answer.wait_for(std::chrono::seconds(0)), std::future_status::ready);
    // The library's statics, made by now, go after this.
    std::atexit([] {
        if (QCoreApplication::instance() != nullptr) {
            std::_Exit(kOutlived);
        }
    });
}

}  // namespace
}  // namespace ktr::test
