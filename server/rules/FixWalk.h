#pragma once

#include <cstdint>
#include <limits>
#include <optional>
#include <vector>

#include "server/rules/FixRange.h"
#include "server/rules/Visibility.h"

namespace ktr::server {

/// Where a person rested last for two slots, of all slots up to one: what the coarse rule finds when it goes back. It
/// says the same to every viewer whose grant reaches back far enough, and stays true until a fix is heard late. A
/// value.
struct LastRest {
    std::int64_t slot = std::numeric_limits<std::int64_t>::min();  ///< of slots after it nothing is said
    std::int64_t since = 0;  ///< nothing is said of fixes before this time; seconds since 1970
    std::optional<Fix> fix;  ///< the last of the second slot; none: nowhere since `since`
    std::int64_t begin = 0;  ///< the time of the fix at the end of the first slot
};

/// Finds of a person's fixes those by which `Visibility::visible` decides: with them alone it says the same. Below
/// exact precision that is the last of each slot, back to where one stayed for two; not days of fixes. It asks for some
/// at a time, so that those of many people are read together:
///
///     while (const auto questions = walk.questions(); !questions.empty()) { walk.take(…an answer to each…); }
class FixWalk {
  public:
    struct Question {
        FixRange range;
        FixEdge edge = FixEdge::Last;
    };

    /// The sharing's own fixes are not used; it outlives the walk. `known`: what is known of where the owner rested at
    /// this precision, used if it still holds: nothing was heard late since. `heardLate`: when that was last, by the
    /// latest time that the store had seen; seconds since 1970.
    FixWalk(const Sharing& sharing, std::int64_t now, const LastRest& known = {},
            std::int64_t heardLate = std::numeric_limits<std::int64_t>::max());

    /// Empty: nothing more is needed.
    std::vector<Question> questions() const;
    /// One for each of `questions`; none: no such fix.
    void take(const std::vector<std::optional<Fix>>& answers);
    /// By ascending time.
    std::vector<Fix> fixes() const { return {fixes_.rbegin(), fixes_.rend()}; }
    /// At the end: what this walk has found out of where the owner rested; none: nothing beyond the last two slots.
    std::optional<LastRest> found() const;

    /// Whether a fix that comes in now belongs to an earlier slot.
    static bool isLate(const Fix& fix, std::int64_t now);

  private:
    enum class Step { Going, First, Done };

    /// The first fix will decide, as far as is known: it is asked for beside the last ones.
    bool asksForFirstToo() const;
    void takeFirst(const std::optional<Fix>& answer);
    bool isSamePlace(const Fix& one, const Fix& other) const;
    void takeLast(const Fix& fix);
    /// Ends the walk where the rest is known.
    void useKnown();
    void foundRest(const Fix& first, std::int64_t secondSlot, const Fix& second);

    const Sharing& sharing_;
    const std::int64_t length_;      ///< of a slot
    FixRange range_;                 ///< what may count
    std::int64_t sure_ = 0;          ///< from this time on what may count is the same for every viewer
    std::int64_t later_ = 0;         ///< of the slots before this one nothing has been read yet
    std::int64_t horizon_ = 0;       ///< up to this slot nothing changes any more but by what is heard late
    std::int64_t atOnce_ = 2;        ///< so many slots are asked for together
    std::optional<LastRest> known_;  ///< if it still holds
    bool showsKnown_ = false;        ///< it is what this viewer sees; else they see none so far back
    std::optional<LastRest> found_;
    std::vector<Fix> fixes_;  ///< by descending time
    std::vector<Fix> kept_;   ///< what was found before a leap back to where the grant began
    Step step_ = Step::Done;
};

}  // namespace ktr::server
