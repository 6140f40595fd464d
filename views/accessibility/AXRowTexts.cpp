#include "views/accessibility/AXRowTexts.h"

#include <utility>

namespace ktr {

AXRowTexts AXRowTexts::make(std::string name, std::vector<std::string> pieces, bool rightToLeft) {
    return {std::move(name), std::move(pieces), platform::preferredFont(platform::TextStyle::Headline),
            platform::preferredFont(platform::TextStyle::Subheadline), rightToLeft};
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
