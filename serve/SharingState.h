#pragma once

#include <mutex>
#include <optional>

namespace ktr::serve {

/// Whether the friends of the development account's owner can see where that is, and where it was when a command last
/// said so. Kept while the service runs. Any thread.
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

    Sharing now() const;
    /// What the user asked for.
    void wish(bool hidden);
    /// What a command says. One that shows may be an older answer that repeats itself, and does not undo a wish to be
    /// hidden. Without a position the one before stays known.
    void command(bool hidden, const std::optional<Position>& position);

  private:
    mutable std::mutex mutex_;
    Sharing sharing_;
    bool wishesToHide_ = false;
};

}  // namespace ktr::serve
