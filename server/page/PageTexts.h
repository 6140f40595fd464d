#pragma once

#include <string_view>
#include <vector>

namespace ktr::server {

/// The texts of the people's page in every language: made at build time from resources/localization/page_*.ts
/// (docs/translating.md). Any thread.
class PageTexts {
  public:
    /// A text as its translators wrote it; English where the language lacks it. The key itself when there is none.
    static std::string_view find(std::string_view language, std::string_view key);
    /// BCP 47, as the files are named; English first.
    static const std::vector<std::string_view>& languages();
};

}  // namespace ktr::server
