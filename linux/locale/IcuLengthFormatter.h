#pragma once

#include <string>

#include "platform/base/LengthFormatter.h"

namespace ktr::linux_ {

/// Lengths by ICU number skeletons (UTS 35, part 3). Main thread.
class IcuLengthFormatter final : public platform::LengthFormatter {
  public:
    /// The words are of the language, the digits too; both may be of the form "de-CH".
    IcuLengthFormatter(std::string language, platform::LengthSystem system);

    platform::LengthSystem system() const override { return system_; }
    std::string text(double amount, platform::LengthUnit unit, platform::LengthWidth width) const override;

  private:
    std::string language_;
    platform::LengthSystem system_;
};

}  // namespace ktr::linux_
