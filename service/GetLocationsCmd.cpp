#include "service/GetLocationsCmd.h"

#include <algorithm>
#include <cstddef>

#include "model/KTRVALocation.h"
#include "model/LogCategory.h"
#include "service/Common.h"
#include "service/JsonInteger.h"
#include "service/KTRVAUtils.h"

namespace ktr {

using platform::Dictionary;
using platform::Value;

namespace {

/// The answer is not complete: a later request carries that back to the service.
constexpr std::int64_t kIncomplete = 416;
/// The service will not report this friend.
constexpr std::int64_t kNotReported = 411;

/// Words the list only when the log keeps the line.
class DescribedList : public platform::Object {
  public:
    explicit DescribedList(const ServiceResult& items) : items_(items) {}
    std::string description() const override {
        std::string text = "(";
        for (const ResultItem& item : items_) {
            const auto* location = std::get_if<std::shared_ptr<platform::VAKtrLocation>>(&item);
            text += text.size() > 1 ? ", " : "";
            text += location != nullptr && *location ? (*location)->description() : "(null)";
        }
        return text + ")";
    }

  private:
    const ServiceResult& items_;
};

const Dictionary* objectAt(const Dictionary& dictionary, const std::string& key) {
    const Value* value = dictionary.find(key);
    return value != nullptr ? value->dictionary() : nullptr;
}

/// The entries of an answer by handle. Services list both in one order: then none is looked up.
class EntriesInOrder {
  public:
    explicit EntriesInOrder(const Dictionary* locations) : locations_(locations) {}
    /// None for a handle without an object.
    const Dictionary* of(const std::string& handle) {
        if (locations_ == nullptr) {
            return nullptr;
        }
        if (next_ < locations_->size()) {
            const auto& [key, value] = *(locations_->begin() + static_cast<std::ptrdiff_t>(next_));
            if (key == handle) {
                ++next_;
                return value.dictionary();
            }
        }
        return objectAt(*locations_, handle);
    }

  private:
    const Dictionary* locations_;
    std::size_t next_ = 0;
};

/// The handles to walk.
std::vector<std::string> handlesOf(const Dictionary& response, const Dictionary* locations) {
    std::vector<std::string> handles;
    const Value* emails = response.find("emails");
    const Value::Array* listed = emails != nullptr ? emails->array() : nullptr;
    if (listed != nullptr && !listed->empty()) {
        for (const Value& handle : *listed) {
            if (handle.string() != nullptr) {
                handles.push_back(*handle.string());
            }
        }
    } else if (locations != nullptr) {
        for (const auto& [handle, entry] : *locations) {
            handles.push_back(handle);
        }
    }
    return handles;
}

}  // namespace

std::string GetLocationsCmd::path() const {
    return std::string(KTRUrlBase) + "getlocations";
}

Dictionary GetLocationsCmd::jsonBodyDictionary() {
    Dictionary body = KTRBaseCmd::jsonBodyDictionary();
    if (const auto handles = allFriendsHandles()) {
        body.set("handles", Value::Array(handles->begin(), handles->end()));
    }
    if (const auto location = currentLocationDictionary()) {
        body.set("myLocation", *location);
    }
    if (const auto location = requestedLocationDictionary()) {
        body.set("requestedLocation", *location);
    }
    if (requestedLocationLabel_) {
        body.set("label", *requestedLocationLabel_);
    }
    if (proximity_) {
        body.set("proximity", *proximity_);
    }
    if (clientId_) {
        body.set("serverContext", Dictionary{{"clientId", *clientId_}});
    }
    return body;
}

std::optional<Dictionary> GetLocationsCmd::currentLocationDictionary() const {
    return KTRVAUtils::dictionaryForLocation(currentLocation_);
}

std::optional<Dictionary> GetLocationsCmd::requestedLocationDictionary() const {
    return KTRVAUtils::dictionaryForLocation(requestedLocation_);
}

std::optional<std::vector<std::string>> GetLocationsCmd::allFriendsHandles() const {
    if (!friends_) {
        return std::nullopt;
    }
    std::vector<std::string> handles;
    if (const auto common = Common::sharedInstance()) {
        for (const auto& person : *friends_) {
            auto own = common->handlesForVAPerson(person);
            std::move(own.begin(), own.end(), std::back_inserter(handles));
        }
    }
    return handles;
}

std::shared_ptr<platform::VAPerson> GetLocationsCmd::friendForHandle(const std::string& handle) const {
    const auto found = friendsByHandle_.find(handle);
    return found != friendsByHandle_.end() ? found->second : nullptr;
}

void GetLocationsCmd::setFriends(std::optional<Persons> friends) {
    friends_ = std::move(friends);
    friendsByHandle_.clear();
    for (const auto& person : friends_.value_or(Persons())) {
        if (!person) {
            continue;
        }
        for (const auto& email : person->emails) {
            if (email && email->emailAddress) {
                friendsByHandle_.emplace(*email->emailAddress, person);
            }
        }
        for (const auto& phone : person->phones) {
            if (phone && phone->number) {
                friendsByHandle_.emplace(*phone->number, person);
            }
        }
    }
}

void GetLocationsCmd::readServerContext(const Dictionary& response) {
    std::optional<Dictionary> context;
    if (const Dictionary* sent = objectAt(response, "serverContext")) {
        context = *sent;
        if (statusCode() == kIncomplete) {
            context->set("incomplete", true);
        }
    }
    LogCategory_Unspecified()->line("serverContextDictionary: %@", context);
    setContextIdentifierURL(KTRVAUtils::contextIdentifierURLForDictionary(context));
}

void GetLocationsCmd::appendLocation(const std::string& handle, const Dictionary* entry, ServiceResult& found) {
    if (entry != nullptr && jsonInteger(entry->find("status")) == kNotReported) {
        return;
    }
    const auto record = KTRVALocation::locationWithEntry(handle, friendForHandle(handle), entry);
    if (record && record->velaLocation()) {
        found.emplace_back(record->velaLocation());
    }
    atRequestedLocation_ = entry != nullptr && jsonInteger(entry->find("match")) != 0;
}

std::optional<ServiceResult> GetLocationsCmd::result() {
    const auto response = jsonResponseDictionary();
    LogCategory_Unspecified()->line("getlocations_resultDictionary_raw: %@", response);
    if (!response) {
        return std::nullopt;
    }
    readServerContext(*response);
    const Dictionary* locations = objectAt(*response, "locations");
    const std::vector<std::string> handles = handlesOf(*response, locations);
    ServiceResult found;
    found.reserve(handles.size());
    EntriesInOrder entries(locations);
    for (const std::string& handle : handles) {
        appendLocation(handle, entries.of(handle), found);
    }
    LogCategory_Unspecified()->line("location result: %@", std::make_shared<DescribedList>(found));
    return found;
}

}  // namespace ktr
