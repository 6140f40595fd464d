#include "app/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <charconv>
#include <cmath>

#include "app/CrossingHook.h"
#include "app/KeepingArguments.h"
#include "app/ServeArguments.h"
#include "documents/NearestName.h"
#include "documents/Words.h"
#include "host/links/LinkPolicy.h"
#include "host/scenario/Scenario.h"
#include "linux/device/LinuxDevice.h"

#ifndef KTR_VERSION
#error "KTR_VERSION is given by the build"
#endif

namespace ktr::app {

namespace {

constexpr double kLongestRun = 7.0 * 86400.0;
constexpr double kLongestLive = 86400.0;

const char* const kFooter = R"(Exit status:
  0  done
  1  something could not be done: a file not written, contacts not read, no display
  2  wrong use of the command line
  3  a scenario cannot be read; one line says file, line, column, place and what was expected
  4  an answer cannot be drawn: its kind, the text size, or a picture too large
  5  the plugin cannot be loaded

Environment:
  KTR_PLUGIN       the plugin's library, when --plugin is not given
  KTR_LOG          debug, info, default, error (as it comes) or off: which log lines are written
  KTR_FONTS        pinned: only the Noto fonts, from their packaged files, for pictures that are compared
  KTR_CONFIG       the configuration file with account, service and positions, when not ~/.config/ktr/config.json
  KTR_RESOURCES    the folder of images and texts, when not ../share/ktr beside the program's folder
  KTR_LOG_PRIVATE  show: names, handles, positions and URLs stand in log lines as they are)";

const char* const kShowExamples = R"(Examples:
  ktr show
  ktr show --ask "Where are my friends?"
  ktr show dinner.json
  ktr show dinner.json show-all.json --dark
  ktr show dinner.json --print-urls

Without a scenario the window is live: it asks the configured assistant what is typed, and the friends in its answers move.
In the window: Tab and Shift+Tab walk the rows, Enter opens one, the arrow keys, Page Up, Page Down, Home and End scroll,
Ctrl+Plus and Ctrl+Minus make the text larger and smaller, Ctrl+0 makes it as it was, Ctrl+Q closes.)";

const char* const kRenderExamples = R"(Examples:
  ktr render dinner.json -o dinner.png
  ktr render dinner.json -o dinner.png --scale 2 --dark
  ktr render dinner.json -o wide.pdf --width 1100
  ktr render dinner.json -o later.svg --at +90 --language de
  ktr render --live 10s --ask "Where are my friends?" -o friends.png

A picture higher than 32,000 pixels is written in pieces: FILE-1.png, FILE-2.png, ...)";

const char* const kDescribeExamples = R"(Examples:
  ktr describe dinner.json
  ktr describe dinner.json --language ar
  ktr describe --live 10s --ask "Where is Ann?")";

const char* const kAskExamples = R"(Examples:
  ktr ask "Where is Ann?"
  ktr ask "Who is near the harbour?" --json
  ktr ask "Wo ist Otto?" --language de --speak
  ktr ask "Where is Ann?" -o ann.png

Exit status, beside those of every command:
  0   found, or done            10  nobody of those asked for can be seen
  11  several have that name    12  nobody has that name
  13  you are hidden            14  the service gave no answer
  15  not signed in             16  not understood
  17  the computer is locked    18  not done: it cannot be done as it was said)";

/// Texts as they were given; read into Options once the parser is content.
struct Words {
    std::string language, textSize, idiom, at, live;
    bool isLive = false;
    bool dark = false;
    bool light = false;
};

/// The library's own range check lets "nan" through.
CLI::Validator range(double least, double most) {
    const std::string expected =
        "a number from " + CLI::detail::to_string(least) + " to " + CLI::detail::to_string(most);
    const auto check = [least, most, expected](std::string& text) {
        double number = 0.0;
        const char* end = text.data() + text.size();
        const auto [stop, error] = std::from_chars(text.data(), end, number);
        const bool fits = error == std::errc() && stop == end && number >= least && number <= most;
        return fits ? std::string() : "expected " + expected + ", found " + documents::inQuotes(text);
    };
    return CLI::Validator(check, "");
}

