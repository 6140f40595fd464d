#pragma once

#include <QImage>
#include <cstddef>
#include <string>

#include "bench/RowsFile.h"

namespace ktr::bench {

/// What is measured: a list of rows that is built, changed, resized and painted. Both programs are one.
class Scene {
  public:
    virtual ~Scene() = default;
    /// Creates everything for the first `count` rows, at `width` points, ready to be painted.
    virtual void build(const RowsFile& file, std::size_t count, double width) = 0;
    /// Sets the texts of every row, or of one, and lays out.
    virtual void updateAll(bool next) = 0;
    virtual void updateOne(std::size_t row, bool next) = 0;
    virtual void resize(double width) = 0;
    /// Points.
    virtual double height() const = 0;
    /// Paints everything into an image of the scene's size times `scale`.
    virtual void paint(QImage& image, double scale) = 0;
    virtual void clear() = 0;
    /// Shapes a name on one line, as a row's label has it, and drops it.
    virtual void shapeName(const std::string& name) = 0;
    /// Paints everything into a PNG file; false when that fails.
    virtual bool write(const QString& path, double scale) = 0;
};

/// The command line of a bench program: `--json FILE` and what to do with it.
int runBenchProgram(int argc, char** argv, Scene& scene);

}  // namespace ktr::bench
