#pragma once

#include <QString>
#include <vector>

#include "platform/ui/AttributedString.h"

namespace ktr::linux_ {

/// An attributed text as the shaper takes it: UTF-16, without anything that could harm the line. Malformed UTF-8,
/// control characters and object marks are shown as U+FFFD, a tab as a space, every kind of line end is U+2028; line
/// ends at the very end are dropped. Bidirectional controls that a run leaves open are closed at its end, so that a
/// name cannot turn round what stands beside it. A value.
struct PreparedText {
    struct Run {
        qsizetype start = 0;
        qsizetype length = 0;
        platform::Font font;
        std::optional<platform::Color> color;
        platform::ParagraphStyle paragraph;
    };

    explicit PreparedText(const platform::AttributedString& source);

    /// The run that a position belongs to; the last one at the text's end. The text must not be empty.
    const Run& runAt(qsizetype position) const;
    /// The direction of the first strong character in [from, to) outside isolates, or the given one without any.
    bool isRightToLeft(qsizetype from, qsizetype to, bool otherwise) const;

    QString text;
    std::vector<Run> runs;
};

}  // namespace ktr::linux_
