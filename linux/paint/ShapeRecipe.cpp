#include "linux/paint/ShapeRecipe.h"

#include <QTextOption>

namespace ktr::linux_ {

std::unique_ptr<QTextLayout> ShapeRecipe::layout() const {
    auto made = std::make_unique<QTextLayout>(text, font.font());
    QTextOption option;
    const auto wrapped = wrapAnywhere ? QTextOption::WrapAnywhere : QTextOption::WrapAtWordBoundaryOrAnywhere;
    option.setWrapMode(wrap ? wrapped : QTextOption::NoWrap);
    option.setTextDirection(direction);
    option.setAlignment(Qt::AlignLeft | Qt::AlignAbsolute);
    made->setTextOption(option);
    QList<QTextLayout::FormatRange> formats;
    for (const Range& range : ranges) {
        QTextLayout::FormatRange format;
        format.start = static_cast<int>(range.start);
        format.length = static_cast<int>(range.length);
        format.format = range.font.format();
        formats.append(format);
    }
    if (!formats.isEmpty()) {
        made->setFormats(formats);
    }
    // Without it every drawing would shape again.
    made->setCacheEnabled(true);
    return made;
}

std::unique_ptr<QTextLayout> ShapeRecipe::layout(const std::vector<Line>& lines) const {
    auto made = layout();
    made->beginLayout();
    for (const Line& line : lines) {
        QTextLine broken = made->createLine();
        if (!broken.isValid()) {
            break;
        }
        broken.setLineWidth(line.width);
        broken.setPosition(line.position);
    }
    made->endLayout();
    return made;
}

}  // namespace ktr::linux_