struct Parser {
    CLI::App app{"Draws the answers to \"where is Ann?\" as an assistant's conversation.", "ktr"};
    CLI::App* show = nullptr;
    CLI::App* render = nullptr;
    CLI::App* describe = nullptr;
    CLI::App* ask = nullptr;
    CLI::App* open = nullptr;
    CLI::App* addMap = nullptr;
    std::unique_ptr<ServeArguments> serve;
    CLI::App* watch = nullptr;
    std::unique_ptr<KeepingArguments> keeping;
    CLI::App* wyoming = nullptr;
    CLI::App* search = nullptr;
    Options options;
    Words words;

    Parser() {
        app.set_version_flag("--version", std::string("ktr ") + KTR_VERSION);
        app.require_subcommand(1);
        app.footer(kFooter);
        show = app.add_subcommand("show", "Opens a window on the conversation that scenarios tell");
        render = app.add_subcommand("render", "Draws a scenario to a PNG, SVG or PDF file, without a display");
        describe = app.add_subcommand("describe", "Prints what a screen reader would say, in reading order");
        ask = app.add_subcommand("ask", "Asks one question and prints the answer");
        addAsk();
        addConversation();
        open = app.add_subcommand("open", "Opens a link to a friend, in the window that is there or in a new one");
        open->add_option("link", options.link, "wayloc://friend/HANDLE, or wayloc://friends/; none: the window alone")
            ->type_name("LINK");
        CLI::App* maps = app.add_subcommand("maps", "Maps of one's own");
        maps->require_subcommand(1);
        addMap = maps->add_subcommand("add", "Checks a map (MBTiles), sees to its index and adds it");
        addMap->add_option("file", options.map, "The file with the map; it stays where it is")
            ->required()
            ->type_name("FILE");
        serve = std::make_unique<ServeArguments>(app);
        addWatch();
        keeping = std::make_unique<KeepingArguments>(app, options.config, options.doctor);
        addWyoming();
        addSearch();
    }

    void addAsk() {
        ask->add_option("question", options.questions, "The question, in words")
            ->required()
            ->expected(1)
            ->type_name("QUESTION");
        ask->add_flag("--json", options.json, "Print all of the answer, as one line of JSON");
        ask->add_flag("--aloud", options.aloud,
                      "For whoever hears it: only friends who may be said aloud, and nothing is changed");
        ask->add_flag("--speak", options.speak, "Say the sentence aloud, through speech-dispatcher");
        ask->add_option("-o,--output", options.output, "Draw the answer, too")->type_name("FILE.png|.svg|.pdf");
        addCommon(*ask);
        ask->footer(kAskExamples);
    }

    void addConversation() {
        show->add_option("scenarios", options.scenarios,
                         "Scenario files; one turn of the conversation each. Without one the window is live")
            ->type_name("SCENARIO");
        show->add_flag("--live", words.isLive, "Scenarios too are live: with the account, its service and the present");
        show->add_flag("--reduced-motion", options.reducedMotion, "Nothing slides or grows; answers fade in");
        show->add_flag("--print-urls", options.printUrls, "Print the URL of a tap instead of opening it");
        for (CLI::App* command : {render, describe}) {
            command->add_option("scenario", options.scenarios, "Scenario file")->expected(0, 1)->type_name("SCENARIO");
            command
                ->add_option(
                    "--live", words.live,
                    "Ask the account's service for so long, in real time: 10s, 1.5s, 2m; then draw what is there")
                ->type_name("DURATION");
            command
                ->add_option("--at", words.at,
                             "Moment: 2026-05-16T17:42:00+02:00, or +90 for 90 seconds after the start")
                ->type_name("TIME");
        }
        render->add_option("-o,--output", options.output, "Picture to write")
            ->required()
            ->type_name("FILE.png|.svg|.pdf");
        render->add_option("--scale", options.scale, "Pixels a point (1)")
            ->type_name("NUMBER")
            ->check(range(0.25, 8.0));
        for (CLI::App* command : {show, render, describe}) {
            command->add_option("--ask", options.questions, "A question for the assistant, of what is live")
                ->expected(1)
                ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
                ->type_name("QUESTION");
            addCommon(*command);
        }
        show->footer(kShowExamples);
        render->footer(kRenderExamples);
        describe->footer(kDescribeExamples);
    }

