#pragma once

#include <unicode/locid.h>
#include <unicode/unumberformatter.h>

namespace ktr::linux_ {

/// How short a unit stands in a row, in a language: "310 m".
class UnitWidth {
  public:
    static UNumberUnitWidth inRow(const icu::Locale& language);
};

}  // namespace ktr::linux_
