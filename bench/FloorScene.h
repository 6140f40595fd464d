#pragma once

#include <QTextLayout>
#include <memory>
#include <vector>

#include "bench/Scene.h"

namespace ktr::bench {

/// The floor that ktr is measured against: the same texts in the same fonts, shaped and painted by Qt at positions that
/// are known beforehand. No views, no layout engine, nothing kept beyond the shaped lines.
class FloorScene : public Scene {
  public:
    void build(const RowsFile& file, std::size_t count, double width) override;
    void updateAll(bool next) override;
    void updateOne(std::size_t row, bool next) override;
    void resize(double width) override;
    double height() const override;
    void paint(QImage& image, double scale) override;
    void clear() override { rows_.clear(); }
    void shapeName(const std::string& name) override;
    bool write(const QString& path, double scale) override;

  private:
    struct Text {
        QString text;
        std::unique_ptr<QTextLayout> layout;
        double width = 0.0;
    };
    struct Row {
        const RowData* data = nullptr;
        Text name;
        Text locality;
        Text distance;
        Text age;
        QString elidedName;
    };

    void fill(Row& row, bool next) const;
    void placeName(Row& row) const;

    std::vector<Row> rows_;
    double width_ = 0.0;
};

}  // namespace ktr::bench