    void addWatch() {
        watch =
            app.add_subcommand("watch", "Shows a notification when somebody comes or goes, as the service tells it");
        watch->add_flag("--print", options.watch.prints, "Lines on the standard output instead of notifications");
        watch->add_option("--language", options.watch.language, "Language of the notifications, such as en, de, ar")
            ->type_name("TAG");
        CLI::Option* hook =
            watch->add_option("--hook", options.watch.hook, "Also post each, signed, to an address of your own")
                ->type_name("https://...");
        CLI::Option* key = watch->add_option("--hook-key", options.watch.hookKey, "File of the key that signs")
                               ->type_name("FILE")
                               ->needs(hook);
        hook->needs(key);
        watch->footer("Example: ktr watch --print");
    }

    void addSearch() {
        search = app.add_subcommand("search", "Answers the desktop's search, which starts it");
        search->add_option("--language", words.language, "Language of questions and answers")->type_name("TAG");
        search->add_option("--idle", options.searchIdle, "Seconds without a search until it ends (60)")
            ->type_name("SECONDS")
            ->check(CLI::Range(1, 86400));
        search->add_option("--plugin", options.plugin, "The plugin's library")->type_name("PATH");
    }

    /// A window that is live, at a link; false for one that is opened by nobody.
    bool readOpen() {
        options.command = Options::Command::Open;
        options.live = true;
        using host::LinkPolicy;
        return options.link.empty() || !std::holds_alternative<LinkPolicy::Refused>(
                                           LinkPolicy::decide(options.link, LinkPolicy::From::Outside));
    }

    void addWyoming() {
        wyoming = app.add_subcommand("wyoming", "Answers voice assistants that speak that protocol");
        wyoming->add_option("--listen", options.wyoming.address, "Address of this machine (127.0.0.1)")
            ->type_name("ADDRESS");
        wyoming->add_option("--port", options.wyoming.port, "Port (10390); 0: a free one")
            ->type_name("NUMBER")
            ->check(CLI::Range(0, 65535));
        wyoming->add_option("--allow", options.wyoming.allowed, "Another machine, or a network, that may ask")
            ->expected(1)
            ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
            ->type_name("ADDRESS");
        wyoming->add_option("--language", words.language, "Language of questions that name none")->type_name("TAG");
        wyoming->add_option("--plugin", options.plugin, "The plugin's library")->type_name("PATH");
        wyoming->footer("Example: ktr wyoming --listen 0.0.0.0 --allow 192.168.1.20");
    }

    void addCommon(CLI::App& command) {
        command.add_option("--width", options.width, "Width in points (400; 1100 on a tablet, desktop or display)")
            ->type_name("POINTS")
            ->check(range(200.0, 8000.0));
        command.add_option("--language", words.language, "Language of the texts, such as en, de, ar")->type_name("TAG");
        command.add_option("--text-size", words.textSize, "XS, S, M, L, XL, XXL, XXXL or AX1 to AX5")
            ->type_name("SIZE");
        command.add_option("--idiom", words.idiom, "phone, tablet, desktop or display")->type_name("IDIOM");
        auto* dark = command.add_flag("--dark", words.dark, "Dark colours");
        command.add_flag("--light", words.light, "Light colours")->excludes(dark);
        command.add_flag("--high-contrast", options.highContrast, "Black and white, edges drawn");
        command.add_option("--plugin", options.plugin, "The plugin's library")->type_name("PATH");
    }
};

/// "+90" or "+90.5": seconds.
std::optional<double> secondsOf(const std::string& text) {
    double seconds = 0.0;
    if (text.size() < 2 || text.front() != '+') {
        return std::nullopt;
    }
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data() + 1, end, seconds, std::chars_format::fixed);
    const bool whole = error == std::errc() && stop == end;
    return whole && std::isfinite(seconds) && seconds >= 0.0 && seconds <= kLongestRun ? std::optional(seconds)
                                                                                       : std::nullopt;
}

