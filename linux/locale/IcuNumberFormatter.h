#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "platform/base/Region.h"

namespace ktr::linux_ {

/// Numbers in a locale's style, by ICU. Main thread.
class IcuNumberFormatter : public platform::NumberFormatter {
  public:
    /// BCP 47; a locale that ICU does not know is written as its nearest known relative.
    explicit IcuNumberFormatter(const std::string& localeIdentifier);
    ~IcuNumberFormatter() override;

    /// Strict: a grouping separator stands where groups end or the text is no number; no blanks around it.
    std::optional<double> numberFromString(const std::string& text) const override;
    std::string plainStringFromInteger(std::int64_t number) const override;

  private:
    struct Formats;
    std::unique_ptr<Formats> formats_;
};

}  // namespace ktr::linux_
