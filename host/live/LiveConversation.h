#pragma once

#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "ask/Ports.h"
#include "host/Host.h"
#include "host/asking/QuestionDesk.h"
#include "host/asking/ServiceRequests.h"
#include "host/live/LiveStatus.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::host {

/// Has questions answered, by the engine or by the assistant's server that the account names, and puts the answers into
/// a host's conversation with what can be done about them; knows what the status line says. The host is a live one and
/// outlives this. Main thread.
class LiveConversation : public platform::PlatformLocationManagerDelegate,
                         public std::enable_shared_from_this<LiveConversation> {
  public:
    /// Longer questions are cut to so many bytes.
    static constexpr std::size_t kLongestQuestion = 2000;

    struct Handlers {
        std::function<void(TurnView&)> asked;     ///< a turn came: a question, or a scenario's
        std::function<void(TurnView&)> answered;  ///< a question's turn has its answer
        std::function<void()> changed;            ///< what `status` says may be another
        /// A turn that waits, or waits no more, looks another way; it is laid out again.
        std::function<void(TurnView&)> waits = {};
        /// Nothing came of a question: whoever asks it again has it at hand.
        std::function<void(const std::string& question)> failed = {};
        /// The turn with this question has gone: it was stopped.
        std::function<void(const std::string& question)> stopped = {};
        // What the buttons of an answer do besides asking; what is not there is not offered.
        std::function<void()> signIn = {};
        std::function<void()> showFriends = {};
        std::function<void(const std::string& url)> open = {};
    };
    /// After this long a ring stands before a question, and after that it is said that it takes long. Seconds.
    static constexpr double kRingAfter = 0.4;
    static constexpr double kSlowAfter = 4.0;

    static std::shared_ptr<LiveConversation> make(Host& host);

    void setHandlers(Handlers handlers) { handlers_ = std::move(handlers); }
    /// Reads the account; the scenarios and the questions that were asked meanwhile come after that.
    void start(std::vector<Scenario> scenarios = {});
    /// Blanks at both ends do not count; a question of nothing else is none.
    void ask(const std::string& question);
    /// Whether `stop` would stop something.
    bool canStop() const;
    /// Gives up the question under way, and those that wait. A wish that has left is not given up: it may be honoured.
    void stop();

    /// What the service says of the user's own sharing.
    struct Sharing {
        std::optional<bool> isSeen;  ///< by those whom a rule allows; none: it did not say
        ask::ServiceReply::Failure failure = ask::ServiceReply::Failure::None;
    };
    /// Says to the service that friends shall see the user, or shall not, or with none asks how it is: one request, in
    /// its turn among the questions. `said` hears once how it is then.
    void wishToBeSeen(std::optional<bool> isSeen, std::function<void(const Sharing&)> said);

    /// Somebody who lets the user see where they are.
    struct Sharer {
        std::string name;
        std::string handle;
    };
    /// Asks the service for all of them; nobody is told where it does not say.
    void whoShares(std::function<void(const std::vector<Sharer>&)> told);

    /// Asks at once whether the service is there again, and for what is on screen.
    void tryNow();

    LiveStatus status() const;
    /// After how many seconds that may be another although nothing happens. None: never.
    std::optional<double> statusChangesIn() const;
    /// Whether questions, or the account, are still waited for.
    bool isWaiting() const { return !ready_ || isAsking(); }
    /// Whether a question waits for its answer.
    bool isAsking() const;
    /// Why the last question, or the last scenario, has no answer; none when it has one.
    const std::optional<Failure>& failure() const { return failure_; }

    void didUpdateLocations(platform::PlatformLocationManager&, const platform::PlatformLocations&) override;

  private:
    LiveStatus::Facts facts() const;
    struct Waiting {
        std::weak_ptr<TurnView> turn;  ///< of a question; a wish has none
        std::string question;
        std::optional<bool> isSeen = std::nullopt;           ///< of a wish
        std::function<void(const Sharing&)> said = nullptr;  ///< of a wish
        /// Who is asked: of two that are under way the one that was stopped has no say any more.
        int number = 0;
    };
    /// What became of a question.
    struct Reply {
        Scenario scenario;
        Offers offers = {};
        bool isFailure = false;  ///< nothing came
        bool wasUnderstood = true;
    };
    explicit LiveConversation(Host& host);
    void enqueue(const std::shared_ptr<TurnView>& turn, const std::string& question);
    /// The same turn is asked once more, or otherwise.
    void askAgain(const std::weak_ptr<TurnView>& turn, const std::string& question);
    void sendWish(const Waiting& asked);
    void sendToEngine(const Waiting& asked);
    void sendToAssistant(const Waiting& asked);
    Reply replyOf(const Waiting& asked, const ask::Answer& answer);
    /// Rings and patience of the questions that wait, from now on.
    void showWaiting();
    std::function<void(const Reply&)> whenAnswered(const Waiting& asked);
    void accountRead();
    /// Sends the question that waits longest, unless one is under way.
    void sendNext();
    void receive(const Waiting& asked, const Reply& reply);
    void receiveWish(const Waiting& asked, const ask::ServiceReply& reply);
    /// What to show for an answer; sets `failure_`.
    Reply read(const linux_::AssistantClient::Answer& answer);
    /// Something has come on screen: an answer of the assistant's, or a scenario.
    void shown(bool wasAsked);
    void tellChanged();
    platform::Date now() const;

    Host& host_;
    ServiceRequests requests_;
    Handlers handlers_;
    bool ready_ = false;
    /// In the order they were asked. One at a time is sent: a question may be a wish, such as to hide, and the last one
    /// has to be honoured last.
    std::deque<Waiting> waiting_;
    std::optional<Waiting> underWay_;
    /// It is a wish, and has left.
    bool isWish_ = false;
    QuestionDesk desk_;
    std::vector<Scenario> scenarios_;
    int asked_ = 0;
    std::shared_ptr<platform::Timer> patience_;
    std::optional<platform::Date> askedAt_;
    ServiceWatch::Trouble assistant_ = ServiceWatch::Trouble::None;
    platform::Date assistantEnded_;
    std::optional<platform::Date> shownAt_;
    bool wasAsked_ = false;
    std::optional<Failure> failure_;
    std::shared_ptr<platform::PlatformLocationManager> positions_;
    bool findingPosition_ = false;
};

}  // namespace ktr::host
