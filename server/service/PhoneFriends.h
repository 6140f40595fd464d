#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "server/ingest/Report.h"
#include "server/store/Store.h"

namespace ktr::server {

/// What a phone hears of its owner's friends when it posts: who is seen now, and the cards that it does not have yet.
/// Any thread.
class PhoneFriends {
  public:
    /// Faces of one answer, bytes of pictures: it travels over a mobile network. Further ones come with the next.
    static constexpr std::size_t kMostFaces = std::size_t{128} << 10;

    explicit PhoneFriends(Store& store) : store_(store) {}

    /// The body of the answer to a report, sealed when the report was. Notes what the phone was told, and that its
    /// owner looked.
    std::string answer(const Device& device, const Report& report, std::int64_t now);

  private:
    Store& store_;
};

}  // namespace ktr::server
