#pragma once

#include <algorithm>

#include "host/conversation/Measures.h"

namespace ktr::host {

/// Where the columns of a wide conversation stand, from its start edge; points. A value.
struct WideColumns {
    double speechStart = 0.0;
    double cardStart = 0.0;
    double cardWidth = 0.0;

    static WideColumns of(double width) {
        constexpr double kBeside = measures::kSpeechColumn + measures::kColumnGap;
        WideColumns columns;
        columns.cardWidth = std::min(measures::kWideCard, width - 2.0 * measures::kMargin - kBeside);
        columns.speechStart = (width - (kBeside + columns.cardWidth)) / 2.0;
        columns.cardStart = columns.speechStart + kBeside;
        return columns;
    }
};

}  // namespace ktr::host
