#include "views/accessibility/AXRowTexts.h"

#include <utility>

namespace ktr {

AXRowTexts AXRowTexts::make(std::string name, std::vector<std::string> pieces, bool rightToLeft) {
    return {std::move(name), std::move(pieces), platform::preferredFont(platform::TextStyle::Headline),
            platform::preferredFont(platform::TextStyle::Subheadline), rightToLeft};
}

std::string AXRowTexts::spoken(const std::vector<std::string>& parts) {
    std::string line;
    for (const std::string& part : parts) {
        if (!part.empty()) {
            line += (line.empty() ? "" : ", ") + part;
        }
    }
    return line;
}

platform::AttributedString AXRowTexts::composed() const {
    using platform::TextAlignment;
    using platform::WritingDirection;
    const platform::ParagraphStyle paragraph = {
        rightToLeft ? TextAlignment::Right : TextAlignment::Left, platform::LineBreakMode::WordWrapping,
        rightToLeft ? WritingDirection::RightToLeft : WritingDirection::LeftToRight};
    platform::AttributedString text;
    text.append({name, headline, std::nullopt, paragraph});
    text.append({"\n", headline, std::nullopt, paragraph});
    for (const std::string& piece : pieces) {
        text.append({piece, subheadline, std::nullopt, paragraph});
    }
    return text;
}

}  // namespace ktr
