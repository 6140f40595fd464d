#pragma once

#include <memory>
#include <optional>

#include "platform/contacts/MonogramMaker.h"

namespace ktr::linux_ {

/// See platform::MonogramMaker. Letters are always bold Noto Sans; of a font only the size counts. Main thread, while a
/// QGuiApplication exists.
class QtMonogramMaker final : public platform::MonogramMaker {
  public:
    explicit QtMonogramMaker(double diameter) : diameter_(diameter) {}

    void setFont(const platform::Font& font) override { font_ = font; }
    std::shared_ptr<platform::MonogramMaker> makerTintedWith(const std::optional<platform::Color>& color) override;
    std::shared_ptr<platform::Image> monogramForContact(const platform::Contact& contact) override;

  private:
    double diameter_;
    std::optional<platform::Font> font_;
    std::optional<platform::Color> tint_;
};

}  // namespace ktr::linux_
