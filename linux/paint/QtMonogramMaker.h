#pragma once

#include <memory>
#include <optional>
#include <utility>

#include "linux/paint/QtAvatarImages.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::linux_ {

/// See platform::MonogramMaker. A contact's photo goes before its letters, so that a pin has the row's face. Letters
/// are always bold Noto Sans; of a font only the size counts. Main thread, while a QGuiApplication exists.
class QtMonogramMaker final : public platform::MonogramMaker {
  public:
    /// `faces` keeps the photos.
    QtMonogramMaker(double diameter, std::shared_ptr<QtAvatarImages> faces)
        : diameter_(diameter), faces_(std::move(faces)) {}

    void setFont(const platform::Font& font) override { font_ = font; }
    std::shared_ptr<platform::MonogramMaker> makerTintedWith(const std::optional<platform::Color>& color) override;
    std::shared_ptr<platform::Image> monogramForContact(const platform::Contact& contact) override;

  private:
    double diameter_;
    std::shared_ptr<QtAvatarImages> faces_;
    std::optional<platform::Font> font_;
    std::optional<platform::Color> tint_;
};

}  // namespace ktr::linux_
