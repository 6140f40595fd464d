#include "server/page/QrCode.h"

#include <qrencode.h>

#include <memory>

namespace ktr::server {

std::optional<QrCode> QrCode::of(std::string_view text) {
    if (text.empty() || text.find('\0') != std::string_view::npos) {
        return std::nullopt;
    }
    const std::unique_ptr<::QRcode, decltype(&::QRcode_free)> made(
        ::QRcode_encodeString(std::string(text).c_str(), 0, QR_ECLEVEL_M, QR_MODE_8, 1), ::QRcode_free);
    if (!made) {
        return std::nullopt;
    }
    QrCode code;
    code.side = made->width;
    const auto count = static_cast<std::size_t>(made->width) * static_cast<std::size_t>(made->width);
    code.black.reserve(count);
    for (std::size_t i = 0; i < count; ++i) {
        code.black.push_back((made->data[i] & 1U) != 0);
    }
    return code;
}

bool QrCode::at(int row, int column) const {
    return black[static_cast<std::size_t>(row) * static_cast<std::size_t>(side) + static_cast<std::size_t>(column)];
}

std::string QrCode::path() const {
    std::string path;
    for (int row = 0; row < side; ++row) {
        for (int column = 0; column < side; ++column) {
            const int begin = column;
            while (column < side && at(row, column)) {
                ++column;
            }
            if (column > begin) {
                const std::string length = std::to_string(column - begin);
                path += "M" + std::to_string(begin) + " " + std::to_string(row) + "h" + length + "v1h-" + length + "z";
            }
        }
    }
    return path;
}

}  // namespace ktr::server
