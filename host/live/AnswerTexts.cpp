#include "host/live/AnswerTexts.h"

#include <algorithm>
#include <iterator>
#include <string>

#include "host/conversation/CutText.h"
#include "host/scenario/AssistantObjectReader.h"

namespace ktr::host {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr const char* kLocations = "locations";

bool isLong(const Value& value) {
    if (const std::string* text = value.string()) {
        return text->size() > AssistantObjectReader::kLongestText;
    }
    if (const Dictionary* members = value.dictionary()) {
        return std::any_of(members->begin(), members->end(), [](const auto& member) { return isLong(member.second); });
    }
    const Value::Array* values = value.array();
    return values != nullptr && std::any_of(values->begin(), values->end(), isLong);
}

Value shortened(const Value& value) {
    if (const std::string* text = value.string()) {
        return cutText(*text, AssistantObjectReader::kLongestText);
    }
    if (const Dictionary* members = value.dictionary()) {
        Dictionary made;
        for (const auto& [name, member] : *members) {
            made.set(name, shortened(member));
        }
        return made;
    }
    if (const Value::Array* values = value.array()) {
        Value::Array made;
        made.reserve(values->size());
        std::transform(values->begin(), values->end(), std::back_inserter(made), shortened);
        return made;
    }
    return value;
}

}  // namespace

Value withShortTexts(Value answer) {
    const Dictionary* members = answer.dictionary();
    const Value* locations = members != nullptr ? members->find(kLocations) : nullptr;
    if (locations == nullptr || !isLong(*locations)) {
        return answer;
    }
    Dictionary made = *members;
    made.set(kLocations, shortened(*locations));
    return made;
}

}  // namespace ktr::host
