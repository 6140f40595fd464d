#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "host/Environment.h"
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
    /// How time passes: only when asked to, or by itself on Qt's event loop. A live conversation's always runs.
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
    /// Takes a turn's answer away: it is a question again.
    void takeAnswerBack(TurnView& turn);
    /// Takes a turn out of the conversation; nothing for one that is none of it.
    void removeTurn(TurnView& turn);
    /// Lets the virtual clock run to the moment that the settings name and on until nothing is due, laying out at
    /// `width` before and after. The conversation's height, points.
    double settle(double width);

    /// A question goes to the assistant, and may be a wish about the user's own sharing: what the newest card about
    /// that has under way ends now, before the question leaves, so that nothing of it can arrive later and undo the
    /// wish. The card becomes a still: a picture, its spoken text, and a tap to the user's own page. Where nothing is
    /// live nothing leaves, and the card stays as it is.
    void endSharing();

    /// Makes everything anew for settings that have changed: language, region, text size, account, contacts. The
    /// installed platform is uninstalled with all that it holds, another one is installed, and each card is made again
    /// of the newest that its controller knew; a live one about the user's own sharing becomes a still instead, since a
    /// new one would show a user who may have hidden since. Window, conversation and turns stay the same objects, cards
    /// and what is in them do not; `remade` is called at the end, and whoever shows the conversation lays it out again.
    /// With a failure everything stays as it was, unless it is the plugin that fails: then there are no cards.
    std::optional<Failure> remake(const HostSettings& settings) { return remake(settings, nullptr); }
    /// The same for what has not changed: each card asks at once, as it did when it came.
    void askAgain();
    /// Called after `remake`.
    void setRemade(std::function<void()> remade) { remade_ = std::move(remade); }
    /// Called in `remake` while what is there is still whole: what belongs to its platform has to go now.
    void setRemaking(std::function<void()> remaking) { remaking_ = std::move(remaking); }

    /// What the answers are about, the newest turn first and as its card knows it now. Of a turn without one nothing.
    std::vector<std::shared_ptr<platform::AssistantObject>> snippets() const;
    /// What draws a snippet outside the conversation; it asks and reports as a card's does. Whoever has it lets go of
    /// it when `remaking` is called. Null where the plugin draws no such thing.
    std::shared_ptr<platform::HostSnippetViewController> controllerFor(
        const std::shared_ptr<platform::AssistantObject>& snippet) const;

    /// The device allows no friends' locations: no card is made and nothing is asked; a turn says so instead.
    bool isRestricted() const;

    /// Tells each card that is scrolled away that it disappears, and when it is back that it appears: it then asks once
    /// more and rests. The newest card lives on wherever it stands, and one about the user's own sharing never appears
    /// twice: it would share again.
    void tellWhatIsSeen(const std::function<bool(const TurnView&)>& isSeen);

    /// The same for as long as the host stands.
    const std::shared_ptr<platform::Window>& window() const { return window_; }
    const std::shared_ptr<ConversationView>& conversation() const { return conversation_; }
    HostDelegate& delegate() { return *delegate_; }
    /// None where nothing is live.
    LiveServices* live() const { return environment_.live.get(); }
    /// The installed one; another after `remake`.
    const std::shared_ptr<platform::Platform>& platform() const { return environment_.platform; }
    /// A text of the host's own, by its key.
    std::string text(const std::string& key) const;
    /// A whole number in the digits of the language.
    std::string number(std::int64_t number) const;
    /// The clock face of a moment, as the conversation shows it.
    std::string clockFace(platform::Date moment) const;
    const HostSettings& settings() const { return settings_; }
    /// The desktop's wish; whoever shows the conversation draws it again.
    void setDesktopHighContrast(bool high) { settings_.desktopHighContrast = high; }
    /// The newest card says that friends cannot see the user.
    bool saysHidden() const { return saysHidden_; }
    bool rightToLeft() const;

    /// Lays the conversation out and makes the window as large as it; the height, points.
    double layOut(double width);

  private:
    /// A turn and what it is made of.
    struct Turn {
        std::shared_ptr<TurnView> view;
        Scenario scenario;  ///< its snippet is the newest at the last making
        documents::IsoTime asked;
        bool isAnswered = false;  ///< of a question
    };

    Host() = default;
    std::optional<Failure> remake(const HostSettings& settings, const Environment::Contacts* contacts);
    /// Follows the configuration from then on, and the contacts.
    void followFiles();
    void configurationChanged();
    void remakeOrSay(const HostSettings& settings, const Environment::Contacts* contacts);
    std::optional<Failure> loadPlugin();
    /// Sets a turn's texts, and its card. False when the plugin draws no such answer.
    bool show(Turn& turn);
    TurnTexts textsOf(const Turn& turn) const;
    /// False when the plugin draws no such answer.
    bool addCard(Turn& turn);
    void makeStill(TurnView& turn);
    /// Where pressing leads, without going there.
    std::optional<platform::Url> pageOf(const platform::AccessibilityNode& link) const;
    /// Keeps what the cards know, and lets go of their controllers.
    void letCardsGo();

    HostSettings settings_;
    std::string pluginPath_;
    Environment environment_;
    std::unique_ptr<Plugin> plugin_;
    std::shared_ptr<HostDelegate> delegate_;
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<ConversationView> conversation_;
    std::vector<Turn> turns_;
    /// The newest turn about the user's own sharing. Of those only the newest is live: an earlier one would go on
    /// showing a user who has hidden since.
    std::weak_ptr<TurnView> sharing_;
    bool saysHidden_ = false;
    std::function<void()> remade_;
    std::function<void()> remaking_;
};

}  // namespace ktr::host
