#include "app/CommandLine.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

Options parsed(const std::vector<std::string>& arguments) {
    const auto result = CommandLine::parse(arguments);
    if (const auto* ending = std::get_if<CommandLine::Ending>(&result)) {
        ADD_FAILURE() << ending->text;
        return {};
    }
    return std::get<Options>(result);
}

CommandLine::Ending ending(const std::vector<std::string>& arguments) {
    const auto result = CommandLine::parse(arguments);
    const auto* found = std::get_if<CommandLine::Ending>(&result);
    EXPECT_NE(found, nullptr);
    return found == nullptr ? CommandLine::Ending{} : *found;
}

TEST(KTRCommandLineTest, Show_TakesSeveralScenarios) {
    const Options options = parsed({"show", "a.json", "b.json", "--print-urls", "--dark"});
    EXPECT_EQ(options.command, Options::Command::Show);
    EXPECT_EQ(options.scenarios, (std::vector<std::string>{"a.json", "b.json"}));
    EXPECT_TRUE(options.printUrls);
    EXPECT_EQ(options.dark, true);
}

TEST(KTRCommandLineTest, Render_TakesEveryOption) {
    const Options options =
        parsed({"render",  "a.json",          "-o",   "x/a.svg",     "--width",  "320",     "--scale",
                "2.5",     "--language",      "ar",   "--text-size", "XXL",      "--idiom", "tablet",
                "--light", "--high-contrast", "--at", "+90.5",       "--plugin", "p"});
    EXPECT_EQ(options.command, Options::Command::Render);
    EXPECT_EQ(options.output, "x/a.svg");
    EXPECT_EQ(options.width, 320.0);
    EXPECT_EQ(options.scale, 2.5);
    EXPECT_EQ(options.language, "ar");
    EXPECT_EQ(options.textSize, platform::ContentSizeCategory::XXL);
    EXPECT_EQ(options.idiom, platform::UserInterfaceIdiom::Tablet);
    EXPECT_EQ(options.dark, false);
    EXPECT_TRUE(options.highContrast);
    EXPECT_EQ(options.atSeconds, 90.5);
    EXPECT_FALSE(options.at);
    EXPECT_EQ(options.plugin, "p");
}

TEST(KTRCommandLineTest, Misspelt_IsNamedWithWhatWasProbablyMeant) {
    const auto misuse = [](const std::vector<std::string>& arguments) {
        const auto found = ending(arguments);
        EXPECT_EQ(found.code, host::ExitCode::Usage);
        return found.text.substr(0, found.text.find('\n'));
    };
    EXPECT_EQ(misuse({"rendr", "a.json"}), "ktr: there is no command \"rendr\"; did you mean \"render\"?");
    EXPECT_EQ(misuse({"frobnicate"}), "ktr: there is no command \"frobnicate\"");
    EXPECT_EQ(misuse({"render", "a.json", "-o", "a.png", "--langauge=de"}),
              "ktr: there is no option \"--langauge\"; did you mean \"--language\"?");
    EXPECT_EQ(misuse({"show", "--frobnicate"}), "ktr: there is no option \"--frobnicate\"");
    EXPECT_EQ(misuse({}), "ktr: A subcommand is required");
}

TEST(KTRCommandLineTest, ArgumentsInAnError_DoNotSteerTheTerminal) {
    for (const std::string bad : {"a\x1b[31mb", "a\u009b2Jb", "a\u202eb", "a\x7f\nb"}) {
        for (const auto& arguments : {std::vector<std::string>{bad},
                                      {"show", "--" + bad},
                                      {"describe", "a", bad},
                                      {"render", "a", "-o", bad},
                                      {"describe", "a", "--at", bad}}) {
            const std::string text = ending(arguments).text;
            const std::string line = text.substr(0, text.find("\nSee ktr --help."));
            EXPECT_EQ(line.find_first_of("\n\x1b\x7f"), std::string::npos) << line;
            EXPECT_EQ(line.find("\u009b"), std::string::npos) << line;
            EXPECT_EQ(line.find("\u202e"), std::string::npos) << line;
        }
    }
}

TEST(KTRCommandLineTest, Describe_LeavesOpenWhatIsNotSaid) {
    const Options options = parsed({"describe", "a.json"});
    EXPECT_EQ(options.command, Options::Command::Describe);
    EXPECT_FALSE(options.dark || options.language || options.textSize || options.idiom || options.at);
}

TEST(KTRCommandLineTest, At_TakesAMoment) {
    const Options options = parsed({"describe", "a.json", "--at", "2026-05-16T17:42:00+02:00"});
    ASSERT_TRUE(options.at);
    EXPECT_EQ(options.at->offsetSeconds, 7200);
}

TEST(KTRCommandLineTest, Search_IsLiveAndEndsWhenItIsIdle) {
    const Options options = parsed({"search", "--language", "de"});
    EXPECT_EQ(options.command, Options::Command::Search);
    EXPECT_TRUE(options.live);
    EXPECT_EQ(options.language, "de");
    EXPECT_EQ(options.searchIdle, 60);
    EXPECT_EQ(parsed({"search", "--idle", "5"}).searchIdle, 5);
    EXPECT_EQ(ending({"search", "--idle", "0"}).code, host::ExitCode::Usage);
    EXPECT_EQ(ending({"search", "ann"}).code, host::ExitCode::Usage);
}

