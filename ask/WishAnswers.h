#pragma once

#include <string>
#include <vector>

#include "ask/Asking.h"
#include "platform/base/Value.h"

namespace ktr::ask {

/// Answers to wishes, from what the service says it did: nothing is promised that it did not confirm. Any thread.
class WishAnswers {
  public:
    explicit WishAnswers(const Asking& asking) : asking_(asking), sentences_(asking.sentences()) {}

    /// What cannot be asked of the service as it was said; none: `request` can be sent.
    std::optional<Answer> impossible() const;
    /// The command and its members, one POST.
    std::pair<std::string, platform::Dictionary> request() const;
    /// The request was honoured, with this answer.
    Answer done(const platform::Dictionary& answer) const;
    /// The service understood, and did not.
    Answer refused() const;

  private:
    Answer sharing(const platform::Dictionary& answer) const;
    Answer fence(const platform::Dictionary& answer) const;
    std::string names() const;
    bool isFence() const;

    const Asking& asking_;
    const Sentences sentences_;
};

}  // namespace ktr::ask
