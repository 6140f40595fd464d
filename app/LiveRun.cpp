#include "app/LiveRun.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <QTimer>
#include <string>

#include "app/Messages.h"

namespace ktr::app {

namespace {

constexpr int kTick = 200;  // milliseconds
constexpr double kMillisecondsASecond = 1000.0;

/// Writes what changed since the last time, a line a change.
class Progress {
  public:
    Progress(host::Host& host, const host::LiveConversation& conversation) : host_(host), conversation_(conversation) {}

    void tellNews() {
        const auto& notes = host_.live()->service().notes();
        if (notes.answers + notes.failures != seen_) {
            seen_ = notes.answers + notes.failures;
            tell("the service was asked: " + std::to_string(notes.answers) + " answers, " +
                 std::to_string(notes.failures) + " failures");
        }
        const auto status = conversation_.status();
        if (!status.words.empty() && status.words != words_ && !host_.live()->isUnusable()) {
            words_ = status.words;
            tell(words_);
        }
    }

  private:
    host::Host& host_;
    const host::LiveConversation& conversation_;
    int seen_ = 0;
    std::string words_;
};

}  // namespace

host::ExitCode LiveRun::run(std::vector<host::Scenario> scenarios) {
    const auto conversation = host::LiveConversation::make(host_);
    Progress progress(host_, *conversation);
    QEventLoop loop;
    QTimer tick;
    QTimer end;
    end.setSingleShot(true);
    const double width = host_.settings().width;
    const auto layOut = [&](host::TurnView&) { host_.layOut(width); };
    conversation->setHandlers({layOut, layOut, [&] { progress.tellNews(); }});
    // Rows are laid out as they would be in a window: what the plugin asks of its width is true.
    QObject::connect(&tick, &QTimer::timeout, [&] {
        host_.layOut(width);
        progress.tellNews();
        if (!conversation->isWaiting() && !end.isActive()) {
            end.start(static_cast<int>(options_.liveSeconds * kMillisecondsASecond));
        }
    });
    QObject::connect(&end, &QTimer::timeout, &loop, &QEventLoop::quit);
    for (const std::string& question : options_.questions) {
        conversation->ask(question);
    }
    conversation->start(std::move(scenarios));
    tick.start(kTick);
    loop.exec();
    if (const auto& failure = conversation->failure()) {
        // The log has named the cause; what follows from it need not be said as well.
        if (!host_.live()->isUnusable()) {
            tell(failure->line);
        }
        return failure->code;
    }
    return host::ExitCode::Ok;
}

}  // namespace ktr::app
