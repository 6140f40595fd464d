#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <variant>

#include "host/Failure.h"
#include "host/HostDelegate.h"
#include "host/HostSettings.h"
#include "host/Plugin.h"
#include "host/conversation/ConversationView.h"
#include "host/live/LiveServices.h"
#include "platform/base/Platform.h"
#include "platform/base/VirtualTime.h"
#include "platform/ui/Window.h"

namespace ktr::host {

/// A complete host around one conversation: the installed platform, the plugin, and the view tree in which the plugin's
/// answers stand. One at a time; a QGuiApplication exists as long as it does. Main thread.
class Host {
  public:
    /// How time passes: only when told to, or by itself on Qt's event loop. A live conversation's always runs.
    enum class Time { Virtual, Running };

    /// Installs the platform, reads the contacts and loads the plugin.
    static std::variant<std::unique_ptr<Host>, Failure> make(const HostSettings& settings, Time time,
                                                             const std::string& pluginPath);
    ~Host();
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;

    /// Adds a scenario's turn at the conversation's end; a failure when the plugin draws no such answer.
    std::optional<Failure> addTurn(const Scenario& scenario);
    /// Adds a turn that is a question so far, asked now.
    std::shared_ptr<TurnView> addQuestion(const std::string& question);
    /// Gives such a turn its sentence and, when there is one that the plugin draws, its card. An answer that cannot be
    /// drawn and says nothing either gets a sentence of the host's.
    void answer(TurnView& turn, const Scenario& answer);
    /// Lets the virtual clock run to the moment that the settings name and on until nothing is due, laying out at
    /// `width` before and after. The conversation's height, points.
    double settle(double width);

    const std::shared_ptr<platform::Window>& window() const { return window_; }
    const std::shared_ptr<ConversationView>& conversation() const { return conversation_; }
    HostDelegate& delegate() { return *delegate_; }
    /// None where nothing is live.
    LiveServices* live() const { return live_.get(); }
    const std::shared_ptr<platform::Platform>& platform() const { return platform_; }
    /// A text of the host's own, by its key.
    std::string text(const std::string& key) const;
    /// The clock face of a moment, as the conversation shows it.
    std::string clockFace(platform::Date moment) const;
    const HostSettings& settings() const { return settings_; }
    /// The newest card says that friends cannot see the user.
    bool saysHidden() const { return saysHidden_; }
    bool rightToLeft() const;

    /// Lays the conversation out and makes the window as large as it; the height, points.
    double layOut(double width);

  private:
    Host() = default;
    TurnTexts textsOf(const Scenario& scenario) const;
    void setTimes(TurnTexts& texts, const std::string& clockFace) const;
    /// False when the plugin draws no such answer.
    bool addCard(TurnView& turn, const Scenario& scenario);
    /// Of the answers about the user's own sharing only the newest is live: an earlier one would go on showing a user
    /// who has hidden since.
    void endEarlierSharing(const std::shared_ptr<platform::HostSnippetViewController>& controller);

    HostSettings settings_;
    std::shared_ptr<platform::Platform> platform_;
    std::shared_ptr<platform::VirtualTime> virtualTime_;
    std::unique_ptr<LiveServices> live_;
    std::unique_ptr<Plugin> plugin_;
    std::shared_ptr<HostDelegate> delegate_;
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<ConversationView> conversation_;
    std::weak_ptr<platform::HostSnippetViewController> sharing_;
    bool saysHidden_ = false;
};

}  // namespace ktr::host
