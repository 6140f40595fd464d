#pragma once

#include <string>

#include "platform/base/Date.h"
#include "platform/base/Value.h"

namespace ktr {

/// The entry with the text that a row shows.
inline constexpr const char* LabelStringKey = "LabelStringKey";
/// The entry with the text that a screen reader speaks.
inline constexpr const char* LabelAccessibilityStringKey = "LabelAccessibilityStringKey";

/// Says how old a fix is. Stateless. Main thread.
class KTRVAUIUtils {
  public:
    struct AgeStrings {
        std::string shown;
        std::string spoken;
    };

    /// What `dictionaryWithAgeStringsForDate` has, without a dictionary: rows are filled with it again and again.
    static AgeStrings ageStringsForDate(const platform::Date& date);
    /// Exactly two strings, under the keys above. The age is the whole seconds between now and the date, either way: a
    /// date in the future reads like one as far in the past. Up to 30 s "now"; up to 59 s the fixed number 30; then
    /// minutes; from 60 to 119 minutes the fixed number 1; then hours.
    static platform::Dictionary dictionaryWithAgeStringsForDate(const platform::Date& date);
    /// Which of these five kinds of age the date has, from 0, the newest.
    static int ageBandForDate(const platform::Date& date);
};

}  // namespace ktr
