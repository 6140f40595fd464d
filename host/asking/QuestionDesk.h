#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "ask/Engine.h"
#include "host/Host.h"
#include "host/asking/AloudRequests.h"
#include "host/asking/ServiceRequests.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::host {

/// The engine that answers questions, on a live host's contacts, service, units, position and lock. Main thread.
class QuestionDesk {
  public:
    /// Who gets the answers.
    enum class Audience {
        User,
        /// Whoever is in the room: only friends who may be said aloud, nothing about the user's sharing, and no wish is
        /// honoured.
        WhoeverHears,
    };

    /// The host is a live one and outlives this.
    explicit QuestionDesk(Host& host, Audience audience = Audience::User);

    /// A question with what the host knows of the asker. `isLive`: its card goes on changing.
    ask::Question question(const std::string& text, bool isLive);
    /// The same without a look for the asker's position: for what is read here and not asked.
    ask::Question questionInWords(const std::string& text) const;
    /// Calls the completion exactly once, and not after this is gone. `understood` hears what the service is asked for.
    void ask(const ask::Question& question, const ask::Engine::Completion& completion,
             const ask::Engine::Meant& understood = nullptr);
    /// The same as a turn for the conversation: the sentence, and its snippet when there is one.
    Scenario scenarioOf(const ask::Answer& answer) const;
    /// With the people of the contacts as they are now.
    ask::Engine& engine() {
        readPeople();
        return engine_;
    }

  private:
    void readPeople();

    Host& host_;
    const Audience audience_;
    ServiceRequests requests_;
    AloudRequests aloud_{requests_};
    ask::Engine engine_;
    /// Whose contacts the engine has.
    std::weak_ptr<platform::ContactStore> contacts_;
    std::shared_ptr<platform::PlatformLocationManager> positions_;
    std::shared_ptr<bool> alive_ = std::make_shared<bool>(true);
};

}  // namespace ktr::host
