#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "platform/base/MainLoop.h"
#include "platform/ui/AccessibilitySubject.h"

namespace ktr::host {

/// What is said by itself to somebody who listens: that an answer has come, that a friend is at another place, cannot
/// be seen any more or can be again, and that the service is out of reach or back. What happens within two seconds is
/// said together, at most every ten seconds; what has become undone by then is not said, and nothing is while nobody
/// listens. Main thread.
class Announcements {
  public:
    /// After so many seconds what happened is said.
    static constexpr double kCollect = 2.0;
    /// So many seconds are between two announcements.
    static constexpr double kQuiet = 10.0;
    /// More who come to a card at once are counted, and not named.
    static constexpr std::size_t kMostNamed = 3;

    struct Card {
        const void* identity = nullptr;  ///< over its updates
        std::vector<platform::AccessibilitySubject> people;
    };
    /// How things stand.
    struct State {
        bool listening = false;  ///< the window is the one that is used
        bool reachable = true;   ///< the service
        std::vector<Card> cards;
    };
    /// A text of the host by its key, and a number as the language writes it.
    struct Words {
        std::function<std::string(const std::string& key)> text;
        std::function<std::string(std::size_t number)> number;
    };

    /// `look` is asked how things stand shortly before `say` says something.
    Announcements(std::shared_ptr<platform::MainLoop> mainLoop, Words words, std::function<State()> look,
                  std::function<void(const std::string&)> say);
    ~Announcements();
    Announcements(const Announcements&) = delete;
    Announcements& operator=(const Announcements&) = delete;

    /// An answer has come, with this sentence (which may be empty) and so many people on its card.
    void answerCame(const std::string& sentence, std::size_t people);
    /// Something may have changed.
    void changed();

  private:
    using Sentences = std::vector<std::string>;
    /// Who was on a card at any time, and how they were said to be; one who has left is not known any more.
    using People = std::unordered_map<std::string, platform::AccessibilitySubject>;

    void wait(double seconds);
    void waitIsOver();
    void announce();
    Sentences news(const State& state);
    void compare(const Card& card, People& told, Sentences& sentences) const;
    /// Empty for what is no news.
    std::string changeOf(const platform::AccessibilitySubject& before, const platform::AccessibilitySubject& now) const;
    std::string sentence(const char* key, const platform::AccessibilitySubject& about) const;
    std::string peopleText(std::size_t people) const;
    void add(std::string& message, const std::string& sentence) const;

    std::shared_ptr<platform::MainLoop> mainLoop_;
    Words words_;
    std::function<State()> look_;
    std::function<void(const std::string&)> say_;
    std::vector<std::pair<std::string, std::size_t>> answers_;
    /// What was said, or would have been had anybody listened.
    std::unordered_map<const void*, People> toldOf_;
    bool toldReachable_ = true;
    std::shared_ptr<platform::Timer> timer_;
    bool quiet_ = false;    ///< something was said a short while ago
    bool pending_ = false;  ///< something may have changed since
};

}  // namespace ktr::host
