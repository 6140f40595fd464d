#pragma once

#include <QString>

#include "platform/contacts/Contact.h"

namespace ktr::linux_ {

/// The letters that stand for a contact without a photo: two initials, the given name's and the family name's; one
/// where letters join or stack (Arabic, Syriac, Devanagari and its kin, Thai); the family name's first character in
/// Han, kana and hangul. Always whole graphemes, in upper case where the script has it. A value; any thread.
class Initials {
  public:
    explicit Initials(const platform::Contact& contact);

    /// Empty when no name holds a letter or digit.
    const QString& letters() const { return letters_; }
    /// From the circle's centre down to the baseline, as a part of the letters' size: half the height of a capital in
    /// this script.
    double baseline() const { return baseline_; }

  private:
    QString letters_;
    double baseline_ = 0.357;
};

}  // namespace ktr::linux_
