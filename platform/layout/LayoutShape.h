#pragma once

#include <cstdint>
#include <vector>

#include "platform/layout/ConstraintRule.h"
#include "platform/layout/LayoutTypes.h"

namespace ktr::platform {

/// All that the equations of a scope depend on apart from its inputs: equal for scopes that can share a structure. A
/// value.
struct LayoutShape {
    static constexpr int kOwner = -1;
    static constexpr int kNobody = -2;

    /// A constraint and the participants at its ends.
    struct Mention {
        int first = kNobody;
        int second = kNobody;
        ConstraintTerms terms;
        bool operator==(const Mention&) const = default;
    };
    /// A view that takes part.
    struct Member {
        int parent = kOwner;   // its superview's participant
        bool isFixed = false;  // its frame is taken as it stands
        bool hasWidth = false;
        bool hasHeight = false;
        ContentPriorities priorities;
        bool operator==(const Member&) const = default;
    };

    bool rightToLeft = false;
    /// What the scope's owner holds comes first, then what participants say of their own size.
    std::vector<Mention> mentions;
    std::size_t ownRules = 0;
    Member owner;
    std::vector<Member> members;

    bool operator==(const LayoutShape&) const = default;
    std::uint64_t hash() const;
};

}  // namespace ktr::platform
