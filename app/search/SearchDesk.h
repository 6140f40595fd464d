#pragma once

#include <QTimer>
#include <chrono>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/search/NameIndex.h"
#include "ask/Answer.h"
#include "host/Host.h"
#include "host/asking/QuestionDesk.h"

namespace ktr::app {

/// What the desktop's search finds. Whatever is typed is read here, by contacts and templates; the service is asked
/// only for a whole name, or a question that names somebody, and only once nothing was typed for a while. Its answer is
/// kept for the next time that the same is searched. Nothing is ever changed. Main thread.
class SearchDesk : public QObject {
  public:
    /// So long nothing is typed before anything is asked, milliseconds.
    static constexpr int kRest = 400;
    static constexpr std::size_t kMost = 10;  ///< results
    /// So long an answer is kept, and so long none newer is asked for.
    static constexpr std::chrono::seconds kKept{120};
    static constexpr std::chrono::seconds kFresh{10};

    struct Result {
        std::string id;
        std::string title;
        std::string description;  ///< empty for none
        bool isWhole = false;
        bool isAnswer = false;  ///< the description answers
    };

    /// `isOpen`: whether only the user is looking. The host is a live one and outlives this.
    SearchDesk(host::Host& host, std::function<bool()> isOpen);

    /// Of what was typed; none while it is locked. Waits for nothing.
    std::vector<Result> results(const std::string& text);
    /// One of them by its id, whoever gave it out; one without a title for what is none, and while it is locked.
    Result result(const std::string& id);
    /// What opens the window on a result: words of the command line; none for nothing.
    std::vector<std::string> opening(const std::string& id);
    /// The window on what was typed.
    std::vector<std::string> openingOf(const std::string& text);

    /// The account was read, as far as it can be: the service may be asked.
    void setReady();
    /// Whether an answer is under way.
    bool isBusy() const { return isAsking_; }
    /// Nobody searches any more, or somebody else may be looking.
    void forget();

  private:
    using Clock = std::chrono::steady_clock;
    struct Kept {
        std::string sentence;
        std::size_t number = 0;  ///< a newer answer is another result
        Clock::time_point since;
    };

    bool mayShow() const;
    const NameIndex& names();
    const Kept* kept(const std::string& key) const;
    Result resultOf(const ask::Person& person, bool isWhole);
    Result resultOf(const std::string& question, const std::string& sentence);
    std::string questionAbout(const ask::Person& person);
    ask::Question read(const std::string& text) const;
    void plan(const std::string& key);
    void rest();
    void take(const std::string& key, const ask::Answer& answer);

    host::Host& host_;
    const std::function<bool()> isOpen_;
    host::QuestionDesk desk_;
    std::unique_ptr<NameIndex> names_;
    std::map<std::string, Kept> kept_;
    std::size_t answers_ = 0;
    QTimer rest_;
    std::string planned_;  ///< the key of what is asked when the typing rests
    bool isReady_ = false;
    bool isAsking_ = false;
};

}  // namespace ktr::app
