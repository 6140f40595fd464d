#pragma once

#include <memory>
#include <vector>

#include "linux/maps/MainlandArea.h"
#include "linux/maps/MapGround.h"
#include "platform/base/MainLoop.h"

namespace ktr::linux_ {

/// Draws maps on the main loop's background workers, one picture at a time in the order of asking, and keeps the latest
/// ones. Equal requests share one drawing. Main thread, while a QGuiApplication exists.
class ThreadedMapSource final : public platform::MapPictureSource {
  public:
    using Grounds = std::vector<std::shared_ptr<MapGround>>;

    /// Each ground fills in what those before it left; what the last one leaves shows plain land. `gcj02`: where their
    /// data is in that datum; none for nowhere.
    ThreadedMapSource(std::shared_ptr<platform::MainLoop> mainLoop, Grounds grounds,
                      std::shared_ptr<const MainlandArea> gcj02 = nullptr);
    ~ThreadedMapSource() override;

    int requestPicture(const platform::MapPictureRequest& request, Completion completion) override;
    void cancel(int request) override;
    std::shared_ptr<void> observeChanges(std::function<void()> changed) override;
    bool isInGcj02(const platform::Coordinate& coordinate) const override {
        return gcj02_ && gcj02_->contains(coordinate);
    }

    /// Pictures have so many times the pixels a point that they are asked for: where they are not shown on a screen,
    /// but printed or enlarged.
    void setDensity(double density) { density_ = density; }
    /// Draws from these from now on, and tells the observers. Drawings under way are made anew.
    void setGrounds(Grounds grounds);

  private:
    class Core;
    std::shared_ptr<Core> core_;
    std::shared_ptr<const MainlandArea> gcj02_;
    double density_ = 1.0;
};

}  // namespace ktr::linux_
