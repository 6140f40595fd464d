#include "ask/Languages.h"

namespace ktr::ask {

namespace {

constexpr const char* kEnding = ".json";

}  // namespace

void Languages::list() {
    std::error_code error;
    for (std::filesystem::directory_iterator entry(folder_, error), end; !error && entry != end;
         entry.increment(error)) {
        if (entry->path().extension() == kEnding) {
            files_.insert(entry->path().stem().string());
        }
    }
}

std::shared_ptr<const Language> Languages::read(const std::string& tag) {
    const auto file = Language::fileFor(tag, files_);
    if (!file) {
        return nullptr;
    }
    if (const auto known = known_.find(*file); known != known_.end()) {
        return known->second->under(tag);
    }
    auto read = Language::read(folder_ / (*file + kEnding), tag);
    if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
        problem_ = error->text();
        return nullptr;
    }
    return known_[*file] = std::get<std::shared_ptr<const Language>>(std::move(read));
}

std::shared_ptr<const Language> Languages::language(const std::string& tag) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (files_.empty()) {
        list();
    }
    auto language = read(tag);
    return language ? language : read("en");
}

std::string Languages::problem() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return problem_;
}

}  // namespace ktr::ask
