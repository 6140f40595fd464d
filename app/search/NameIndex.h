#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "ask/People.h"

namespace ktr::app {

/// Whom the beginning of a name may mean: people of the contacts who can be asked about, by any word of their name, by
/// nickname or e-mail address. Any thread.
class NameIndex {
  public:
    explicit NameIndex(std::shared_ptr<const ask::People> people);

    struct Match {
        const ask::Person* person = nullptr;  ///< of `people`
        bool isWhole = false;                 ///< the text is all of their name, and not its beginning
    };
    /// At most `most`, each person once: whole names first, then by name.
    std::vector<Match> find(const std::string& text, std::size_t most) const;
    /// Null for nobody.
    const ask::Person* withHandle(const std::string& handle) const;
    const std::shared_ptr<const ask::People>& people() const { return people_; }

  private:
    struct Entry {
        std::u32string name;  ///< folded
        std::size_t person = 0;
        bool isWhole = false;
    };

    void add(const std::string& name, std::size_t person, bool isWhole);

    std::shared_ptr<const ask::People> people_;
    std::vector<Entry> entries_;  ///< by name
    std::map<std::string, std::size_t> byHandle_;
};

}  // namespace ktr::app
