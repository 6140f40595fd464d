#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "ask/Asking.h"
#include "ask/Languages.h"
#include "ask/People.h"
#include "ask/Ports.h"
#include "ask/Question.h"
#include "ask/WhereAnswers.h"

namespace ktr::ask {

/// Answers questions: understands them here, by templates and contacts, asks the service what only that knows, and says
/// it in one honest sentence. The same question gets the same answer wherever it is asked. Main thread.
class Engine {
  public:
    using Completion = std::function<void(Answer)>;
    using Meant = std::function<void(const Meaning&)>;

    /// Of the handles of one request.
    static constexpr std::size_t kMostHandles = 1000;

    /// The service outlives this, and what it was asked.
    Engine(std::shared_ptr<Languages> languages, ServicePort& service, World world);

    /// Whom the user knows. Whoever answers aloud to everybody gives only those who may be said aloud.
    void setPeople(std::vector<Person> people) { crowd_ = std::make_shared<Crowd>(std::move(people)); }
    std::shared_ptr<const People> people() const { return crowd_->people(); }

    /// Calls the completion exactly once, perhaps inside the call, and not after this is gone. Languages are read,
    /// people sorted and the question understood elsewhere, where the world has an elsewhere. `understood` hears what
    /// the service is asked for, just before it is.
    void ask(const Question& question, const Completion& completion, const Meant& understood = nullptr);
    /// The answer as far as it needs no service: not understood, unknown, ambiguous, locked, refused. None: the service
    /// has to be asked.
    std::optional<Answer> answerHere(const Question& question);
    /// The same, or what the question says where the service has to be asked. What it points to is of `people`.
    std::variant<Answer, Understood> readHere(const Question& question);
    /// "Where is Ann?" in a language (BCP 47); empty where the languages cannot be read.
    std::string whereIs(const std::string& name, const std::string& language) const;

  private:
    using Shared = std::shared_ptr<const Asking>;
    /// An answer, or what to go on with.
    using Begun = std::variant<Answer, Shared>;

    /// People, who are sorted where they are first asked for. Any thread.
    class Crowd {
      public:
        explicit Crowd(std::vector<Person> people) : listed_(std::move(people)) {}
        std::shared_ptr<const People> people();

      private:
        std::once_flag once_;
        std::vector<Person> listed_;
        std::shared_ptr<const People> people_;
    };

    /// Any thread.
    static Begun begun(const Question& question, Languages& languages, Crowd& crowd, const World& world, bool isLocked);
    void goOn(Begun begun, const Completion& completion, const Meant& understood);
    bool isLocked() const { return world_.isLocked && world_.isLocked(); }
    void read(const Shared& asking, const Completion& completion);
    void readPlaces(const Shared& asking, std::vector<Sight> sights, platform::Dictionary answer,
                    const Completion& completion);
    void wish(const Shared& asking, const Completion& completion);
    /// Asks for the handles from `from` on, as many requests as it takes, then goes on with all entries in one answer.
    void gather(const Shared& asking, const std::shared_ptr<const std::vector<std::string>>& handles, std::size_t from,
                const platform::Dictionary& gathered, const std::function<void(ServiceReply)>& then);

    std::shared_ptr<Languages> languages_;
    ServicePort& service_;
    World world_;
    std::shared_ptr<Crowd> crowd_;
    std::shared_ptr<bool> alive_ = std::make_shared<bool>(true);
};

}  // namespace ktr::ask
