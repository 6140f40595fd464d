#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <string>

#include "platform/assistant/Localization.h"

namespace ktr::test {

/// The texts that the suite asks for: language -> key -> text, all in the bundle "org.example" and its default table.
using LocalizationTexts = std::map<std::string, std::map<std::string, std::string>>;

struct LocalizationCase {
    std::string name;
    /// A localization in German over these texts.
    std::function<std::shared_ptr<platform::Localization>(const LocalizationTexts& texts)> make;
};

class LocalizationContract : public ::testing::TestWithParam<LocalizationCase> {
  protected:
    static constexpr const char* kBundle = "org.example";
    void SetUp() override {
        localization =
            GetParam().make({{"en", {{"BOTH", "Both"}, {"ENGLISH", "English only"}, {"_$!<home>!$_", "Home"}}},
                             {"de", {{"BOTH", "Beides"}, {"GERMAN", "Nur deutsch"}}}});
    }
    std::shared_ptr<platform::Localization> localization;
};

}  // namespace ktr::test
