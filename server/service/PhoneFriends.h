#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "server/answers/PhoneAnswer.h"
#include "server/ingest/Report.h"
#include "server/store/Store.h"

namespace ktr::server {

/// What a phone hears of its owner's friends when it posts: who is seen now, and the cards that it does not have yet.
/// The phone of a child, or one that several use, finds its own person among them, with a card that says by whom they
/// are seen. Any thread.
class PhoneFriends {
  public:
    /// Faces of one answer, bytes of pictures: it travels over a mobile network. Further ones come with the next.
    static constexpr std::size_t kMostFaces = std::size_t{128} << 10;
    static constexpr int kMostEvents = 20;  ///< in one answer

    explicit PhoneFriends(Store& store) : store_(store) {}

    /// The body of the answer to a report, sealed when the report was. Notes what the phone was told, and that its
    /// owner looked.
    /// `isToReport`: the phone is told to say where it is now, once.
    std::string answer(const Device& device, const Report& report, std::int64_t now, bool isToReport = false);

  private:
    /// Who came and went, of which this phone has not heard.
    std::vector<FenceEvent> eventsFor(const Device& device, const Report& report, std::int64_t now);
    /// "Ann, seen by Mara, Otto".
    std::string titleOf(const Person& person, std::int64_t now);
    void addOwn(const Device& device, const Report& report, std::int64_t now, std::vector<PhoneFriend>& friends,
                std::map<std::int64_t, SentCard>& told);

    Store& store_;
};

}  // namespace ktr::server
