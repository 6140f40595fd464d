#include "ask/Languages.h"

namespace ktr::ask {

std::shared_ptr<const Language> Languages::read(const std::string& tag) {
    if (const auto known = known_.find(tag); known != known_.end()) {
        return known->second;
    }
    const auto file = Language::fileFor(tag, folder_);
    if (!file) {
        return nullptr;
    }
    auto read = Language::read(*file, tag);
    if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
        problem_ = error->text();
        return nullptr;
    }
    return known_[tag] = std::get<std::shared_ptr<const Language>>(std::move(read));
}

std::shared_ptr<const Language> Languages::language(const std::string& tag) {
    const std::lock_guard<std::mutex> lock(mutex_);
    auto language = read(tag);
    return language ? language : read("en");
}

std::string Languages::problem() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return problem_;
}

}  // namespace ktr::ask
