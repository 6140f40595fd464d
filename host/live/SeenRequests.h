#pragma once

#include <functional>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/base/MainLoop.h"
#include "platform/client/HttpTransport.h"

namespace ktr::host {

/// What nobody sees does not ask. Hands commands on as long as somebody sees the cards. While nobody does, of the
/// questions where friends are (`getlocations`) the newest of each card waits until somebody does, and answers the
/// card's earlier ones with its own answer; a command that shows the user to friends ends with `Cancelled` at once: it
/// must not leave later, when the user may have thought better of it. Cards are told nothing of all this.
///
/// Under a page that covers them, cards ask nothing either, but the page may. Sharing goes on: its user is there.
///
/// Texts of an answer are cut where they come in, so that no row gets a megabyte (`withShortTexts`).
///
/// Two questions that differ only in times are one on the wire while the first is under way: a card starts twice and so
/// asks twice. Main thread, but for completions.
class SeenRequests : public platform::HttpTransport {
  public:
    /// The loop outlives what is sent.
    SeenRequests(std::shared_ptr<platform::HttpTransport> next, std::shared_ptr<platform::MainLoop> mainLoop);
    /// What waits ends with `Cancelled`.
    ~SeenRequests() override;

    /// Whether somebody sees the cards; so it is at first. What waited is sent, the earliest card's first.
    void setSeen(bool seen);
    bool isSeen() const { return isSeen_; }
    /// Whether a page's question is about these friends' handles, and so is not a card's.
    using IsThePages = std::function<bool(const std::vector<std::string>& handles)>;
    /// A page covers the cards; none: no more, and what waited is sent. The page is asked at each question.
    void setCover(IsThePages cover);
    /// Ends what waits, with `Cancelled`. What is under way is for those below to end.
    void cancelHeld();
    /// Of how many cards a question waits.
    std::size_t held() const { return held_.size(); }

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    /// A request on the wire, and who wants its answer.
    struct Asking;
    struct Held {
        std::string card;
        platform::HttpRequest request;
        std::vector<Completion> completions;
    };

    /// What two questions have in common. Another card has another `card`; a card that asks from elsewhere, or with
    /// other credentials, another `question`.
    struct Keys {
        std::string card;
        std::string question;
    };
    static Keys keysOf(const platform::HttpRequest& request);

    void ask(const platform::HttpRequest& request, const std::string& question, std::vector<Completion> completions);
    bool mustWait(const platform::HttpRequest& request) const;
    void sendHeld();
    void refuse(std::vector<Completion> completions);

    std::shared_ptr<platform::HttpTransport> next_;
    std::shared_ptr<platform::MainLoop> mainLoop_;
    bool isSeen_ = true;
    IsThePages cover_;
    std::vector<Held> held_;
    std::unordered_map<std::string, std::weak_ptr<Asking>> underWay_;
};

}  // namespace ktr::host
