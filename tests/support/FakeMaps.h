#pragma once

#include <map>
#include <memory>
#include <utility>
#include <vector>

#include "platform/base/MainLoop.h"
#include "platform/map/MapPictureSource.h"
#include "tests/support/Doubles.h"

namespace ktr::test {

/// Answers with blank pictures, on the next turn of the main loop.
class FakeMaps : public platform::MapPictureSource {
  public:
    explicit FakeMaps(std::shared_ptr<platform::MainLoop> mainLoop) : mainLoop_(std::move(mainLoop)) {}

    int requestPicture(const platform::MapPictureRequest& request, Completion completion) override {
        const int id = ++last_;
        requests.push_back(request);
        waiting_->emplace(id, std::make_pair(request, std::move(completion)));
        mainLoop_->post([waiting = std::weak_ptr(waiting_), id] {
            const auto all = waiting.lock();
            const auto found = all ? all->find(id) : Waiting::iterator();
            if (!all || found == all->end()) {
                return;
            }
            const auto [asked, answer] = found->second;
            all->erase(found);
            platform::MapPicture picture;
            picture.viewport = asked.viewport;
            picture.image = std::make_shared<Blank>(asked.viewport.size);
            picture.attribution = "© Nobody";
            answer(picture);
        });
        return id;
    }
    void cancel(int request) override { waiting_->erase(request); }
    std::shared_ptr<void> observeChanges(std::function<void()> changed) override {
        auto observer = std::make_shared<std::function<void()>>(std::move(changed));
        observers_.push_back(observer);
        return observer;
    }

    /// As when a tile has arrived.
    void change() {
        for (const auto& weak : std::vector(observers_)) {
            if (const auto observer = weak.lock()) {
                (*observer)();
            }
        }
    }

    std::vector<platform::MapPictureRequest> requests;

  private:
    using Waiting = std::map<int, std::pair<platform::MapPictureRequest, Completion>>;
    class Blank : public platform::Image {
      public:
        explicit Blank(platform::Size size) : size_(size) {}
        platform::Size size() const override { return size_; }

      private:
        platform::Size size_;
    };

    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<Waiting> waiting_ = std::make_shared<Waiting>();
    std::vector<std::weak_ptr<std::function<void()>>> observers_;
    int last_ = 0;
};

}  // namespace ktr::test
