#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/base/Api.h"
#include "platform/ui/Color.h"
#include "platform/ui/Font.h"

namespace ktr::platform {

enum class TextAlignment { Natural, Left, Center, Right };

/// Values as the platform's visual language counts them.
enum class LineBreakMode { WordWrapping = 0, TruncatingTail = 4 };

/// Which way a text is set. Natural: the direction of its first strong character, the interface's without one.
enum class WritingDirection { Natural, LeftToRight, RightToLeft };

struct ParagraphStyle {
    TextAlignment alignment = TextAlignment::Natural;
    LineBreakMode lineBreakMode = LineBreakMode::WordWrapping;
    /// Other than Natural each run is set as an isolate: its words cannot turn round what stands beside it.
    WritingDirection writingDirection = WritingDirection::Natural;
    bool operator==(const ParagraphStyle&) const = default;
};

/// UTF-8 text in runs of one style each. A value.
class KTR_API AttributedString {
  public:
    struct Run {
        std::string text;
        Font font;
        /// None: the standard text colour.
        std::optional<Color> color;
        ParagraphStyle paragraph;
        bool operator==(const Run&) const = default;
    };

    AttributedString() = default;
    AttributedString(std::string text, const Font& font) { append({std::move(text), font, std::nullopt, {}}); }

    /// Empty runs are left out.
    void append(Run run) {
        if (!run.text.empty()) {
            runs_.push_back(std::move(run));
        }
    }
    const std::vector<Run>& runs() const { return runs_; }
    bool empty() const { return runs_.empty(); }
    std::string text() const {
        std::string all;
        for (const Run& run : runs_) {
            all += run.text;
        }
        return all;
    }
    bool operator==(const AttributedString&) const = default;

  private:
    std::vector<Run> runs_;
};

}  // namespace ktr::platform
