#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>

#include "server/store/Store.h"

namespace ktr::serve {

/// Whether the friends of the development account's owner can see where that is, which the service's store knows, and
/// where it was when a command last said so, which it does not. Any thread.
class SharingState {
  public:
    struct Position {
        double latitude = 0.0;
        double longitude = 0.0;
        double accuracy = 12.0;  ///< metres
    };
    struct Sharing {
        bool hidden = false;
        std::optional<Position> position;
    };

    /// Whose sharing it is, and with which reader commands come.
    SharingState(std::shared_ptr<server::Store> store, std::int64_t person, std::int64_t reader)
        : store_(std::move(store)), person_(person), reader_(reader) {}

    Sharing now() const;
    /// What the user asked the service for, which has done it.
    void wished(bool hides);
    /// What a command said that the service obeyed. One that hides does not take back the user's wish to share: the
    /// next one that shows, shows. Without a position the one before stays known.
    void commanded(bool hides, const std::optional<Position>& position);

  private:
    const std::shared_ptr<server::Store> store_;
    const std::int64_t person_;
    const std::int64_t reader_;
    mutable std::mutex mutex_;
    std::optional<Position> position_;
    bool wishesToHide_ = false;
};

}  // namespace ktr::serve
