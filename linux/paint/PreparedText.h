#pragma once

#include <QString>
#include <vector>

#include "platform/text/TextEngine.h"
#include "platform/ui/AttributedString.h"

namespace ktr::linux_ {

/// An attributed text as the shaper takes it: UTF-16, without anything that could harm the line. Malformed UTF-8,
/// control characters and object marks are shown as U+FFFD, a tab as a space, every kind of line end is U+2028.
/// Bidirectional controls that a run leaves open are closed at its end, so that a name cannot turn round what stands
/// beside it; where the direction is given, each run with words in it is an isolate. A value.
struct PreparedText {
    struct Run {
        qsizetype start = 0;
        qsizetype length = 0;
        platform::Font font;
        std::optional<platform::Color> color;
        platform::ParagraphStyle paragraph;
    };

    /// What the container's limits change: without one on the lines, line ends at the very end count; without
    /// hyphenation soft hyphens are left out; on a single line no phrase needs holding together.
    struct Options {
        bool keepsLineEnds = false;
        bool keepsSoftHyphens = true;
        bool joinsPhrases = true;
        static Options of(const platform::TextContainer& container) {
            return {container.maximumLines <= 0, container.hyphenationFactor > 0.0, container.maximumLines != 1};
        }
    };

    PreparedText(const platform::AttributedString& source, Options options);

    /// The run that a position belongs to; the last one at the text's end. The text must not be empty.
    const Run& runAt(qsizetype position) const;
    /// The direction of the first strong character in [from, to) outside isolates, or the given one without any.
    bool isRightToLeft(qsizetype from, qsizetype to, bool otherwise) const;
    /// The ellipsis for a text that is cut to [from, end), with what takes it to the side where its last letters end.
    QString ellipsisAfter(qsizetype from, qsizetype end) const;

    QString text;
    std::vector<Run> runs;
};

}  // namespace ktr::linux_
