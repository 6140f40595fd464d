#pragma once

#include <QRawFont>

namespace ktr::linux_ {

/// Whether the font's file could be opened: in place of any other the library has one of boxes, which has no name, and
/// being asked for that ends the process with a signal. Each file has this table (OpenType, "head").
inline bool isOpened(const QRawFont& font) {
    return font.isValid() && !font.fontTable("head").isEmpty();
}

}  // namespace ktr::linux_
