#include "linux/paint/PlacedGlyphs.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QPainter>
#include <algorithm>
#include <bit>

namespace ktr::linux_ {

namespace {

/// Qt makes a new object of the same font for each run that it hands out: one serves for all. The main thread's, until
/// the application ends.
QRawFont sharedFont(const QRawFont& font) {
    constexpr std::size_t kMost = 64;
    static std::vector<QRawFont> known = [] {
        qAddPostRoutine([] { known.clear(); });
        return std::vector<QRawFont>();
    }();
    const auto found = std::find(known.begin(), known.end(), font);
    if (found != known.end()) {
        return *found;
    }
    if (known.size() == kMost) {
        known.clear();
    }
    known.push_back(font);
    return font;
}

}  // namespace

int PlacedGlyphs::Maker::addColor(std::optional<platform::Color> color) {
    if (!glyphs_.colors_) {
        glyphs_.colors_ = std::make_unique<std::vector<std::optional<platform::Color>>>();
    }
    glyphs_.colors_->push_back(color);
    return static_cast<int>(glyphs_.colors_->size()) - 1;
}

void PlacedGlyphs::Maker::add(const QRawFont& font, const quint32* indexes, const QPointF* positions, int count,
                              int color) {
    if (count == 0) {
        return;
    }
    const double y = positions[0].y();
    const bool hasHeights =
        std::any_of(positions, positions + count, [y](const QPointF& position) { return position.y() != y; });
    glyphs_.runs_.push_back({sharedFont(font), count, static_cast<short>(color), hasHeights, static_cast<float>(y)});
    for (int i = 0; i < count; ++i) {
        words_.append(std::bit_cast<quint32>(static_cast<float>(positions[i].x())));
    }
    for (int i = 0; hasHeights && i < count; ++i) {
        words_.append(std::bit_cast<quint32>(static_cast<float>(positions[i].y())));
    }
    // A font has at most 65,535 glyphs.
    for (int i = 0; i < count; i += 2) {
        words_.append(indexes[i] | (i + 1 < count ? indexes[i + 1] << 16U : 0U));
    }
}

PlacedGlyphs PlacedGlyphs::Maker::made() {
    glyphs_.runs_.shrink_to_fit();
    glyphs_.words_ = std::make_unique<quint32[]>(static_cast<std::size_t>(words_.size()));
    std::copy(words_.begin(), words_.end(), glyphs_.words_.get());
    return std::move(glyphs_);
}

void PlacedGlyphs::draw(QPainter& painter, const QColor& color, const Palette& palette) const {
    QVarLengthArray<QPointF, 128> positions;
    QVarLengthArray<quint32, 128> indexes;
    QGlyphRun run;
    const quint32* word = words_.get();
    for (const Run& part : runs_) {
        positions.resize(part.count);
        indexes.resize(part.count);
        for (QPointF& position : positions) {
            position = {std::bit_cast<float>(*word++), part.y};
        }
        for (int i = 0; part.hasHeights && i < part.count; ++i) {
            positions[i].setY(std::bit_cast<float>(*word++));
        }
        for (int i = 0; i < part.count; ++i) {
            indexes[i] = i % 2 == 0 ? *word & 0xFFFFU : *word++ >> 16U;
        }
        word += part.count % 2;
        const auto* own = part.color < 0 ? nullptr : &(*colors_)[static_cast<std::size_t>(part.color)];
        painter.setPen(own != nullptr && own->has_value() ? palette.resolve(**own) : color);
        run.setRawFont(part.font);
        run.setRawData(indexes.constData(), positions.constData(), part.count);
        painter.drawGlyphRun(QPointF(0, 0), run);
    }
}

}  // namespace ktr::linux_