/// "10s", "1.5s", "2m" or "250ms"; seconds alone may leave the unit out.
std::optional<double> durationOf(const std::string& text) {
    double number = 0.0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, number, std::chars_format::fixed);
    const std::string unit(stop, end);
    const double factor = unit.empty() || unit == "s" ? 1.0 : unit == "ms" ? 0.001 : unit == "m" ? 60.0 : 0.0;
    const double seconds = number * factor;
    const bool fits = error == std::errc() && factor > 0.0 && seconds > 0.0 && seconds <= kLongestLive;
    return fits ? std::optional(seconds) : std::nullopt;
}

std::string wrong(const std::string& option, const std::string& expected, const std::string& found) {
    return option + ": expected " + expected + ", found " + documents::inQuotes(found);
}

/// Fills in what the words say; the complaint about the first wrong one, or an empty text.
std::string readWords(const Words& words, Options& options) {
    if (!words.language.empty()) {
        if (!host::isLanguageTag(words.language)) {
            return wrong("--language", "a language such as en-GB", words.language);
        }
        options.language = words.language;
    }
    if (!words.textSize.empty()) {
        options.textSize = linux_::LinuxDevice::categoryNamed(words.textSize);
        if (!options.textSize) {
            return wrong("--text-size", "one of XS, S, M, L, XL, XXL, XXXL, AX1, AX2, AX3, AX4, AX5", words.textSize);
        }
    }
    if (!words.idiom.empty()) {
        options.idiom = linux_::LinuxDevice::idiomNamed(words.idiom);
        if (!options.idiom) {
            return wrong("--idiom", "one of phone, tablet, desktop, display", words.idiom);
        }
    }
    if (!words.at.empty()) {
        options.at = documents::parseIsoTime(words.at);
        options.atSeconds = secondsOf(words.at);
        if (!options.at && !options.atSeconds) {
            return wrong("--at", "a time such as 2026-05-16T17:42:00+02:00, or +90 for seconds up to a week", words.at);
        }
    }
    if (words.dark || words.light) {
        options.dark = words.dark;
    }
    return "";
}

/// What is live, and whether there is anything to draw.
std::string readLive(const Words& words, Options& options) {
    const bool isShow = options.command == Options::Command::Show;
    options.live = words.isLive || !words.live.empty() || (isShow && options.scenarios.empty());
    if (!words.live.empty()) {
        const auto seconds = durationOf(words.live);
        if (!seconds) {
            return wrong("--live", "a duration up to a day, such as 10s or 2m", words.live);
        }
        options.liveSeconds = *seconds;
    }
    if (options.command == Options::Command::Ask || options.command == Options::Command::Wyoming ||
        options.command == Options::Command::Search) {
        options.live = true;
        return options.command == Options::Command::Wyoming ? WyomingCommand::objection(options.wyoming) : "";
    }
    if (!options.live && !options.questions.empty()) {
        return "--ask: nobody answers in a scenario; add --live";
    }
    if (options.live && !words.at.empty()) {
        return "--at: what is live happens now";
    }
    if (!isShow && options.scenarios.empty() && options.questions.empty()) {
        return options.live ? "expected a scenario, or a question: --ask \"Where is Ann?\""
                            : "expected a scenario, or --live 10s --ask \"Where is Ann?\"";
    }
    return "";
}

/// What is wrong with the first word, when it is no command, and with an option that there is not.
std::string unknownWord(const CLI::App& app, const std::vector<std::string>& arguments) {
    std::vector<std::string> names;
    for (const CLI::App* command : app.get_subcommands({})) {
        names.push_back(command->get_name());
    }
    if (arguments.empty() || arguments.front().starts_with('-')) {
        return "";
    }
    const std::string& word = arguments.front();
    const auto command = std::find(names.begin(), names.end(), word);
    if (command == names.end()) {
        return "there is no command " + documents::inQuotes(word) + documents::didYouMean(word, names);
    }
    names.clear();
    for (const CLI::Option* option : app.get_subcommand(word)->get_options()) {
        for (const std::string& name : option->get_lnames()) {
            names.push_back("--" + name);
        }
    }
    for (auto argument = arguments.begin() + 1; argument != arguments.end() && *argument != "--"; ++argument) {
        const std::string name = argument->substr(0, argument->find('='));
        if (name.starts_with("--") && std::find(names.begin(), names.end(), name) == names.end()) {
            return "there is no option " + documents::inQuotes(name) + documents::didYouMean(name, names);
        }
    }
    return "";
}

