#pragma once

#include <memory>
#include <vector>

#include "bench/Scene.h"
#include "linux/paint/Palette.h"
#include "platform/base/Platform.h"
#include "platform/ui/StackView.h"
#include "platform/ui/Window.h"
#include "views/KTRVelaFriendView.h"

namespace ktr::bench {

/// The multiple-locations rows as the plugin builds them, their texts set from the file: views created, texts set, laid
/// out. Records, contact lookups and avatars are measured apart; an initials disc stands for the avatar's pixels.
class KtrScene : public Scene {
  public:
    KtrScene();
    ~KtrScene() override;
    void build(const RowsFile& file, std::size_t count, double width) override;
    void updateAll(bool next) override;
    void updateOne(std::size_t row, bool next) override;
    void resize(double width) override;
    double height() const override;
    void paint(QImage& image, double scale) override;
    void clear() override;
    void shapeName(const std::string& name) override;
    bool write(const QString& path, double scale) override;

  private:
    void installPlatform();
    void setTexts(std::size_t row, const RowTexts& texts);
    void layOut();

    const RowsFile* file_ = nullptr;
    double width_ = 0.0;
    std::shared_ptr<platform::Platform> platform_;
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<platform::StackView> stack_;
    std::vector<std::shared_ptr<KTRVelaFriendView>> rows_;
    linux_::Palette palette_;
};

}  // namespace ktr::bench
