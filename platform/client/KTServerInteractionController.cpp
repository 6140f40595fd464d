#include "platform/client/KTServerInteractionController.h"

#include <utility>

#include "platform/base/Assert.h"
#include "platform/base/MainLoop.h"
#include "platform/base/NotificationCenter.h"
#include "platform/base/Platform.h"

namespace ktr::platform {

namespace {

/// What lives as long as a command is under way. It holds the loop of the platform that sent it, since the platform may
/// be taken away meanwhile.
struct Sending {
    std::shared_ptr<KTJSONCommand> command;
    std::shared_ptr<MainLoop> mainLoop;
    std::shared_ptr<NotificationCenter> notificationCenter;
    KTJSONCommand::CompletionBlock block;
};

}  // namespace

void KTServerInteractionController::sendCommand(const std::shared_ptr<KTJSONCommand>& command,
                                                KTJSONCommand::CompletionBlock completion) {
    KTR_ASSERT_MAIN_THREAD();
    const auto platform = Platform::installed();
    if (!command || !platform || !platform->mainLoop) {
        return;
    }
    command->setCompletionBlock(std::move(completion));
    const auto sending = std::make_shared<Sending>();
    sending->command = command;
    sending->mainLoop = platform->mainLoop;
    sending->notificationCenter = platform->notificationCenter;
    const auto finish = [sending](HttpAnswer answer) {
        sending->command->finish(std::move(answer));
        if (sending->command->wasRedirected()) {
            sending->notificationCenter->post({kKTCommandRedirectedNotification, sending->command});
        }
        sending->block = sending->command->takeCompletionBlock();
        if (sending->block) {
            sending->block();
        }
        // The last references go on the main thread, after what the block has posted there.
        Sending last = std::move(*sending);
        const auto loop = std::move(last.mainLoop);
        loop->post([kept = std::make_shared<Sending>(std::move(last)), worker = std::weak_ptr(loop)] {
            kept->block = nullptr;
            const auto there = worker.lock();
            // Nobody else has the command: nobody can ask for its answer any more.
            if (there && kept->command.use_count() == 1 && kept->command->hasLargeAnswer()) {
                there->runInBackground([answer = kept->command->takeAnswer()] {});
            }
        });
    };
    if (command->host().empty() || !platform->httpTransport) {
        platform->mainLoop->post([finish] { finish({HttpFailure::BadRequest, 0, std::nullopt, std::nullopt}); });
        return;
    }
    platform->httpTransport->send(command->makeRequest(), finish);
}

}  // namespace ktr::platform
