#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"
#include "platform/client/HttpTransport.h"

namespace ktr::host {

/// Hands commands on and takes notes of how they end, for those who tell the user about it.
class ServiceWatch : public platform::HttpTransport {
  public:
    enum class Trouble {
        None,
        Unreachable,  ///< nothing could be reached: no connection, or one that failed
        Untrusted,    ///< whoever was reached could not prove to be the service
        Faulty,       ///< the service answers, but not what was asked for
        SignedOut,    ///< the service does not take the credentials
    };

    struct Notes {
        /// When the last answer came that said something.
        std::optional<platform::Date> answered;
        /// How the last command ended.
        Trouble trouble = Trouble::None;
        int underWay = 0;
        int answers = 0;
        int failures = 0;
        /// After how many seconds the service wants to be asked again; 0: no more.
        double interval = 0.0;
    };

    /// `changed` is called on the main thread after notes were taken.
    ServiceWatch(std::shared_ptr<platform::HttpTransport> next, std::shared_ptr<platform::MainLoop> mainLoop,
                 std::shared_ptr<platform::Clock> clock);
    ~ServiceWatch() override;

    void send(const platform::HttpRequest& request, Completion completion) override;

    /// Main thread.
    const Notes& notes() const { return state_->notes; }
    void setChanged(std::function<void()> changed) { state_->changed = std::move(changed); }

    /// What an answer says of the service; `isUsable`: it has the content that was asked for. Any thread.
    static Trouble troubleOf(platform::HttpFailure failure, int status, bool isUsable);
    static Trouble troubleOf(const platform::HttpAnswer& answer);
    /// After how many seconds the plugin will ask again after this answer; it also reads numbers that stand in a text.
    /// 0 where the service names none. Any thread.
    static double intervalOf(const platform::HttpAnswer& answer);

  private:
    struct State {
        Notes notes;
        std::function<void()> changed;
        std::shared_ptr<platform::Clock> clock;
        /// No trouble at all, not even `None`: the command was ended by this side.
        void take(std::optional<Trouble> trouble, std::optional<double> interval);
    };

    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<State> state_;
    /// Goes first: what it ends still posts to the loop.
    std::shared_ptr<platform::HttpTransport> next_;
};

}  // namespace ktr::host
