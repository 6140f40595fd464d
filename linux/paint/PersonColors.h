#pragma once

#include <QColor>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "platform/contacts/Contact.h"
#include "platform/contacts/PersonColor.h"

namespace ktr::linux_ {

/// The colour that stands for a person, the same on every device without being stored anywhere. Any thread.
class PersonColors {
  public:
    static constexpr std::size_t kCount = platform::PersonColor::kCount;

    /// 32-bit FNV-1a of the bytes (draft-eastlake-fnv: offset basis 811c9dc5, prime 01000193).
    static std::uint32_t hash(std::string_view bytes);
    /// The number of a handle's colour: both halves of its hash folded together, modulo twelve.
    static std::size_t number(std::string_view handle);
    /// All twelve are equally light: white letters read on them, and they are seen on a light and a dark card alike.
    static QColor color(std::size_t number);
    /// Under the figure that stands for nobody.
    static QColor stone();

    /// What identifies a contact: the first e-mail address in ASCII lower case, else the first phone number
    /// reduced to digits and "+", else the identifier, else the name.
    static std::string handleOf(const platform::Contact& contact);
    static QColor colorOf(const platform::Contact& contact);
};

}  // namespace ktr::linux_
