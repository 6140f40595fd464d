#pragma once

#include <optional>
#include <string>
#include <vector>

namespace ktr {

/// The labels that contact databases store for their built-in kinds of address ("_$!<home>!$_"). Stateless.
class LabelUtil {
  public:
    /// Home, work, school, gym, other. Any thread.
    static const std::vector<std::string>& defaultLabelKeys();
    /// Whether the label, its ASCII letters lower-cased, is one of the keys; false for none. Any thread.
    static bool isDefaultLabel(const std::optional<std::string>& label);
    /// The first key whose localized text in the host's own bundle (an absent one counts as empty) is this text; none
    /// when no key has it. Main thread.
    static std::optional<std::string> keyForDefaultLabel(const std::string& text);
};

}  // namespace ktr
