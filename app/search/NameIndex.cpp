#include "app/search/NameIndex.h"

#include <algorithm>
#include <set>
#include <tuple>

#include "ask/FoldedText.h"

namespace ktr::app {

namespace {

bool startsWith(const std::u32string& text, const std::u32string& beginning) {
    return text.compare(0, beginning.size(), beginning) == 0;
}

}  // namespace

NameIndex::NameIndex(std::shared_ptr<const ask::People> people) : people_(std::move(people)) {
    for (std::size_t i = 0; i < people_->all().size(); ++i) {
        const ask::Person& person = people_->all()[i];
        if (person.handle().empty() || !byHandle_.emplace(person.handle(), i).second) {
            continue;
        }
        add(person.shownName(), i, true);
        add(person.nickname, i, true);
        if (!person.firstName.empty() && !person.lastName.empty()) {
            add(person.firstName + " " + person.lastName, i, true);
            add(person.lastName + " " + person.firstName, i, true);
        }
        add(person.firstName, i, false);
        for (const std::string& email : person.emails) {
            add(email, i, true);
        }
    }
    std::sort(entries_.begin(), entries_.end(), [](const Entry& one, const Entry& other) {
        return std::tie(one.name, one.person, other.isWhole) < std::tie(other.name, other.person, one.isWhole);
    });
}

void NameIndex::add(const std::string& name, std::size_t person, bool isWhole) {
    const std::u32string folded = ask::FoldedText::of(name);
    if (folded.empty()) {
        return;
    }
    entries_.push_back({folded, person, isWhole});
    for (std::size_t blank = folded.find(U' '); blank != std::u32string::npos; blank = folded.find(U' ', blank + 1)) {
        entries_.push_back({folded.substr(blank + 1), person, false});
    }
}

std::vector<NameIndex::Match> NameIndex::find(const std::string& text, std::size_t most) const {
    const std::u32string beginning = ask::FoldedText::of(text);
    std::vector<Match> matches;
    if (beginning.empty()) {
        return matches;
    }
    std::set<std::size_t> known;
    const auto first =
        std::lower_bound(entries_.begin(), entries_.end(), beginning,
                         [](const Entry& entry, const std::u32string& name) { return entry.name < name; });
    const auto take = [&](bool whole) {
        for (auto entry = first; entry != entries_.end() && matches.size() < most && startsWith(entry->name, beginning);
             ++entry) {
            const bool isWhole = entry->isWhole && entry->name.size() == beginning.size();
            // Whole names stand before all that go on from them.
            if (whole && entry->name.size() > beginning.size()) {
                return;
            }
            if (isWhole == whole && known.insert(entry->person).second) {
                matches.push_back({&people_->all()[entry->person], isWhole});
            }
        }
    };
    take(true);
    take(false);
    return matches;
}

const ask::Person* NameIndex::withHandle(const std::string& handle) const {
    const auto found = byHandle_.find(handle);
    return found == byHandle_.end() ? nullptr : &people_->all()[found->second];
}

}  // namespace ktr::app