TEST(KTRCommandLineTest, Ask_IsAloudOnlyWhenItIsSaid) {
    EXPECT_FALSE(parsed({"ask", "Where is Ann?"}).aloud);
    EXPECT_TRUE(parsed({"ask", "Where is Ann?", "--aloud"}).aloud);
    EXPECT_EQ(parsed({"ask", "--", "--help"}).questions, std::vector<std::string>{"--help"});
}

TEST(KTRCommandLineTest, Help_HasExamplesAndTheExitStatus) {
    const auto all = ending({"--help"});
    EXPECT_EQ(all.code, host::ExitCode::Ok);
    EXPECT_NE(all.text.find("Exit status:"), std::string::npos);
    EXPECT_NE(all.text.find("\nEnvironment:\n"), std::string::npos) << all.text;
    for (const char* command : {"show", "render", "describe"}) {
        const auto help = ending({command, "--help"});
        EXPECT_EQ(help.code, host::ExitCode::Ok);
        EXPECT_NE(help.text.find(std::string("  ktr ") + command), std::string::npos) << help.text;
    }
}

TEST(KTRCommandLineTest, Version_IsPrinted) {
    const auto version = ending({"--version"});
    EXPECT_EQ(version.code, host::ExitCode::Ok);
    EXPECT_EQ(version.text.rfind("ktr ", 0), 0u);
}

TEST(KTRCommandLineTest, Live_IsAWindowWithoutScenariosAndWhatSaysSo) {
    EXPECT_TRUE(parsed({"show"}).live);
    EXPECT_FALSE(parsed({"show", "a.json"}).live);
    EXPECT_TRUE(parsed({"show", "a.json", "--live"}).live);
    EXPECT_FALSE(parsed({"describe", "a.json"}).live);
    EXPECT_TRUE(parsed({"describe", "a.json", "--live", "5s"}).live);
    const auto asked = parsed({"render", "--live", "1.5s", "--ask", "one", "--ask", "two", "-o", "a.png"});
    EXPECT_TRUE(asked.live);
    EXPECT_EQ(asked.questions, (std::vector<std::string>{"one", "two"}));
    EXPECT_EQ(asked.liveSeconds, 1.5);
    EXPECT_EQ(parsed({"describe", "a.json", "--live", "250ms"}).liveSeconds, 0.25);
    EXPECT_EQ(parsed({"describe", "a.json", "--live", "2m"}).liveSeconds, 120.0);
    EXPECT_EQ(parsed({"describe", "a.json", "--live", "7"}).liveSeconds, 7.0);
}

TEST(KTRCommandLineTest, Misuse_IsToldWithStatusTwo) {
    const std::vector<std::vector<std::string>> cases = {
        {},
        {"paint"},
        {"render", "-o", "a.png"},
        {"describe"},
        {"describe", "--live", "5s"},
        {"describe", "--ask", "where is ann"},
        {"describe", "a.json", "--ask", "where is ann"},
        {"describe", "a.json", "--live", "0s"},
        {"describe", "a.json", "--live", "soon"},
        {"describe", "a.json", "--live", "5h"},
        {"describe", "a.json", "--live", "2d"},
        {"describe", "a.json", "--live", "5s", "--at", "+5"},
        {"show", "a.json", "--ask", "where is ann"},
        {"render", "a.json"},
        {"render", "a.json", "-o", "a.gif"},
        {"render", "a.json", "-o", ".png"},
        {"render", "a.json", "b.json", "-o", "a.png"},
        {"render", "a.json", "-o", "a.png", "--scale", "0"},
        {"render", "a.json", "-o", "a.png", "--scale", "nan"},
        {"render", "a.json", "-o", "a.png", "--width", "1e9"},
        {"render", "a.json", "-o", "a.png", "--width", "wide"},
        {"describe", "a.json", "--at", "soon"},
        {"describe", "a.json", "--at", "+"},
        {"describe", "a.json", "--at", "+-5"},
        {"describe", "a.json", "--at", "+1e3"},
        {"describe", "a.json", "--at", "+999999999"},
        {"describe", "a.json", "--language", "en_GB"},
        {"describe", "a.json", "--text-size", "huge"},
        {"describe", "a.json", "--idiom", "watch"},
        {"describe", "a.json", "--dark", "--light"},
        {"describe", "a.json", "--unknown"},
        {"show", "a.json", "--scale", "2"},
    };
    for (const auto& arguments : cases) {
        std::string line;
        for (const auto& argument : arguments) {
            line += " " + argument;
        }
        const auto end = ending(arguments);
        EXPECT_EQ(end.code, host::ExitCode::Usage) << line;
        EXPECT_EQ(end.text.rfind("ktr: ", 0), 0u) << line << ": " << end.text;
    }
}

}  // namespace

}  // namespace ktr::app