bool endsWith(const std::string& text, const std::string& end) {
    return text.size() > end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

/// Empty, or what is wrong.
std::string readWatch(Options& options) {
    options.command = Options::Command::Watch;
    const WatchCommand::Options& given = options.watch;
    if (!given.language.empty() && !host::isLanguageTag(given.language)) {
        return wrong("--language", "a language such as en-GB", given.language);
    }
    const std::string objection = given.hook.empty() ? "" : CrossingHook::objection(given.hook);
    return objection.empty() ? "" : "--hook: " + objection;
}

/// What a command that asks or draws was given. Empty, or what is wrong.
std::string readQuestion(Parser& parser) {
    Options& options = parser.options;
    options.command = parser.ask->parsed()       ? Options::Command::Ask
                      : parser.wyoming->parsed() ? Options::Command::Wyoming
                      : parser.search->parsed()  ? Options::Command::Search
                      : parser.show->parsed()    ? Options::Command::Show
                      : parser.render->parsed()  ? Options::Command::Render
                                                 : Options::Command::Describe;
    if (const std::string complaint = readWords(parser.words, options); !complaint.empty()) {
        return complaint;
    }
    if (const std::string complaint = readLive(parser.words, options); !complaint.empty()) {
        return complaint;
    }
    const std::string& output = options.output;
    const bool draws = parser.render->parsed() || !output.empty();
    if (draws && !endsWith(output, ".png") && !endsWith(output, ".svg") && !endsWith(output, ".pdf")) {
        return wrong("--output", "a file name that ends in .png, .svg or .pdf", output);
    }
    return "";
}

}  // namespace

std::variant<Options, CommandLine::Ending> CommandLine::parse(std::vector<std::string> arguments) {
    Parser parser;
    const std::vector<std::string> given = arguments;
    // The parser takes the arguments from the back.
    std::reverse(arguments.begin(), arguments.end());
    const auto misuse = [](const std::string& line) {
        return Ending{host::ExitCode::Usage, "ktr: " + documents::forLine(line) + "\nSee ktr --help.\n"};
    };
    try {
        parser.app.parse(std::move(arguments));
    } catch (const CLI::CallForVersion& version) {
        return Ending{host::ExitCode::Ok, std::string(version.what()) + "\n"};
    } catch (const CLI::CallForHelp&) {
        const auto asked = parser.app.get_subcommands();
        return Ending{host::ExitCode::Ok, (asked.empty() ? parser.app.help() : asked.front()->help("ktr")) + "\n"};
    } catch (const CLI::ParseError& error) {
        // The library's own words name neither the slip nor what was meant.
        const std::string unknown = unknownWord(parser.app, given);
        return misuse(unknown.empty() ? error.what() : unknown);
    }
    if (parser.serve->parsed()) {
        parser.options.command = Options::Command::Serve;
        const std::string complaint = parser.serve->read(parser.options.serve);
        return complaint.empty() ? std::variant<Options, Ending>(parser.options) : misuse(complaint);
    }
    if (parser.watch->parsed()) {
        const std::string complaint = readWatch(parser.options);
        return complaint.empty() ? std::variant<Options, Ending>(parser.options) : misuse(complaint);
    }
    if (parser.keeping->isConfig() || parser.keeping->isDoctor()) {
        parser.options.command = parser.keeping->isDoctor() ? Options::Command::Doctor : Options::Command::Config;
        return parser.options;
    }
    if (parser.addMap->parsed()) {
        parser.options.command = Options::Command::AddMap;
        return parser.options;
    }
    if (parser.open->parsed()) {
        return parser.readOpen() ? std::variant<Options, Ending>(parser.options)
                                 : misuse(wrong("LINK", "a link such as wayloc://friend/ann@harbour.example, or https",
                                                parser.options.link));
    }
    const std::string complaint = readQuestion(parser);
    return complaint.empty() ? std::variant<Options, Ending>(parser.options) : misuse(complaint);
}

}  // namespace ktr::app
