#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::documents {

/// The name that was probably meant: the one that takes the fewest slips (a letter missing, doubled, wrong, or two
/// swapped; case does not count), if those are few for its length. Ties go to the earlier name.
std::optional<std::string> nearestName(std::string_view word, const std::vector<std::string>& names);

/// `; did you mean "latitude"?`, or nothing when no name is near.
std::string didYouMean(std::string_view word, const std::vector<std::string>& names);

}  // namespace ktr::documents
