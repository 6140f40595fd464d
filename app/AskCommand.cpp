#include "app/AskCommand.h"

#include <unistd.h>

#include <QEventLoop>
#include <QProcess>
#include <QTimer>
#include <algorithm>
#include <cstdio>
#include <optional>

#include "app/Messages.h"
#include "app/RenderCommand.h"
#include "documents/Words.h"
#include "host/asking/QuestionDesk.h"
#include "platform/base/Json.h"

namespace ktr::app {

namespace {

/// How long a keyring may take before the question is asked without a secret, and an answer may be spoken,
/// milliseconds.
constexpr int kAccountWait = 10000;
constexpr int kSpeechWait = 60000;
/// What a picture waits for until faces, region and map are there, milliseconds.
constexpr int kSettling = 1500;
constexpr int kTick = 100;
/// Of many who could be meant, so many lines.
constexpr std::size_t kMostTold = 9;

/// Through speech-dispatcher; waits for the end. Whether it was said.
bool speak(const std::string& sentence, const std::string& language) {
    QProcess speech;
    // After "--" nothing is an option, whatever a name begins with.
    speech.start(QStringLiteral("spd-say"),
                 {QStringLiteral("--wait"), QStringLiteral("--application-name"), QStringLiteral("ktr"),
                  QStringLiteral("--language"), QString::fromStdString(language.substr(0, language.find('-'))),
                  QStringLiteral("--"), QString::fromStdString(sentence)});
    return speech.waitForFinished(kSpeechWait) && speech.exitStatus() == QProcess::NormalExit && speech.exitCode() == 0;
}

void tellQuestion(const std::string& question, const std::string& name) {
    tell("ktr ask " + documents::asShellWord(question) + (name.empty() ? "" : "   # " + name));
}

/// The questions that mean one of several, or that ask somebody to share.
void tellWhatToAsk(const ask::Answer& answer) {
    for (std::size_t i = 0; i < std::min(answer.choices.size(), kMostTold); ++i) {
        tellQuestion(answer.choices[i].question, answer.choices[i].name);
    }
    if (answer.action.kind == ask::Action::Kind::AskToShare) {
        tellQuestion(answer.action.label, "");
    }
}

}  // namespace

int AskCommand::run() {
    using Audience = host::QuestionDesk::Audience;
    host::QuestionDesk desk(host_, options_.aloud ? Audience::WhoeverHears : Audience::User);
    QEventLoop loop;
    std::optional<ask::Answer> answer;
    const std::string& text = options_.questions.front();
    const auto ask = [&] {
        desk.ask(desk.question(text, false), [&](ask::Answer given) {
            answer = std::move(given);
            loop.quit();
        });
    };
    bool isAsked = false;
    const auto askOnce = [&] {
        if (!std::exchange(isAsked, true)) {
            ask();
        }
    };
    QTimer::singleShot(kAccountWait, &loop, askOnce);
    host_.live()->start(askOnce);
    if (!answer) {
        loop.exec();
    }
    return write(text, *answer);
}

void AskCommand::settle() {
    QEventLoop loop;
    QTimer tick;
    const auto layOut = [this] { host_.layOut(host_.settings().width); };
    QObject::connect(&tick, &QTimer::timeout, layOut);
    QTimer::singleShot(kSettling, &loop, &QEventLoop::quit);
    layOut();
    tick.start(kTick);
    loop.exec();
    layOut();
}

int AskCommand::write(const std::string& question, const ask::Answer& answer) {
    const std::string text = options_.json ? documents::jsonForTerminal(platform::writeJson(ask::objectOf(answer)))
                                           : documents::withoutControls(answer.sentence);
    if (std::fputs((text + "\n").c_str(), stdout) == EOF || std::fflush(stdout) != 0) {
        tell("the answer cannot be written");
        return static_cast<int>(host::ExitCode::Failure);
    }
    // Whoever reads it sees what to ask next; a program has it in the object.
    if (!options_.json && ::isatty(STDERR_FILENO) == 1) {
        tellWhatToAsk(answer);
    }
    if (!options_.output.empty()) {
        host::QuestionDesk desk(host_);
        const RenderCommand render(host_);
        render.choosePalette();
        host_.answer(*host_.addQuestion(question), desk.scenarioOf(answer));
        settle();
        if (const auto failure = render.write(options_.output)) {
            tell(failure->line);
            return static_cast<int>(failure->code);
        }
    }
    if (options_.speak && !speak(answer.sentence, host_.settings().language)) {
        tell("the answer cannot be said: speech-dispatcher (spd-say) does not answer");
        return static_cast<int>(host::ExitCode::Failure);
    }
    return ask::exitCodeOf(answer.outcome);
}

}  // namespace ktr::app
