#include "server/admin/TerminalCode.h"

namespace ktr::server {

namespace {

constexpr int kQuiet = 4;
constexpr const char* kColours = "\x1b[97;40m";
constexpr const char* kAsBefore = "\x1b[0m";

bool isWhite(const QrCode& code, int row, int column) {
    const bool isInside = row >= 0 && row < code.side && column >= 0 && column < code.side;
    return !isInside || !code.at(row, column);
}

}  // namespace

std::string terminalCode(const QrCode& code, bool coloured) {
    std::string text;
    for (int row = -kQuiet; row < code.side + kQuiet; row += 2) {
        text += coloured ? kColours : "";
        for (int column = -kQuiet; column < code.side + kQuiet; ++column) {
            const bool upper = isWhite(code, row, column);
            // The last line of an odd number of rows has one more row of the quiet zone.
            const bool lower = isWhite(code, row + 1, column);
            text += upper && lower ? "█" : upper ? "▀" : lower ? "▄" : " ";
        }
        text += coloured ? kAsBefore : "";
        text += "\n";
    }
    return text;
}

}  // namespace ktr::server
