#include "platform/layout/PinnedEdges.h"

#include <vector>

#include "platform/layout/ConstraintRule.h"
#include "platform/ui/View.h"

namespace ktr::platform {

void pinEdges(View& view, View& onto, std::initializer_list<LayoutAttribute> edges) {
    const ViewReference inner(view);
    const ViewReference outer(onto);
    std::vector<ConstraintRule> rules;
    rules.reserve(edges.size());
    for (const auto edge : edges) {
        rules.push_back({inner, outer, {edge, edge}});
    }
    onto.addRules(rules);
}

}  // namespace ktr::platform
