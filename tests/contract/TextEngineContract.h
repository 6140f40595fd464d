#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/text/TextEngine.h"

namespace ktr::test {

/// Makes the engine that is tested, and names it.
struct TextEngineCase {
    std::string name;
    std::function<std::shared_ptr<platform::TextEngine>()> make;
};

/// What every text engine promises. Instantiated for the double and for each real one.
class TextEngineContract : public ::testing::TestWithParam<TextEngineCase> {
  protected:
    using Layout = std::shared_ptr<const platform::TextLayout>;

    static platform::Font body() { return {platform::FontFace::Text, platform::FontWeight::Regular, 16.0}; }
    static platform::Font headline() { return {platform::FontFace::Text, platform::FontWeight::Bold, 20.0}; }
    static platform::TextContainer oneLine(double width) {
        platform::TextContainer container;
        container.width = width;
        container.maximumLines = 1;
        container.lineBreakMode = platform::LineBreakMode::TruncatingTail;
        return container;
    }
    static platform::TextContainer wrapped(double width) {
        platform::TextContainer container;
        container.width = width;
        return container;
    }
    Layout layOut(const std::string& text, const platform::TextContainer& container) {
        return engine_->layOut(platform::AttributedString(text, body()), container);
    }
    double naturalWidth(const std::string& text) { return layOut(text, {}).get()->usedSize().width; }

    std::shared_ptr<platform::TextEngine> engine_ = GetParam().make();
};

inline std::string nameOfCase(const ::testing::TestParamInfo<TextEngineCase>& info) {
    return info.param.name;
}

}  // namespace ktr::test
