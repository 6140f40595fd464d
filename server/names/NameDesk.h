#pragma once

#include <condition_variable>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

#include "server/names/PlaceNames.h"

namespace ktr::server {

/// Looks names up on a thread of its own, in the order in which they are asked for: maps are files, and answers to
/// others do not wait for them. Any thread.
class NameDesk {
  public:
    /// In the order of the places asked for. Called once, on the desk's thread, or at once where it is overrun.
    using Told = std::function<void(std::vector<PlaceName>)>;

    /// Who comes when so many places wait to be named is told coordinates.
    static constexpr std::size_t kMostWaiting = 20'000;
    /// How long maps are read for those who ask together; names are coarser after that.
    static constexpr std::chrono::milliseconds kPatience{1500};

    explicit NameDesk(PlaceNames::Setup setup);
    /// Those who still wait are not told.
    ~NameDesk();
    NameDesk(const NameDesk&) = delete;
    NameDesk& operator=(const NameDesk&) = delete;

    void ask(std::vector<PlaceNames::Place> places, ViewerLocale viewer, Told told);
    std::uint64_t streetLookUps() const { return names_.streetLookUps(); }

  private:
    struct Question {
        std::vector<PlaceNames::Place> places;
        ViewerLocale viewer;
        Told told;
        PlaceNames::Clock::time_point until;
    };

    void run();

    PlaceNames names_;
    std::mutex mutex_;
    std::condition_variable wake_;
    std::deque<Question> waiting_;
    std::size_t placesWaiting_ = 0;
    bool isEnding_ = false;
    std::thread thread_;
};

}  // namespace ktr::server
