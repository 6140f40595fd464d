#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "serve/ServedFriend.h"
#include "server/http/HttpRequest.h"
#include "server/store/Store.h"

namespace ktr::serve {

/// The people of a friends file as people of a service of one's own that is kept in memory. Each has a phone, and
/// shares exactly with the account's owner, who has a reader. Where the file gives a handle to several, the first one
/// has it. Any thread.
class MadeUpPeople {
  public:
    /// The owner's name there is the account's person identifier; the reader's secret is its token.
    MadeUpPeople(const FriendsFile& file, const std::string& personId, const std::string& token, std::int64_t now);

    /// Empty, or why there are none.
    const std::string& complaint() const { return complaint_; }
    const std::shared_ptr<server::Store>& store() const { return store_; }
    std::int64_t owner() const { return owner_; }
    std::int64_t reader() const { return reader_; }
    /// The file's friend of this number.
    std::int64_t friendAt(std::size_t number) const { return friends_.at(number); }

    /// Hides the file's friend of this number, or shows them again; nothing where it is so already.
    void setHidden(std::size_t number, bool hidden, std::int64_t now) const;
    /// What the phone of the file's friend of this number sends from a place, as it reaches the service.
    server::HttpRequest post(std::size_t number, const Waypoint& place, std::int64_t now) const;

  private:
    /// What the track calls its places, as the person would have named them: fences and answers find them.
    bool namePlaces(std::int64_t person, const ServedFriend& of);
    bool add(const std::string& name, const ServedFriend& person, std::int64_t now);
    bool make(const FriendsFile& file, const std::string& personId, const std::string& token, std::int64_t now);

    std::shared_ptr<server::Store> store_;
    std::string complaint_;
    std::vector<std::string> secrets_;   ///< of the phones, in the file's order
    std::vector<std::int64_t> friends_;  ///< as the store knows them, in the same order
    std::int64_t owner_ = 0;
    std::int64_t reader_ = 0;
};

}  // namespace ktr::serve
