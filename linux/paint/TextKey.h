#pragma once

#include <QByteArray>
#include <QHashFunctions>
#include <cstddef>

#include "platform/text/TextEngine.h"

namespace ktr::linux_ {

/// A text and the container that it is set in, in few bytes more than the text has: what a kept layout is found by, and
/// what it is shaped from again where its glyphs cannot be drawn. The same bytes are the same text in the same
/// container. A value; copies share their bytes. Any thread.
class TextKey {
  public:
    TextKey(const platform::AttributedString& text, const platform::TextContainer& container);

    platform::AttributedString text() const;
    platform::TextContainer container() const;
    std::size_t hash() const { return qHash(bytes_); }
    bool operator==(const TextKey& other) const { return bytes_ == other.bytes_; }

  private:
    QByteArray bytes_;
};

}  // namespace ktr::linux_
