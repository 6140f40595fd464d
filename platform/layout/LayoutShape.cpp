#include "platform/layout/LayoutShape.h"

#include <bit>

namespace ktr::platform {

namespace {

class Hash {
  public:
    void add(std::uint64_t number) {
        hash_ = (hash_ ^ number) * 0x9E3779B97F4A7C15ULL;
        hash_ ^= hash_ >> 32;
    }
    void add(double number) { add(std::bit_cast<std::uint64_t>(number)); }
    std::uint64_t value() const { return hash_; }

  private:
    std::uint64_t hash_ = 0;
};

}  // namespace

/// Rows that share a structure are compared whole: what differs seldom need not be in it.
std::uint64_t LayoutShape::hash() const {
    Hash hash;
    hash.add((mentions.size() << 1U) + (rightToLeft ? 1U : 0U));
    for (const Mention& mention : mentions) {
        const auto first = static_cast<std::uint64_t>(mention.first - kNobody);
        const auto second = static_cast<std::uint64_t>(mention.second - kNobody);
        hash.add((first << 40U) + (second << 20U) + (static_cast<std::uint64_t>(mention.terms.first) << 10U) +
                 static_cast<std::uint64_t>(mention.terms.second));
        hash.add(mention.terms.constant);
    }
    for (const Member& member : members) {
        hash.add(member.priorities.horizontalCompressionResistance + (member.hasWidth ? 0.5 : 0.0) +
                 (member.hasHeight ? 0.25 : 0.0));
    }
    return hash.value();
}

}  // namespace ktr::platform
