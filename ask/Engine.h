#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "ask/Asking.h"
#include "ask/Languages.h"
#include "ask/People.h"
#include "ask/Ports.h"
#include "ask/Question.h"
#include "ask/WhereAnswers.h"

namespace ktr::ask {

/// Answers questions: understands them here, by templates and contacts, asks the service what only that knows, and says it in
/// one honest sentence. The same question gets the same answer wherever it is asked. Main thread.
class Engine {
  public:
    using Completion = std::function<void(Answer)>;

    /// Of the handles of one request.
    static constexpr std::size_t kMostHandles = 1000;

    /// The service outlives this, and what it was asked.
    Engine(std::shared_ptr<Languages> languages, ServicePort& service, World world);

    /// Whom the user knows. Whoever answers aloud to everybody gives only those who may be said aloud.
    void setPeople(std::vector<Person> people) { people_ = std::make_shared<const People>(std::move(people)); }
    const std::shared_ptr<const People>& people() const { return people_; }

    /// Calls the completion exactly once, perhaps inside the call.
    void ask(const Question& question, const Completion& completion);
    /// The answer as far as it needs no service: not understood, unknown, ambiguous, locked, refused. None: the service has
    /// to be asked.
    std::optional<Answer> answerHere(const Question& question);
    /// The same, or what the question says where the service has to be asked. What it points to is of `people`.
    std::variant<Answer, Understood> readHere(const Question& question);
    /// "Where is Ann?" in a language (BCP 47); empty where the languages cannot be read.
    std::string whereIs(const std::string& name, const std::string& language) const;

  private:
    using Shared = std::shared_ptr<const Asking>;

    /// An answer, or what to go on with.
    std::variant<Answer, Shared> begun(const Question& question);
    void read(const Shared& asking, const Completion& completion);
    void readPlaces(const Shared& asking, std::vector<Sight> sights, platform::Dictionary answer, const Completion& completion);
    void wish(const Shared& asking, const Completion& completion);
    /// Asks for the handles from `from` on, as many requests as it takes, then goes on with all entries in one answer.
    void gather(const Shared& asking, std::shared_ptr<const std::vector<std::string>> handles, std::size_t from,
                platform::Dictionary gathered, const std::function<void(ServiceReply)>& then);

    std::shared_ptr<Languages> languages_;
    ServicePort& service_;
    World world_;
    std::shared_ptr<const People> people_;
};

}  // namespace ktr::ask
