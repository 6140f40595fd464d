#include "host/links/KnownFriends.h"

#include <algorithm>

#include "host/Host.h"
#include "platform/contacts/ContactStore.h"

namespace ktr::host {

using namespace platform;

namespace {

/// Addresses have no case, and numbers no blanks and brackets.
std::string plain(const std::string& handle) {
    const bool isAddress = handle.find('@') != std::string::npos;
    std::string text;
    for (const char c : handle) {
        if (isAddress) {
            text += c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
        } else if ((c >= '0' && c <= '9') || c == '+') {
            text += c;
        }
    }
    return text.empty() ? handle : text;
}

/// An answer's context without what it says of the answer as a whole: that there are more friends than it shows.
std::optional<Url> contextOf(const std::shared_ptr<AssistantObject>& snippet) {
    const auto answer = std::dynamic_pointer_cast<VASnippet>(snippet);
    if (!answer || !answer->searchContext) {
        return std::nullopt;
    }
    const std::string& text = answer->searchContext->text();
    const auto query = text.find('?');
    std::string kept = text.substr(0, query);
    for (auto start = query; start != std::string::npos;) {
        const auto end = text.find('&', start + 1);
        const std::string part = text.substr(start, end == std::string::npos ? end : end - start);
        kept += part.compare(1, 11, "incomplete=") == 0 ? part.substr(0, part[0] == '?' ? 1 : 0) : part;
        start = end;
    }
    return Url(kept);
}

LocationList friendsIn(const std::shared_ptr<AssistantObject>& snippet) {
    if (const auto locations = std::dynamic_pointer_cast<VAKtrLocationSnippet>(snippet)) {
        return locations->locations ? *locations->locations : LocationList();
    }
    const auto fence = std::dynamic_pointer_cast<VAKtrGeoFenceSnippet>(snippet);
    if (!fence || !fence->cueKtrGeoFence || !fence->cueKtrGeoFence->friend_) {
        return {};
    }
    // Where the fence is says nothing of where its friend is.
    auto nowhere = std::make_shared<VAKtrLocation>();
    nowhere->friend_ = fence->cueKtrGeoFence->friend_;
    return {nowhere};
}

std::shared_ptr<Contact> firstOf(const ContactFetch<ContactStore::Contacts>& found) {
    return found.result.empty() ? nullptr : found.result.front();
}

std::string fullNameOf(const Contact& contact) {
    const auto installed = Platform::installed();
    const auto name = installed->contactFormatter
                          ? installed->contactFormatter->stringFromContact(contact, ContactFormatterStyle::FullName)
                          : std::nullopt;
    return name.value_or("");
}

}  // namespace

std::shared_ptr<Contact> KnownFriends::contactOf(const std::string& handle) {
    const auto installed = Platform::installed();
    if (!installed || !installed->contactStore || handle.empty()) {
        return nullptr;
    }
    auto& store = *installed->contactStore;
    return firstOf(handle.find('@') != std::string::npos ? store.unifiedContactsMatchingEmailAddress(handle, {})
                                                         : store.unifiedContactsMatchingPhoneNumber(handle, {}));
}

std::shared_ptr<Contact> KnownFriends::contactOf(const VAKtrLocation& location) {
    for (const std::string& handle : handlesOf(location)) {
        if (auto contact = contactOf(handle)) {
            return contact;
        }
    }
    return nullptr;
}

std::vector<std::string> KnownFriends::handlesOf(const VAKtrLocation& location) {
    std::vector<std::string> handles;
    const auto& attribute = location.friend_;
    if (!attribute) {
        return handles;
    }
    if (attribute->data && !attribute->data->empty()) {
        handles.push_back(*attribute->data);
    }
    const auto& person = attribute->object;
    for (const auto& email : person ? person->emails : std::vector<std::shared_ptr<VAEmail>>()) {
        if (email && email->emailAddress && !email->emailAddress->empty()) {
            handles.push_back(*email->emailAddress);
        }
    }
    for (const auto& phone : person ? person->phones : std::vector<std::shared_ptr<VAPhone>>()) {
        if (phone && phone->number && !phone->number->empty()) {
            handles.push_back(*phone->number);
        }
    }
    return handles;
}

std::string KnownFriends::handleOf(const VAKtrLocation& location) {
    const auto handles = handlesOf(location);
    return handles.empty() ? "" : handles.front();
}

std::string KnownFriends::nameOf(const VAKtrLocation& location) {
    const auto contact = contactOf(location);
    const std::string name = contact ? fullNameOf(*contact) : "";
    const auto& person = location.friend_ ? location.friend_->object : nullptr;
    return !name.empty()                                              ? name
           : person && person->fullName && !person->fullName->empty() ? *person->fullName
                                                                      : handleOf(location);
}

std::string KnownFriends::shortNameOf(const VAKtrLocation& location) {
    const auto contact = contactOf(location);
    const auto& person = location.friend_ ? location.friend_->object : nullptr;
    if (contact && !contact->givenName.empty()) {
        return contact->givenName;
    }
    return person && person->firstName && !person->firstName->empty() ? *person->firstName : nameOf(location);
}

bool KnownFriends::isCalled(const VAKtrLocation& location, const std::string& handle) {
    const auto handles = handlesOf(location);
    return std::any_of(handles.begin(), handles.end(),
                       [wanted = plain(handle)](const auto& one) { return plain(one) == wanted; });
}

std::optional<KnownFriends::Known> KnownFriends::find(const std::string& handle) const {
    for (const auto& snippet : host_.snippets()) {
        for (const auto& location : friendsIn(snippet)) {
            if (location && isCalled(*location, handle)) {
                return Known{location, contextOf(snippet)};
            }
        }
    }
    return std::nullopt;
}

std::vector<KnownFriends::Known> KnownFriends::all() const {
    std::vector<Known> friends;
    std::vector<std::string> seen;
    for (const auto& snippet : host_.snippets()) {
        for (const auto& location : friendsIn(snippet)) {
            const std::string handle = location ? plain(handleOf(*location)) : "";
            if (!handle.empty() && std::find(seen.begin(), seen.end(), handle) == seen.end()) {
                seen.push_back(handle);
                friends.push_back({location, contextOf(snippet)});
            }
        }
    }
    return friends;
}

std::optional<KnownFriends::Known> KnownFriends::fromContacts(const std::string& handle) {
    const auto contact = contactOf(handle);
    if (!contact) {
        return std::nullopt;
    }
    Known known = named(fullNameOf(*contact), handle);
    known.location->friend_->object->firstName = contact->givenName;
    return known;
}

KnownFriends::Known KnownFriends::named(const std::string& name, const std::string& handle) {
    auto person = std::make_shared<VAPerson>();
    person->fullName = name;
    if (handle.find('@') != std::string::npos) {
        person->emails.push_back(std::make_shared<VAEmail>());
        person->emails.back()->emailAddress = handle;
    } else {
        person->phones.push_back(std::make_shared<VAPhone>());
        person->phones.back()->number = handle;
    }
    auto location = std::make_shared<VAKtrLocation>();
    location->friend_ = std::make_shared<VAPersonAttribute>();
    location->friend_->object = std::move(person);
    location->friend_->data = handle;
    return Known{std::move(location), std::nullopt};
}

}  // namespace ktr::host
