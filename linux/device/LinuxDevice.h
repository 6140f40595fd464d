#pragma once

#include <optional>
#include <string_view>

#include "platform/ui/Device.h"

namespace ktr::linux_ {

/// The device as the host sees it: nothing is asked of the system here, the host sets what it knows. Main thread.
class LinuxDevice final : public platform::Device {
  public:
    std::optional<platform::UserInterfaceIdiom> userInterfaceIdiom() const override { return idiom_; }
    double mainScreenScale() const override { return scale_; }
    platform::ContentSizeCategory contentSizeCategory() const override { return category_; }

    void setUserInterfaceIdiom(std::optional<platform::UserInterfaceIdiom> idiom) { idiom_ = idiom; }
    /// Pixels a point; what is not a positive finite number is ignored.
    void setMainScreenScale(double scale);
    void setContentSizeCategory(platform::ContentSizeCategory category) { category_ = category; }

    /// The category for the system's text scale (1 is its default); L for what is no number.
    static platform::ContentSizeCategory categoryForTextScale(double scale);
    /// Of "XS" to "XXXL" and "AX1" to "AX5", in any case of letters; none for another text.
    static std::optional<platform::ContentSizeCategory> categoryNamed(std::string_view name);
    static std::string_view nameOf(platform::ContentSizeCategory category);
    /// Of "phone", "tablet", "desktop" and "display"; none for another text.
    static std::optional<platform::UserInterfaceIdiom> idiomNamed(std::string_view name);
    static std::string_view nameOf(platform::UserInterfaceIdiom idiom);

  private:
    std::optional<platform::UserInterfaceIdiom> idiom_ = platform::UserInterfaceIdiom::Phone;
    double scale_ = 1.0;
    platform::ContentSizeCategory category_ = platform::ContentSizeCategory::L;
};

}  // namespace ktr::linux_
