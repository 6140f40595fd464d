#pragma once

#include <QByteArray>
#include <QImage>
#include <memory>

struct spng_ctx;

namespace ktr::linux_ {

/// Writes a picture as a PNG file (ISO/IEC 15948), rows by rows, so that a tall picture never has to be in memory as a
/// whole. Rows are not filtered: text on plain ground compresses better and several times as fast without. The same
/// rows give the same file. One thread at a time, any thread.
class PngEncoder {
  public:
    /// Pixels; an opaque picture has no alpha channel in its file.
    PngEncoder(int width, int height, bool opaque);
    ~PngEncoder();
    PngEncoder(const PngEncoder&) = delete;
    PngEncoder& operator=(const PngEncoder&) = delete;

    /// The next rows, from the top: the first `count` of the picture, which is as wide as the file's.
    void add(const QImage& picture, int count);
    /// The file when all rows are there; else, or without memory, empty.
    QByteArray file();

  private:
    int width_;
    bool opaque_;
    bool failed_ = false;
    bool finished_ = false;
    QByteArray file_;
    std::unique_ptr<spng_ctx, void (*)(spng_ctx*)> context_;
};

}  // namespace ktr::linux_
