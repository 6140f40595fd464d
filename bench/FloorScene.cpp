#include "bench/FloorScene.h"

#include <QFontMetricsF>
#include <QPainter>
#include <limits>

namespace ktr::bench {

namespace {

constexpr double kRowHeight = 78.5;
constexpr double kTextStart = 82.0;
constexpr double kMargin = 15.0;
constexpr double kGap = 13.0;

QFont fontOf(int pixels, bool bold) {
    QFont font;
    font.setFamilies({"Noto Sans", "Noto Sans Arabic", "Noto Sans Hebrew", "Noto Sans CJK JP", "Noto Color Emoji"});
    font.setPixelSize(pixels);
    font.setBold(bold);
    font.setHintingPreference(QFont::PreferNoHinting);
    return font;
}

const QFont& nameFont() {
    static const QFont font = fontOf(16, true);
    return font;
}
const QFont& distanceFont() {
    static const QFont font = fontOf(16, false);
    return font;
}
const QFont& smallFont() {
    static const QFont font = fontOf(13, false);
    return font;
}

std::unique_ptr<QTextLayout> shaped(const QString& text, const QFont& font, double& width) {
    auto layout = std::make_unique<QTextLayout>(text, font);
    layout->setCacheEnabled(true);
    layout->beginLayout();
    QTextLine line = layout->createLine();
    if (line.isValid()) {
        line.setLineWidth(std::numeric_limits<int>::max() / 256.0);
        line.setPosition({0.0, 0.0});
        width = line.naturalTextWidth();
    }
    layout->endLayout();
    return layout;
}

}  // namespace

void FloorScene::fill(Row& row, bool next) const {
    const RowTexts& texts = next ? row.data->next : row.data->now;
    const auto set = [](Text& text, const std::string& to, const QFont& font) {
        const QString wanted = QString::fromStdString(to);
        if (text.layout && text.text == wanted) {
            return false;
        }
        text.text = wanted;
        text.layout = shaped(wanted, font, text.width);
        return true;
    };
    set(row.locality, texts.locality, smallFont());
    set(row.age, texts.age, smallFont());
    const bool moved = set(row.distance, texts.distance, distanceFont());
    if (set(row.name, texts.name, nameFont()) || moved) {
        placeName(row);
    }
}

void FloorScene::placeName(Row& row) const {
    const double room = width_ - kTextStart - kMargin - kGap - row.distance.width;
    if (row.name.width <= room) {
        if (!row.elidedName.isEmpty()) {
            row.elidedName.clear();
            row.name.layout = shaped(row.name.text, nameFont(), row.name.width);
        }
        return;
    }
    row.elidedName = QFontMetricsF(nameFont()).elidedText(row.name.text, Qt::ElideRight, room);
    double ignored = 0.0;
    row.name.layout = shaped(row.elidedName, nameFont(), ignored);
}

void FloorScene::build(const RowsFile& file, std::size_t count, double width) {
    width_ = width;
    rows_.clear();
    rows_.resize(count);
    for (std::size_t i = 0; i < count; ++i) {
        rows_[i].data = &file.friends[i];
        fill(rows_[i], false);
    }
}

void FloorScene::shapeName(const std::string& name) {
    double ignored = 0.0;
    shaped(QString::fromStdString(name), nameFont(), ignored);
}

void FloorScene::updateAll(bool next) {
    for (Row& row : rows_) {
        fill(row, next);
    }
}

void FloorScene::updateOne(std::size_t row, bool next) {
    fill(rows_[row], next);
}

void FloorScene::resize(double width) {
    width_ = width;
    for (Row& row : rows_) {
        placeName(row);
    }
}

double FloorScene::height() const {
    return static_cast<double>(rows_.size()) * kRowHeight;
}

void FloorScene::paint(QImage& image, double scale) {
    image.fill(QColor("#FFFDF8"));
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(scale, scale);
    QFont initials = fontOf(22, true);
    double y = 0.0;
    for (const Row& row : rows_) {
        painter.setPen(Qt::NoPen);
        painter.setBrush(QColor(QString::fromStdString(row.data->color)));
        painter.drawEllipse(QRectF(kMargin, y + 10.0, 54.0, 54.0));
        painter.setFont(initials);
        painter.setPen(Qt::white);
        painter.drawText(QRectF(kMargin, y + 10.0, 54.0, 54.0), Qt::AlignCenter,
                         QString::fromStdString(row.data->initials));
        painter.setPen(QColor("#2B2620"));
        row.locality.layout->draw(&painter, {kTextStart, y + 10.0});
        row.name.layout->draw(&painter, {kTextStart, y + 28.0});
        row.age.layout->draw(&painter, {kTextStart, y + 50.0});
        row.distance.layout->draw(&painter, {width_ - kMargin - row.distance.width, y + 28.0});
        painter.fillRect(QRectF(0.0, y + 78.0, width_, 1.0 / scale), QColor(151, 158, 149));
        y += kRowHeight;
    }
}

bool FloorScene::write(const QString& path, double scale) {
    QImage image(static_cast<int>(width_ * scale), static_cast<int>(height() * scale),
                 QImage::Format_ARGB32_Premultiplied);
    paint(image, scale);
    return image.save(path, "PNG");
}

}  // namespace ktr::bench
