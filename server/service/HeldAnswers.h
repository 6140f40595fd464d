#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <vector>

#include "server/http/HttpReply.h"
#include "server/store/Changes.h"

namespace ktr::server {

/// Answers that wait until what they say has changed. A client that asks the same again when it was told to, and would
/// hear the same again, is held below its deadline (30 seconds for everything, 15 without a byte) instead: so it hears
/// of a change when it happens. Whoever asks for the first time, or out of turn, is answered at once; of clients that
/// ask for the same with one secret, one is held. What is compared is what the viewer may see and nothing else: of
/// somebody hidden, as of nobody, nothing ever changes. Any thread.
class HeldAnswers {
  public:
    static constexpr double kMost = 10.0;     ///< seconds that an answer is held at most
    static constexpr double kAskAgain = 1.0;  ///< after which a client that is held in turn asks again, seconds
    /// A client that comes this much later than it was told to is a new one. Seconds.
    static constexpr double kGrace = 3.0;
    static constexpr std::size_t kMostHeld = 1500;

    /// An answer as it would be given now.
    struct Answer {
        std::string said;               ///< of what the viewer sees: alike when nothing has changed
        std::set<std::int64_t> people;  ///< a change of one of them may change it: the viewer, and who was asked for
        std::function<void(const HttpReply&)> give;  ///< sends it, now or a little later
    };
    /// Makes an answer; a reply of its own kind when it cannot, with `people` empty.
    using Maker = std::function<Answer()>;
    using Later = std::function<void(double seconds, std::function<void()>)>;

    explicit HeldAnswers(Later later) : later_(std::move(later)), alive_(std::make_shared<Alive>()) {
        alive_->answers = this;
    }
    ~HeldAnswers();
    HeldAnswers(const HeldAnswers&) = delete;
    HeldAnswers& operator=(const HeldAnswers&) = delete;

    /// Answers now, or holds it. `client`: who asks for what.
    void give(const std::string& client, const Maker& make, const HttpReply& reply);
    /// For the store's changes.
    void concerns(const Change& change);
    /// Answers all that are held.
    void release();
    std::size_t size() const;

  private:
    using Clock = std::chrono::steady_clock;
    struct Held;
    struct Last {
        std::string said;
        Clock::time_point time;
    };
    struct Alive {
        std::mutex mutex;
        HeldAnswers* answers = nullptr;
    };
    /// Whether this is the client that was answered so, in its turn.
    bool isInTurn(const std::string& client, const std::string& said, Clock::time_point now) const;
    void answer(const std::string& client, const Answer& answer, const HttpReply& reply);
    /// Looks whether what a held answer says has changed, or its time is over.
    void look(const std::string& client, const std::shared_ptr<Held>& held, bool isOver);
    void schedule(double seconds, std::function<void(HeldAnswers&)> what);

    const Later later_;
    mutable std::mutex mutex_;
    std::map<std::string, Last> last_;
    std::map<std::string, std::shared_ptr<Held>> held_;
    std::multimap<std::int64_t, std::string> clients_;  ///< by person
    Clock::time_point forgotten_;                       ///< when old clients were forgotten last
    std::shared_ptr<Alive> alive_;
};

}  // namespace ktr::server
